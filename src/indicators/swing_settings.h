#pragma once

#include <optional>
#include <string_view>

#include "chart/swing_kind.h"

// What a swing chart is asked for with.

namespace kora {

inline constexpr std::string_view kSwingMessage = "Incorrect values entered";
inline constexpr std::string_view kSwingTitle = "Swing";
// What the boxes show for a size of 0.
inline constexpr double kSwingDays = 3, kSwingPoints = 9;

// Days or points as typed, at least 1; nothing for what is below that or no number, which is
// told as kSwingMessage.
std::optional<double> ReadSwingSize(std::string_view typed);

// The kind and size with which a swing chart comes on: a size below 1 of kDays and kPoints
// becomes 3, and any other kind kStandard.
SwingChoice SwingToShow(const SwingChoice& kept);

}  // namespace kora
