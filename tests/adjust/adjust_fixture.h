#pragma once

#include <gtest/gtest.h>

#include <map>
#include <string>
#include <vector>

#include "adjust/adjust_list.h"
#include "adjust/make_adjustments.h"
#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {

inline const std::string kData = "c:\\korawin\\data\\";
inline const std::string kHostData = "drive_c/korawin/data/";
inline const std::string kHostMisc = "drive_c/korawin/chtmisc/";
inline const std::string kHostIn = "drive_c/bul/in/";
inline const std::string kHostOut = "drive_c/bul/out/";
inline constexpr std::int32_t kNoteColour = 255;

// What a run showed; it stops at step `stopAt`.
struct KeptProgress : Progress {
  std::vector<std::string> items, notes;
  int steps = 0, stopAt = 0;
  void Show(ProgressLine line, std::string_view text) override {
    (line == ProgressLine::kNote ? notes : items).emplace_back(text);
  }
  bool Step(int, int) override { return ++steps != stopAt; }
};

// An installation of service 1 with ORE, BHP and NEW, whose five days are 7 to 11 September 1998.
class AdjustTest : public testing::Test {
 protected:
  AdjustTest() {
    settings.paths.SystemPath = "c:\\korawin\\";
    settings.paths.CurrentDataPath = kData;
    settings.paths.ChartMiscPath = "c:\\korawin\\chtmisc\\";
    settings.download.DataService = 1;
    settings.download.ServiceIn = "c:\\bul\\in\\";
    settings.download.ServiceOut = "c:\\bul\\out\\";
    settings.download.ServiceSystem = "c:\\bul\\system\\";
    Fill(home);
  }
  static void Fill(const TempHome& home) {
    home.Put(kHostOut + "keep", "");
    home.Put(kHostMisc + "keep", "");
    home.Put(kHostData + "Names.dat",
             Bytes(std::vector<NameRec>{Security("BHP"), Security("NEW"), Security("ORE")}));
    for (const char* code : {"BHP", "ORE"}) home.Put(kHostData + code + ".WDT", Bytes(Days(5)));
    home.Put(kHostData + "NEW.WDT", Bytes(Days(9)));
  }
  // 7 to 11 September, each `close`.
  static std::vector<PriceRec> Days(float close) {
    std::vector<PriceRec> days;
    for (const char* date : {"19980907", "19980908", "19980909", "19980910", "19980911"})
      days.push_back(Day(date, close, close + 1, close - 1, close, 1000));
    return days;
  }
  void Put(const std::string& name, const std::string& bytes) { home.Put(kHostData + name, bytes); }

  static AdjustRows Rows(const std::vector<std::string>& lines) {
    AdjustRows rows;
    for (const std::string& line : lines) rows.push_back(ParseAdjustLine(line));
    return rows;
  }
  AdjustResult Make(const std::vector<std::string>& lines) {
    rows = Rows(lines);
    return MakeAdjustments({home.files(), settings, kNoteColour, progress,
                            [this](size_t row) { done.push_back(row); }},
                           rows, kData);
  }
  std::vector<PriceRec> Prices(const std::string& code) {
    return PriceFile(home.files(), kData + code + ".WDT").ReadAll();
  }
  std::vector<float> Closes(const std::string& code) {
    std::vector<float> out;
    for (const PriceRec& rec : Prices(code)) out.push_back(float(rec.Close));
    return out;
  }
  // "BHP0 NEW0 ORE9": codes and status.
  std::string Names() {
    std::string out;
    for (const NameRec& rec : ReadNames(home.files(), kData))
      out += (out.empty() ? "" : " ") + std::string(rec.Code.trimmed()) +
             std::to_string(rec.NameStatus);
    return out;
  }
  NameRec NameOf(const std::string& code) {
    for (const NameRec& rec : ReadNames(home.files(), kData))
      if (rec.Code.trimmed() == code) return rec;
    ADD_FAILURE() << code << " is not in the name file";
    return {};
  }
  bool There(const std::string& name) { return home.files().CheckFile(kData + name); }
  std::string List() { return home.Get(kHostData + "Adjust.Lst"); }

  TempHome home;
  Settings settings;
  ScriptedDialogs dialogs;
  KeptProgress progress;
  AdjustRows rows;
  std::vector<size_t> done;
};

}  // namespace kora::test
