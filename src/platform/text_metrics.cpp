#include "platform/text_metrics.h"

#include <cmath>
#include <cstdint>

#include "base/text.h"

namespace kora {
namespace {

// Advance widths in thousandths of the font size, characters 32 to 126.
constexpr std::uint16_t kRegular[95] = {
    278, 278, 355, 556, 556, 889, 667, 191, 333, 333, 389, 584, 278, 333,  278, 278, 556, 556, 556,
    556, 556, 556, 556, 556, 556, 556, 278, 278, 584, 584, 584, 556, 1015, 667, 667, 722, 722, 667,
    611, 778, 722, 278, 500, 667, 556, 833, 722, 778, 667, 778, 722, 667,  611, 722, 667, 944, 667,
    667, 611, 278, 278, 278, 469, 556, 333, 556, 556, 500, 556, 556, 278,  556, 556, 222, 222, 500,
    222, 833, 556, 556, 556, 556, 333, 500, 278, 556, 500, 722, 500, 500,  500, 334, 260, 334, 584};

constexpr std::uint16_t kBold[95] = {
    278, 333, 474, 556, 556, 889, 722, 238, 333, 333, 389, 584, 278, 333, 278, 278, 556, 556, 556,
    556, 556, 556, 556, 556, 556, 556, 333, 333, 584, 584, 584, 611, 975, 722, 722, 722, 722, 667,
    611, 778, 722, 278, 556, 722, 611, 833, 722, 778, 667, 778, 722, 667, 611, 722, 667, 944, 667,
    667, 611, 333, 278, 333, 584, 556, 333, 556, 611, 556, 611, 556, 333, 611, 611, 278, 278, 556,
    278, 889, 611, 611, 611, 611, 389, 556, 333, 611, 556, 778, 556, 556, 500, 389, 280, 389, 584};

double Pixels(const SurfaceFont& font) { return font.size * 96.0 / 72.0; }

}  // namespace

bool HasStandardMetrics(const SurfaceFont& font) {
  if (font.name.empty()) return true;
  for (const char* name : {"Arial", "Helvetica", "Liberation Sans", "MS Sans Serif", "Nimbus Sans"})
    if (EqualNoCase(font.name, name)) return true;
  return false;
}

double StandardTextWidth(std::string_view text, const SurfaceFont& font) {
  const std::uint16_t* widths = font.bold ? kBold : kRegular;
  unsigned sum = 0;
  for (const char c : text) {
    const auto u = static_cast<unsigned char>(c);
    if (u >= 32 && u < 127)
      sum += widths[u - 32];
    else if ((u & 0xC0) != 0x80)
      sum += 556;  // other letters count as a digit does
  }
  return sum / 1000.0 * Pixels(font);
}

double StandardTextHeight(const SurfaceFont& font) { return std::ceil(Pixels(font) * 1.149); }

double StandardAscent(const SurfaceFont& font) { return Pixels(font) * 0.905; }

}  // namespace kora
