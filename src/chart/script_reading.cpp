#include "chart/script_reading.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace kora {
namespace {

constexpr std::uint64_t kLargestScript = 16u << 20;
constexpr double kLargestFont = 500;
constexpr size_t kMostFontSizes = 32;  // a chart has a handful

constexpr std::string_view kTexts = "TSZ", kSegments = "BFHLMCDEV";

bool Holds(std::string_view letters, char letter) {
  return letter != '\0' && letters.find(letter) != std::string_view::npos;
}

}  // namespace

ScriptShape ShapeOf(char letter, ScriptMedium medium) {
  const bool paper = medium == ScriptMedium::kPaper;
  if (Holds(kTexts, letter)) return ScriptShape::kText;
  if (Holds(kSegments, letter) || (paper && letter == 'X')) return ScriptShape::kSegment;
  if (letter == 'P' || (paper && letter == 'K')) return ScriptShape::kPoint;
  return ScriptShape::kNone;
}

std::string ReadChartScript(const Files& files, std::string_view path) {
  return files.ReadAll(path, kLargestScript);
}

double ScriptPlace(const ScriptLine& line, int field) {
  const double value = line.number(field);
  if (!(std::abs(value) <= std::numeric_limits<float>::max())) throw RunTimeError(kOverflow);
  return value;
}

void PlayBudget::Spend(double work) {
  work_ += work;
  if (work_ > mostWork_) throw RunTimeError(kOutOfMemory);
}

double PlayBudget::FontSize(const ScriptLine& line) {
  const double size = ScriptPlace(line, 2);
  if (size < 1 || size > kLargestFont) throw RunTimeError(kInvalidValue);
  if (std::find(sizes_.begin(), sizes_.end(), size) == sizes_.end()) {
    if (sizes_.size() == kMostFontSizes) throw RunTimeError(kOutOfMemory);
    sizes_.push_back(size);
  }
  return size;
}

bool IsCutOff(std::string_view line, const ScriptLine& fields, ScriptMedium medium) {
  const auto commas = std::count(line.begin(), line.end(), ',');
  switch (ShapeOf(fields.letter(), medium)) {
    case ScriptShape::kText:
    case ScriptShape::kSegment: return commas < 5;
    case ScriptShape::kPoint: return commas < 3;
    case ScriptShape::kNone: break;
  }
  return false;
}

}  // namespace kora
