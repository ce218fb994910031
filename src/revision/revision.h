#pragma once

#include <string>
#include <string_view>

namespace kora {

// The checkout that the programs were built from: the short hash of its commit, with "-dirty"
// where files differed from it; "unknown" outside a checkout.
std::string_view Revision();

// What `--version` says: "kora 7F (revision 1a2b3c4)".
std::string VersionLine(std::string_view program);

}  // namespace kora
