#pragma once

#include <string>

#include "base/files.h"

namespace kora {

// Whether two DOS paths name one file or folder, by whatever names: in another case, with or
// without the last backslash, through a link.
bool IsSamePlace(const Files& files, const std::string& a, const std::string& b);

}  // namespace kora
