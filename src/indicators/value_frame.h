#pragma once

#include <cstdint>
#include <string_view>

#include "indicators/osc_panel.h"

namespace kora {

// The frame of a series drawn by its own values, with a margin of a tenth of the height.
//
// A series that goes below zero is spread over highest - lowest. One that does not is spread
// from zero to its highest, with lowest as the offset only.
class ValueFrame {
 public:
  // Error 6 for a range without bounds.
  ValueFrame(const OscPanel& panel, double highest, double lowest);

  // There is nothing to scale: the panel ends at its frame.
  bool Empty() const { return scale_ == 0; }
  // Error 6 where y leaves 16 bits.
  std::int16_t Y(double value) const;

  // The lines 20 inside the frame, with the texts of highest and lowest, and the zero line. The
  // two stand by pixels and not by value: close to, not on, the values that they name.
  void DrawLines(OscPanel& panel, std::string_view highest, std::string_view lowest) const;

 private:
  double base_, lowest_, scale_;
};

}  // namespace kora
