#include "bench/bench_home.h"

#include "base/dates.h"

namespace kora::bench {

std::vector<PriceRec> TradingDays(int year, int count) {
  std::vector<PriceRec> days;
  for (std::int32_t n = DayNumber({year, 1, 1}); int(days.size()) < count; ++n) {
    const CalendarDate date = DateOfDayNumber(n);
    if (Weekday(date) != 1 && Weekday(date) != 7) days.push_back(NewPriceRec(FormatFileDate(date)));
  }
  return days;
}

Home::Home(int records) {
  files().MakeFolder("c:\\korawin\\data");
  std::vector<PriceRec> days = TradingDays(1990, records);
  float close = 20;
  std::uint32_t noise = 1;
  for (PriceRec& rec : days) {
    noise = noise * 1664525u + 1013904223u;
    const float open = close;
    close *= 0.985f + float(noise >> 16) / 65536.0f * 0.0302f;
    rec.Open = open;
    rec.Close = close;
    rec.High = (open > close ? open : close) * 1.006f;
    rec.Low = (open < close ? open : close) * 0.994f;
    rec.Volume = 20000 + std::int32_t(noise >> 13) % 90000;
  }
  PriceFile(files(), "c:\\korawin\\data\\BENCH.WDT", OpenMode::kReplace).WriteRun(1, days);
}

}  // namespace kora::bench
