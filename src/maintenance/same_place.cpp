#include "maintenance/same_place.h"

#include "base/text.h"

namespace kora {

bool IsSamePlace(const Files& files, const std::string& a, const std::string& b) {
  if (EqualNoCase(WithBackslash(a), WithBackslash(b))) return true;
  const auto host = [&](std::string path) {
    while (path.size() > 3 && path.back() == '\\') path.pop_back();
    return files.io().LinkTarget(files.HostPath(path));
  };
  const std::string one = host(a), other = host(b);
  if (one == other) return true;
  const HostStatus first = files.io().Status(one), second = files.io().Status(other);
  return first.exists && second.exists && first.id != 0 && first.id == second.id &&
         first.size == second.size && first.modified == second.modified &&
         first.folder == second.folder;
}

}  // namespace kora
