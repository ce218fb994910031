#pragma once

#include <string>
#include <vector>

#include "base/dates.h"
#include "chart/composer.h"
#include "store/price_rec.h"
#include "tests/support/recording_surface.h"
#include "tests/support/records.h"
#include "tests/support/script_lines.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// A home with one security, TEST, whose days a test sets, and a surface of 638 x 452. Colour
// entry n has the colour n, so that a test reads entries.
struct ComposerFixture {
  TempHome home;
  ScriptedDialogs dialogs;
  Paths paths;
  FontSettings fonts;
  ChartColours colours{};
  RecordingSurface price{638, 452};
  ChartScript script;
  ChartServices services{home.files(), dialogs, paths, fonts, colours, price, nullptr, &script};
  ChartRequest request;
  Composition chart;
  std::vector<PriceRec> days;

  ComposerFixture() {
    paths.SystemPath = "c:\\korawin\\";
    paths.CurrentDataPath = "c:\\korawin\\data\\";
    fonts.Font2Size = 8;
    for (size_t i = 0; i < colours.size(); ++i) colours[i] = std::int32_t(i);
    request.Name = NewNameRec("TEST");
    request.Name.Name.set("Test Holdings");
  }

  PriceRec& Day(std::string_view date, float open, float high, float low, float close,
                std::int32_t volume = 0) {
    days.push_back(test::Day(date, open, high, low, close, volume));
    return days.back();
  }
  // `count` calendar days from `date` on, each flat at 10 but with a range of 9 to 11.
  void Days(std::string_view date, int count, std::int32_t volume = 0) {
    const std::int32_t first = DayNumber(*ParseFileDate(date));
    for (int i = 0; i < count; ++i)
      Day(FormatFileDate(DateOfDayNumber(first + i)), 10, 11, 9, 10, volume);
  }
  void Save() const {
    home.Put("drive_c/korawin/data/TEST.WDT",
             {reinterpret_cast<const char*>(days.data()), days.size() * sizeof(PriceRec)});
  }
  bool Compose() {
    Save();
    price.ops.clear();
    return ComposeChart(services, request, chart);
  }

  std::vector<std::string> Script() const { return LinesOf(script); }
  std::vector<std::string> Lines(char letter) const { return LinesOf(script, letter); }
  bool Wrote(const std::string& line) const {
    for (const std::string& l : Script())
      if (l == line) return true;
    return false;
  }
};

}  // namespace kora::test
