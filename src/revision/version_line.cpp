#include "base/version.h"
#include "revision/revision.h"

namespace kora {

std::string VersionLine(std::string_view program) {
  return std::string(program) + " " + std::string(kVersion) + " (revision " +
         std::string(Revision()) + ")";
}

}  // namespace kora
