#include "scans/scan_filter.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/industry_classes.h"

namespace kora {
namespace {

constexpr size_t kWarrantCode = 6;

// The product as a 32-bit float, or nothing where there is none.
std::optional<float> Product(double factor, float price) {
  const double product = factor * price;
  if (!(std::fabs(product) <= double(std::numeric_limits<float>::max()))) return std::nullopt;
  return CSng(product);
}

}  // namespace

bool SecurityFilter::Wants(const NameRec& name) const {
  if (category && name.Category != *category) return false;
  if (industry && !MatchesIndClass(Trim(name.IndClass.trimmed()), *industry)) return false;
  return !(noWarrants && Trim(name.Code.trimmed()).size() == kWarrantCode);
}

std::optional<float> FloatOf(std::string_view typed) {
  const double value = Val(typed);
  if (!(std::fabs(value) <= double(std::numeric_limits<float>::max()))) return std::nullopt;
  return CSng(value);
}

std::optional<ClosingRange> ReadClosingRange(std::string_view min, std::string_view max) {
  const auto low = FloatOf(min), high = FloatOf(max);
  if (!low || !high) return std::nullopt;
  ClosingRange range{*low, *high};
  if (!(range.min > 0)) range.min = CSng(0.005);
  if (range.max == 0 || range.max < range.min) return std::nullopt;
  return range;
}

std::optional<std::string> PaddedIndustry(std::string_view typed) {
  typed = Trim(typed);
  if (typed.empty()) return std::string();
  const bool digits =
      std::all_of(typed.begin(), typed.end(), [](char c) { return c >= '0' && c <= '9'; });
  if (!digits) return std::nullopt;
  return Format(Val(typed), "000");
}

std::optional<ScanFault> ReadRangeBoxes(std::string_view min, std::string_view max,
                                        std::optional<ClosingRange>& range) {
  range = ReadClosingRange(min, max);
  if (range) return std::nullopt;
  return ScanFault{"Price values invalid", "Closing Price Range", "Text2"};
}

std::optional<ScanFault> ReadClassBox(std::string_view typed,
                                      std::optional<std::string>& industry) {
  const auto padded = PaddedIndustry(typed);
  if (!padded || padded->empty())
    return ScanFault{"Industry Class invalid", "Industry Class", "Text6"};
  industry = padded;
  return std::nullopt;
}

bool RisesBy(double percent, float before, float last) {
  const auto product = Product(percent / 100 + 1, before);
  return product && last >= *product;
}

bool FallsBy(double percent, float before, float last) {
  const auto product = Product((100 - percent) / 100, before);
  return product && last <= *product;
}

std::string PercentText(float before, float last) {
  const double percent = RoundHalfEven((double(last) - before) / before * 100);
  return Str(percent == 0 ? 0.0 : percent);
}

std::string PriceText(float price) { return Format(price, "####.00"); }

}  // namespace kora
