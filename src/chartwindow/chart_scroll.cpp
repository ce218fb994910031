#include "chartwindow/chart_scroll.h"

#include <algorithm>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/price_rec.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Chart Scroll";
constexpr std::int32_t kTooFew = 100;

std::string FileDate(std::int32_t yyyymmdd) { return Format(double(yyyymmdd), "00000000"); }

}  // namespace

bool ChartScroll::SetScrollBar() {
  const std::string file(Trim(services_.current.PriceFileName));
  RecDates_.clear();
  try {
    const PriceFile prices(services_.files, services_.settings.paths.CurrentDataPath + file);
    if (prices.count() <= kTooFew) {
      services_.dialogs.Message("Too few records to show scroll bar", kTitle);
      return false;
    }
    for (const PriceRec& rec : prices.ReadAll()) RecDates_.push_back(CLng(Val(rec.RecDate.raw())));
  } catch (const RunTimeError& e) {
    RecDates_.clear();
    services_.dialogs.Message(file + "  -  " + e.what(), kTitle);
    return false;
  }
  value_ = Maximum();
  if (file == ScrollFile_ && ScrollPos_ >= 1 && ScrollPos_ <= Maximum()) value_ = ScrollPos_;
  services_.state.ScrollInUse = true;
  return true;
}

void ChartScroll::SetValue(std::int32_t value) {
  value_ = std::clamp<std::int32_t>(value, 1, std::max<std::int32_t>(Maximum(), 1));
}

std::string ChartScroll::DateText() const {
  if (value_ < 1 || value_ > Maximum()) return {};
  const auto date = ParseFileDate(FileDate(RecDates_[size_t(value_) - 1]));
  return date ? FormatUserDate(*date) : std::string();
}

void ChartScroll::Accept() {
  ChartState& s = services_.state;
  const auto date = value_ >= 1 && value_ < Maximum()
                        ? ParseFileDate(FileDate(RecDates_[size_t(value_) - 1]))
                        : std::nullopt;
  if (!date) {
    s.DateLimitOn = false;
    s.ScrollInUse = false;
    Forget();
    return;
  }
  s.DateLimitOn = true;
  s.DateLimitDate = s.ChosenLimitDate = FormatFileDate(*date);
  s.DateLimitText = FormatDisplayDate(*date);
  s.ChosenLimitText = FormatUserDate(*date);
  ScrollFile_ = Trim(services_.current.PriceFileName);
  ScrollPos_ = value_;
}

void ChartScroll::Forget() {
  ScrollFile_.clear();
  ScrollPos_ = 1;
}

}  // namespace kora
