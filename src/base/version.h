#pragma once

#include <string_view>

// What the program calls itself, in titles and messages.

namespace kora {

inline constexpr std::string_view kVersion = "7F";
inline constexpr std::string_view kProgramTitle = "KORA Charting 7F";
static_assert(kProgramTitle.ends_with(kVersion));

}  // namespace kora
