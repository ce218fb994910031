#include "bench/bench_home.h"

#include <filesystem>
#include <stdexcept>
#include <stdlib.h>

#include "base/dates.h"
#include "store/price_rec.h"

namespace kora::bench {
namespace {

std::string MakeFolder() {
  std::string name = (std::filesystem::temp_directory_path() / "kora-bench-XXXXXX").string();
  if (!::mkdtemp(name.data())) throw std::runtime_error("no temporary folder");
  return name;
}

}  // namespace

Home::Home(int records) : path_(MakeFolder()), files_(path_) {
  files_.MakeFolder("c:\\korawin\\data");
  std::vector<PriceRec> days;
  float close = 20;
  std::uint32_t noise = 1;
  for (std::int32_t n = DayNumber({1990, 1, 1}); int(days.size()) < records; ++n) {
    const CalendarDate date = DateOfDayNumber(n);
    if (Weekday(date) == 1 || Weekday(date) == 7) continue;
    noise = noise * 1664525u + 1013904223u;
    const float open = close;
    close *= 0.985f + float(noise >> 16) / 65536.0f * 0.0302f;
    PriceRec rec = NewPriceRec(FormatFileDate(date));
    rec.Open = open;
    rec.Close = close;
    rec.High = (open > close ? open : close) * 1.006f;
    rec.Low = (open < close ? open : close) * 0.994f;
    rec.Volume = 20000 + std::int32_t(noise >> 13) % 90000;
    days.push_back(rec);
  }
  PriceFile file(files_, "c:\\korawin\\data\\BENCH.WDT", OpenMode::kReplace);
  file.WriteRun(1, days);
}

Home::~Home() {
  std::error_code ignored;
  std::filesystem::remove_all(path_, ignored);
}

}  // namespace kora::bench
