#pragma once

#include <gtest/gtest.h>

#include <deque>
#include <memory>
#include <string>
#include <vector>

#include "chartwindow/chart_window.h"
#include "tests/support/recording_surface.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {

// A window over three shares with 28 days of February 2026, on surfaces that record.
class ChartWindowTest : public testing::Test {
 protected:
  ChartWindowTest() {
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.paths.CurrentDataPath = "c:\\korawin\\data\\";
    settings.paths.ChartMiscPath = "c:\\korawin\\chtmisc\\";
    settings.charts.Type = "B";
    settings.charts.Period = "A";
    settings.charts.Spacing = 2;
    home.files().MakeFolder("c:\\korawin\\data");
    home.files().MakeFolder("c:\\korawin\\chtmisc");
    LoadColours(home.files(), settings.paths.SystemPath, "Black", colours);
  }

  void PutNames(const std::vector<NameRec>& names) {
    home.Put("drive_c/korawin/data/Names.dat", test::Bytes(names));
    for (const NameRec& name : names) PutPrices(std::string(name.Code.trimmed()));
  }
  void PutPrices(const std::string& code) {
    std::vector<PriceRec> days;
    for (int i = 1; i <= 28; ++i) {
      const std::string date = "202602" + std::string(i < 10 ? "0" : "") + std::to_string(i);
      const float close = 10.0f + float(i % 5);
      days.push_back(test::Day(date, close, close + 1, close - 1, close, 1000 * i));
    }
    home.Put("drive_c/korawin/data/" + code + ".WDT", test::Bytes(days));
  }
  // A, B and C, all shares.
  void PutThree() {
    PutNames({test::Security("AAA"), test::Security("BBB"), test::Security("CCC")});
  }

  ChartWindow& window() {
    if (!window_) {
      window_ = std::make_unique<ChartWindow>(
          ChartWindowServices{.files = home.files(),
                              .dialogs = dialogs,
                              .settings = settings,
                              .ini = ini,
                              .user = user,
                              .colours = colours,
                              .current = current,
                              .state = state,
                              .price = surface,
                              .panel = panel,
                              .popUpTrend =
                                  [this] {
                                    ++popUps;
                                    if (choices.empty()) return TrendChoice::kNothing;
                                    const TrendChoice c = choices.front();
                                    choices.pop_front();
                                    return c;
                                  },
                              .openZoom = [this](const ZoomBox& box) { zoomed.push_back(box); }});
      window_->Load();
      surface.ops.clear();
      panel.ops.clear();
    }
    return *window_;
  }
  std::string shown() const { return current.PriceFileName; }
  std::string script() const { return home.Get("drive_c/korawin/data/TCht.Tmp"); }

  test::TempHome home;
  test::ScriptedDialogs dialogs;
  Settings settings;
  ChartColours colours{};
  CurrentName current;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  SettingsFile user{home.files(), "C:\\WINDOWS\\KoraUser.ini"};
  ChartState state;
  int popUps = 0;
  std::deque<TrendChoice> choices;  // of the pop-up; dismissed when empty
  std::vector<ZoomBox> zoomed;
  test::RecordingSurface surface{638, 452}, panel{638, 144};

 private:
  std::unique_ptr<ChartWindow> window_;
};

}  // namespace kora
