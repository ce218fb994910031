#include "chart/swing_kind.h"

#include "base/text.h"

namespace kora {
namespace {

constexpr SwingKind kKinds[] = {SwingKind::kStandard, SwingKind::kDays, SwingKind::kPoints,
                                SwingKind::kPointsAuto};

}  // namespace

std::optional<SwingKind> SwingKindOf(std::string_view word) {
  for (const SwingKind kind : kKinds)
    if (EqualNoCase(word, SwingWord(kind))) return kind;
  return std::nullopt;
}

std::string_view SwingWord(SwingKind kind) {
  switch (kind) {
    case SwingKind::kStandard: return "NORM";
    case SwingKind::kDays: return "XDay";
    case SwingKind::kPoints: return "XPoint";
    case SwingKind::kPointsAuto: return "XPointAuto";
    default: return "";
  }
}

}  // namespace kora
