#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "base/io.h"

// Files that the user names by a path of the machine, outside the home.

namespace kora {

// The whole file. Error 7 when larger than `limit` bytes, 75 for a folder or what else is no
// plain file.
std::string ReadHostFile(Io& io, const std::string& path, std::uint64_t limit);

// Replaces the file as a whole, or leaves it as it was: a HostFileSet of one, whose rules and
// errors it has.
void WriteHostFile(Io& io, const std::string& path, std::string_view bytes);

}  // namespace kora
