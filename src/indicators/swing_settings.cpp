#include "indicators/swing_settings.h"

#include "base/numbers.h"
#include "base/text.h"

namespace kora {

std::optional<double> ReadSwingSize(std::string_view typed) {
  const auto size = ParseFloat(Trim(typed));
  if (!size || *size < 1) return std::nullopt;
  // Sizes have 64 bits.
  const double whole = Val(Trim(typed));
  return CSng(whole) == *size ? whole : double(*size);
}

SwingChoice SwingToShow(const SwingChoice& kept) {
  const bool sized = kept.kind == SwingKind::kDays || kept.kind == SwingKind::kPoints;
  if (!sized) return {SwingKind::kStandard, kept.size};
  return {kept.kind, kept.size < 1 ? kSwingDays : kept.size};
}

}  // namespace kora
