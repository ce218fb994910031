#pragma once

#include <algorithm>

namespace kora {

// The part of a line from (x, y) by (dx, dy) that lies on a rectangle from the origin to
// (width, height), as the shares `from` and `to` of its length. False when none does. Media
// can't write coordinates as far off as a script may hold.
inline bool CutLine(double x, double y, double dx, double dy, double width, double height,
                    double& from, double& to) {
  from = 0;
  to = 1;
  const auto cut = [&](double p, double q) {  // keeps t with p * t <= q
    if (p == 0) return q >= 0;
    if (p < 0)
      from = std::max(from, q / p);
    else
      to = std::min(to, q / p);
    return from < to;
  };
  return cut(-dx, x) && cut(dx, width - x) && cut(-dy, y) && cut(dy, height - y);
}

}  // namespace kora
