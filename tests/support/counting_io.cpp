#include "tests/support/counting_io.h"

#include "base/runtime_error.h"

namespace kora::test {

std::vector<std::string> CountingIo::List(const std::string& folder) {
  ++lists;
  if (refuseLists) throw RunTimeError(kPathAccess);
  return MachineIo().List(folder);
}

}  // namespace kora::test
