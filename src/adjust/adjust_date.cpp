#include "adjust/adjust_date.h"

#include <algorithm>

#include "base/dates.h"
#include "base/numbers.h"

namespace kora {
namespace {

constexpr int kBeside = 20;  // records shown to each side
constexpr size_t kSelectedLine = 20;

// The date, as many blanks again, three more, and the close.
std::string LineOf(const PriceRec& rec) {
  const std::string date = DateToDisplay(rec.RecDate.raw());
  return date + std::string(date.size() + 3, ' ') + Format(rec.Close, "######.00");
}

}  // namespace

AdjustmentDates FindAdjustmentDate(std::span<const PriceRec> records,
                                   std::string_view AdjWantedDate) {
  AdjustmentDates dates;
  const int count = CInt(double(records.size()));
  int n = 2;
  while (n <= count && records[size_t(n - 1)].RecDate.raw() <= AdjWantedDate) ++n;
  --n;
  n = std::min(n, count);
  if (n <= 1) return dates;
  dates.Found = CInt(n);
  const int first = std::max(1, n - kBeside), last = std::min(count, n + kBeside);
  dates.AdjListFirst = CInt(first);
  for (int i = first; i <= last; ++i) dates.Lines.push_back(LineOf(records[size_t(i - 1)]));
  dates.Selected = std::min(kSelectedLine, dates.Lines.size() - 1);
  return dates;
}

std::string OtherDateText(std::span<const PriceRec> records, const AdjustmentDates& dates,
                          std::string_view AdjWantedDate, std::string_view typed) {
  if (dates.Found == 0) return {};
  const PriceRec& rec = records[size_t(dates.Found - 1)];
  if (rec.RecDate.raw() == AdjWantedDate) return {};
  return "No close price on file for " + std::string(typed) + "\n Nearest date prior is " +
         DateToDisplay(rec.RecDate.raw()) + "\n Close price is " + Str(rec.Close);
}

}  // namespace kora
