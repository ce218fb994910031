// The operations of maintenance by koractl as a process.

#include <gtest/gtest.h>

#include <filesystem>
#include <map>

#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

using namespace kora::test;

namespace {

namespace fs = std::filesystem;
using Words = std::vector<std::string>;

class MaintenanceCommand : public ::testing::Test {
 protected:
  ProgramResult Run(Words words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(kora::BinDir() + "/koractl", words);
  }
  ProgramResult Good(const Words& words) {
    const ProgramResult result = Run(words);
    EXPECT_EQ(result.code, 0) << words[0] << " " << result.err;
    return result;
  }
  void Lay() {
    ASSERT_EQ(Run({"init"}).code, 0);
    home.Put("ORE.csv", "Date,Open,High,Low,Close,Volume\n19980911,1,2,1,1.5,10\n");
    home.Put("OLD.csv", "Date,Close\n19980910,3\n");
    Good({"import", home.path() + "/ORE.csv", home.path() + "/OLD.csv"});
  }
  // "date close" a line.
  std::string Prices(const std::string& code) {
    const std::string out = Good({"prices", code}).out;
    std::string text;
    size_t at = out.find('\n') + 1;
    while (at < out.size()) {
      const std::string line = out.substr(at, out.find('\n', at) - at);
      Words cells;
      for (size_t from = 0; from <= line.size();) {
        const size_t end = std::min(line.find('\t', from), line.size());
        cells.push_back(line.substr(from, end - from));
        from = end + 1;
      }
      text += cells.at(1) + " " + cells.at(5) + "\n";
      at += line.size() + 1;
    }
    return text;
  }
  std::map<std::string, std::string> DataFiles() {
    std::map<std::string, std::string> out;
    for (const auto& e : fs::directory_iterator(home.path() + "/kora/drive_c/korawin/data"))
      if (e.is_regular_file())
        out[e.path().filename().string()] =
            home.Get("kora/drive_c/korawin/data/" + e.path().filename().string());
    return out;
  }
  TempHome home;
};

}  // namespace

TEST_F(MaintenanceCommand, ADayIsEnteredAndRemovedAgain) {
  Lay();
  Good({"enter", "ORE", "--date", "14/9/98", "--open", "2", "--high", "3", "--low", "2", "--close",
        "2.5", "--volume", "7"});
  EXPECT_EQ(Prices("ORE"), "19980911 1.5\n19980914 2.5\n");
  const ProgramResult refused =
      Run({"enter", "ORE", "--date", "15/9/98", "--close", "0", "--open", "1"});
  EXPECT_EQ(refused.code, 1);
  EXPECT_EQ(refused.err, "[Data Entry] Use previous close \nData should not be 0\n");
  const ProgramResult removed = Good({"remove-date", "14/9/98"});
  EXPECT_EQ(removed.out, "1 files changed, 1 records removed\n");
  EXPECT_EQ(Prices("ORE"), "19980911 1.5\n");
  EXPECT_EQ(Run({"remove-date", "31/9/98"}).code, 1);
}

TEST_F(MaintenanceCommand, ACodeIsChangedAndCombined) {
  Lay();
  const ProgramResult result = Good({"change-code", "OLD", "ORE"});
  EXPECT_NE(result.err.find("[Conversion] File converted and OLD changed to ORE in the NAME File"),
            std::string::npos);
  EXPECT_EQ(Prices("ORE"), "19980910 3\n19980911 1.5\n");
  EXPECT_EQ(Run({"prices", "OLD"}).code, 1);
  EXPECT_EQ(Run({"change-code", "OLD", "ORE"}).code, 1);
}

TEST_F(MaintenanceCommand, AFileIsMovedToAnotherFolder) {
  Lay();
  fs::create_directories(home.path() + "/kora/drive_c/m/b");
  Good({"move", "ORE", "--from", "c:\\korawin\\data", "--to", "c:\\m\\b"});
  EXPECT_EQ(home.Get("kora/drive_c/m/b/ORE.WDT"), home.Get("kora/drive_c/korawin/data/ORE.WDT"));
  EXPECT_EQ(home.Get("kora/drive_c/m/b/Names.dat").size(), 96u);
  EXPECT_EQ(Run({"move", "ORE", "--from", "c:\\m\\b", "--to", "C:\\M\\B\\"}).code, 1);
}

TEST_F(MaintenanceCommand, ChecksSayWhatTheyFound) {
  Lay();
  fs::remove(home.path() + "/kora/drive_c/korawin/data/OLD.WDT");
  EXPECT_EQ(Good({"check", "data", "--types", "1,2,4,5"}).out,
            "OLD has no data file\n# Checked=1 Repaired=0 Listed=1\n");
  EXPECT_EQ(Run({"check", "data", "--types", "3"}).code, 2);
  const ProgramResult kept = Good({"--answer", "no", "check", "names"});
  EXPECT_EQ(kept.out, "Names.DAT  has 2 Records\n");
  EXPECT_EQ(Good({"check", "names"}).out, "Names.DAT  has 1 Records\n");
  EXPECT_EQ(Run({"check", "totals", "OLD"}).code, 1);
  EXPECT_EQ(Run({"check"}).code, 2);
}

TEST_F(MaintenanceCommand, TheStoreIsBackedUpAndRestored) {
  Lay();
  EXPECT_EQ(Run({"restore"}).code, 1);
  Good({"backup"});
  const auto before = DataFiles();
  Good({"change-code", "OLD", "ORE"});
  ASSERT_NE(DataFiles(), before);
  Good({"restore"});
  EXPECT_EQ(DataFiles(), before);
}

TEST_F(MaintenanceCommand, PricesAreExported) {
  Lay();
  EXPECT_EQ(Good({"export", "closes"}).err, "[Text File] Text File 11SEP98.TXT created\n");
  EXPECT_EQ(home.Get("kora/drive_c/korawin/chtmisc/11SEP98.TXT"), "ORE,19980911,1.5\r\n");
  Good({"export", "closes", "--date", "10/9/98", "--columns"});
  EXPECT_EQ(home.Get("kora/drive_c/korawin/chtmisc/10SEP98.TXT"), "OLD         19980910    3\r\n");
  Good({"export", "history", "ORE"});
  EXPECT_EQ(home.Get("kora/drive_c/korawin/chtmisc/ORE.txt"), "ORE,11/9/98,1,2,1,1.5,10\r\n");
  // Who says nothing keeps the texts of his charts.
  home.Put("kora/drive_c/korawin/chtmisc/OLD.Txt", "T,8.25,19980910,3.00,A note,255\r\n");
  EXPECT_EQ(Run({"export", "history", "OLD"}).code, 1);
  EXPECT_EQ(home.Get("kora/drive_c/korawin/chtmisc/OLD.Txt").substr(0, 2), "T,");
  Good({"--answer", "yes", "export", "history", "OLD"});
  EXPECT_EQ(home.Get("kora/drive_c/korawin/chtmisc/OLD.Txt"), "OLD,10/9/98,3,3,3,3,0\r\n");
}

// A day typed in, a price corrected, a code changed, a file moved, all checked, a date removed: the backup brings every
// chart back as it was.
TEST_F(MaintenanceCommand, EveryChartLooksAsBeforeBehindARestore) {
  Good({"demo", "--securities", "8", "--years", "1"});
  Words codes;
  const std::string names = Good({"names"}).out;
  for (size_t at = names.find('\n') + 1; at < names.size(); at = names.find('\n', at) + 1) {
    const size_t code = names.find('\t', names.find('\t', at) + 1) + 1;
    codes.push_back(names.substr(code, names.find('\t', code) - code));
  }
  ASSERT_EQ(codes.size(), 8u);
  const auto charts = [&] {
    std::string all;
    for (const std::string& code : codes) all += Good({"chart", code, "--out", "-"}).out;
    return all;
  };
  const std::string before = charts();
  EXPECT_NE(Good({"backup"}).out.find(" files copied\n"), std::string::npos);
  Good({"enter", codes[0], "--date", "1/1/30", "--open", "1", "--high", "2", "--low", "1",
        "--close", "2"});
  EXPECT_NE(charts(), before);
  Good({"edit", codes[3], "set", "5", "Close", "99.5"});
  Good({"change-code", codes[1], "QQQ"});
  fs::create_directories(home.path() + "/kora/drive_c/m/b");
  Good({"move", codes[2], "--from", "c:\\korawin\\data", "--to", "c:\\m\\b"});
  Good({"check", "data", "--types", "1,2,4,5"});
  Good({"--answer", "no", "check", "names"});
  EXPECT_EQ(Good({"remove-date", "1/1/30"}).out, "1 files changed, 1 records removed\n");
  Good({"restore"});
  EXPECT_EQ(charts(), before);
}
