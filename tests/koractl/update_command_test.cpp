// Downloaded files taken in by koractl as a process.

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <map>
#include <set>
#include <sstream>

#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

using namespace kora::test;

namespace {

namespace fs = std::filesystem;
using Words = std::vector<std::string>;
const std::string kDown = "drive_c/korawin/download/";

class UpdateCommand : public ::testing::Test {
 protected:
  ProgramResult Run(Words words, const std::string& name = "kora") {
    words.insert(words.begin(), {"--home", home.path() + "/" + name});
    return RunProgram(kora::BinDir() + "/koractl", words);
  }
  std::string Out(const Words& words, const std::string& name = "kora") {
    const ProgramResult result = Run(words, name);
    EXPECT_EQ(result.code, 0) << words[0] << " " << result.err;
    return result.out;
  }
  void Download(const std::string& name, const std::string& text) {
    home.Put("kora/" + kDown + name, text);
  }
  bool Waits(const std::string& name) { return home.Exists("kora/" + kDown + name); }
  // Every file of the installation with its bytes, but for the lock's.
  std::map<std::string, std::string> AllFiles() {
    std::map<std::string, std::string> out;
    for (const auto& e : fs::recursive_directory_iterator(home.path() + "/kora"))
      if (e.is_regular_file()) {
        const std::string name = e.path().string().substr(home.path().size() + 1);
        if (!name.ends_with("Kora.lock")) out[name] = home.Get(name);
      }
    return out;
  }
  TempHome home;
};

std::vector<std::vector<std::string>> Cells(const std::string& table) {
  std::vector<std::vector<std::string>> rows;
  std::istringstream in(table);
  std::string line, cell;
  while (std::getline(in, line)) {
    rows.emplace_back();
    std::istringstream cells(line);
    while (std::getline(cells, cell, '\t')) rows.back().push_back(cell);
  }
  return rows;
}

}  // namespace

// Every line of the three waiting files must stand in the price file of its code, field by
// field, and shares that did not trade must be flat.
TEST_F(UpdateCommand, TheDemoMarketsWaitingDaysAreTakenIn) {
  ASSERT_EQ(Run({"demo"}).code, 0);
  const auto listed = Cells(Out({"downloads"}));
  ASSERT_EQ(listed.size(), 4u);
  EXPECT_EQ(listed[0], std::vector<std::string>{"File"});
  std::map<std::string, std::map<std::string, std::string>> wanted;  // code, date, fields
  std::set<std::string> dates;
  for (size_t i = 1; i < listed.size(); ++i) {
    std::istringstream in(home.Get("kora/" + kDown + listed[i][0]));
    std::string line;
    while (std::getline(in, line)) {
      if (line.ends_with('\r')) line.pop_back();
      const size_t code = line.find(','), date = line.find(',', code + 1);
      std::string fields = line.substr(date + 1, line.rfind(',') - date);
      std::replace(fields.begin(), fields.end(), ',', '\t');
      wanted[line.substr(0, code)][line.substr(code + 1, date - code - 1)] = fields;
      dates.insert(line.substr(code + 1, date - code - 1));
    }
  }
  ASSERT_EQ(dates.size(), 3u);
  ASSERT_GT(wanted.size(), 40u);
  std::map<std::string, std::vector<std::vector<std::string>>> before;
  for (const auto& [code, days] : wanted) before[code] = Cells(Out({"prices", code}));

  EXPECT_EQ(Out({"update"}), "");  // the first day, then the rest
  EXPECT_EQ(Cells(Out({"downloads"})).size(), 3u);
  EXPECT_EQ(Out({"update", "--all"}), "");
  EXPECT_EQ(Cells(Out({"downloads"})).size(), 1u);

  size_t flat = 0;
  for (const auto& [code, days] : wanted) {
    const auto rows = Cells(Out({"prices", code}));
    size_t found = 0;
    std::string close;
    for (size_t r = 1; r < rows.size(); ++r) {
      const auto& row = rows[r];
      if (dates.contains(row[1])) {
        std::string fields;
        for (int c = 2; c <= 6; ++c) fields += row[size_t(c)] + "\t";
        if (const auto day = days.find(row[1]); day != days.end()) {
          EXPECT_EQ(fields, day->second) << code << " " << row[1];
          ++found;
        } else {
          EXPECT_EQ(fields, close + "\t" + close + "\t" + close + "\t" + close + "\t0\t") << code;
          ++flat;
        }
      }
      close = row[5];
    }
    EXPECT_EQ(found, days.size()) << code;
    EXPECT_EQ(rows.size(), before[code].size() + 3) << code;
  }
  EXPECT_EQ(flat, 0u);  // the files of the demo's service have every security, traded or not
}

TEST_F(UpdateCommand, TakesTheEntryThatIsNamed) {
  ASSERT_EQ(Run({"init"}).code, 0);
  ASSERT_EQ(Run({"--set", "Download.InternetDLfmt=DDMMMYY.D", "update"}).code, 1);
  Download("15SEP98.d", "ORE,19980915,1,1,1,1,1,0\n");
  Download("16SEP98.d", "ORE,19980916,2,2,2,2,2,0\n");
  const Words words{"--set", "Download.InternetDLfmt=DDMMMYY.D", "update"};
  auto named = words;
  named.push_back("16sep98.d");
  EXPECT_EQ(Out(named), "");
  EXPECT_TRUE(Waits("15SEP98.d"));
  EXPECT_FALSE(Waits("16SEP98.d"));
  named.back() = "17SEP98.d";
  const ProgramResult missing = Run(named);
  EXPECT_EQ(missing.code, 1);
  EXPECT_EQ(missing.err, "[Update] File does not exist\n17SEP98.d\n");
  named.back() = "";
  const ProgramResult empty = Run(named);
  EXPECT_EQ(empty.code, 1);
  EXPECT_EQ(empty.err, "[Update] File does not exist\n\n");
  EXPECT_TRUE(Waits("15SEP98.d"));
  named.back() = "--all";
  named.push_back("16SEP98.d");
  EXPECT_EQ(Run(named).code, 2);
}

// What was left out is told, and shows in the exit status; what was misread is told alone.
TEST_F(UpdateCommand, ADayThatWasTakenInPartEndsWithOne) {
  ASSERT_EQ(Run({"init"}).code, 0);
  const Words words{"--set", "Download.InternetDLfmt=DDMMMYY.D", "update"};
  Download("15SEP98.d", "ORE,19980915,1,1,1,x,1,0\n");
  const ProgramResult misread = Run(words);
  EXPECT_EQ(misread.code, 0);
  EXPECT_EQ(misread.err,
            "[Data Update] Not everything was taken in as it stands:\n15SEP98.d\n"
            " line 1, ORE: Close \"x\" read as 0\n");
  home.Put("kora/drive_c/korawin/data/ORE.WDT", std::string(50 * 32767, ' '));
  Download("16SEP98.d", "ORE,19980916,1,1,1,1,1,0\nZAP,19980916,1,1,1,1,1,0\n");
  const ProgramResult part = Run(words);
  EXPECT_EQ(part.code, 1);
  EXPECT_EQ(part.err,
            "[Data Update] Not everything was taken in as it stands:\n16SEP98.d\n"
            " left out: ORE: its price file is full, with 32767 days\n");
  EXPECT_FALSE(Waits("16SEP98.d"));
}

TEST_F(UpdateCommand, CancelAtTheDateLeavesEveryFile) {
  ASSERT_EQ(Run({"demo"}).code, 0);
  const std::string first = Cells(Out({"downloads"})).at(1).at(0);
  const std::string text = home.Get("kora/" + kDown + first);
  ASSERT_EQ(Run({"update", first}).code, 0);
  Download(first, text);
  const auto before = AllFiles();
  const ProgramResult result = Run({"--answer", "cancel", "update", first});
  EXPECT_EQ(result.code, 1);
  EXPECT_EQ(result.err,
            "[c:\\korawin\\data\\]  There is already data on file with this date\n"
            "  New data will replace the old data\n");
  EXPECT_EQ(AllFiles(), before);
  EXPECT_EQ(Run({"--answer", "ok", "update", first}).code, 0);
}

TEST_F(UpdateCommand, AHostileFileChangesNothing) {
  ASSERT_EQ(Run({"demo"}).code, 0);
  const std::string first = Cells(Out({"downloads"})).at(1).at(0);
  Download(first, home.Get("kora/" + kDown + first) + "../../X,20261102,1,1,1,1,1,0\r\n");
  const auto before = AllFiles();
  const ProgramResult result = Run({"update", first});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("[Download Data Update] " + first), std::string::npos) << result.err;
  EXPECT_NE(result.err.find("../../X,20261102"), std::string::npos) << result.err;
  EXPECT_EQ(AllFiles(), before);
}

// Real prices: forty daily files taken in one by one give the files and the charts that one
// import of the same rows gives.
TEST_F(UpdateCommand, FortyRealDaysComeOutAsAnImportOfTheSameRows) {
  if (!fs::is_directory(kora::DataDir())) GTEST_SKIP() << "no real prices here";
  const std::vector<Words> groups{
      {"AAPL", "ORCL", "SPY"}, {"INDX", "AAPL", "ORCL"}, {"INTC", "ORCL"}};
  for (const Words& codes : groups) {
    const std::string out = home.path() + "/daily" + codes[0];
    Words words{out, "40"}, old{"import"}, all{"import"};
    for (const std::string& code : codes) {
      words.push_back(kora::DataDir() + "/" + code + ".csv");
      old.push_back(out + "/" + code + ".csv");
      all.push_back(out + "/all/" + code + ".csv");
    }
    const ProgramResult script = RunProgram(kora::SourceDir() + "/tests/daily_files.sh", words);
    ASSERT_EQ(script.code, 0) << script.err;
    const std::string one = codes[0] + "1", two = codes[0] + "2";
    ASSERT_EQ(Run({"init"}, one).code, 0);
    ASSERT_EQ(Run({"init"}, two).code, 0);
    ASSERT_EQ(Run(old, one).code, 0);
    ASSERT_EQ(Run(all, two).code, 0);
    int days = 0;
    for (const auto& e : fs::directory_iterator(out))
      if (e.path().extension() == ".d") {
        fs::copy(e.path(), home.path() + "/" + one + "/" + kDown);
        ++days;
      }
    ASSERT_EQ(days, 40);
    const Words set{"--set", "Download.InternetDLfmt=DDMMMYY.D"};
    const auto with = [&set](const Words& tail) {
      Words w = set;
      w.insert(w.end(), tail.begin(), tail.end());
      return w;
    };
    EXPECT_EQ(Cells(Out(with({"downloads"}), one)).size(), 41u);
    const ProgramResult update = Run(with({"update", "--all"}), one);
    EXPECT_EQ(update.code, 0) << update.err;
    EXPECT_EQ(update.err, "");
    for (const std::string& code : codes) {
      const std::string wdt = "/drive_c/korawin/data/" + code + ".WDT";
      EXPECT_TRUE(home.Get(one + wdt) == home.Get(two + wdt)) << code;
      EXPECT_GT(home.Get(one + wdt).size(), 40u * 50) << code;
      EXPECT_EQ(Out({"prices", code}, one), Out({"prices", code}, two)) << code;
      for (const char* period : {"A", "W"}) {
        const Words bars{"bars", code, "--period", period};
        EXPECT_EQ(Out(bars, one), Out(bars, two)) << code;
      }
      const std::string drawn = Out({"chart", code, "--out", "-"}, one);
      EXPECT_GT(drawn.size(), 5000u) << code;
      EXPECT_EQ(drawn, Out({"chart", code, "--out", "-"}, two)) << code;
    }
  }
}

TEST_F(UpdateCommand, MakesTheMasterList) {
  ASSERT_EQ(Run({"init"}).code, 0);
  home.Put("list.csv",
           "Code,Type,Category,Class,Name,Details\nORE,4,1,121,Ore Ltd,\nBHP,4,1,,Big,\n");
  EXPECT_EQ(Out({"master", home.path() + "/list.csv"}), "2 securities\n");
  EXPECT_EQ(home.Get("kora/drive_c/korawin/KoraName.Mas").size(), 124u);
  home.Put("list.csv", "../X,4,1,121,Ore Ltd,\n");
  const auto before = AllFiles();
  const ProgramResult result = Run({"master", home.path() + "/list.csv"});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("list.csv line 1: "), std::string::npos) << result.err;
  EXPECT_EQ(AllFiles(), before);
}

// A process that is killed in the middle leaves whole records and its file on the list, and
// the next run brings what an undisturbed one does.
TEST_F(UpdateCommand, TakesUpAgainAfterAKilledProcess) {
  constexpr int kSecurities = 1500;
  ASSERT_EQ(Run({"init"}).code, 0);
  std::string history, day;
  const auto code = [](int n) { return "C" + std::to_string(1000 + n); };
  for (int n = 0; n < kSecurities; ++n) {
    const std::string tail = ",1,2,1,1." + std::to_string(n) + "," + std::to_string(n) + ",";
    if (n % 3 != 2)  // each third is new
      history += code(n) + ",19980911" + tail + "0\n" + code(n) + ",19980914" + tail + "0\n";
    day += code(n) + ",19980915" + tail + (n % 5 == 0 ? "77" : "0") + "\r\n";
  }
  home.Put("history.csv", history);
  ASSERT_EQ(Run({"import", home.path() + "/history.csv"}).code, 0);
  Download("15SEP98.d", day);
  const std::string root = home.path() + "/";
  fs::copy(root + "kora", root + "whole", fs::copy_options::recursive);
  const Words update{"--set", "Download.InternetDLfmt=DDMMMYY.D", "update"};
  ASSERT_EQ(Run(update, "whole").code, 0);

  const std::string data = "kora/drive_c/korawin/data/";
  const std::string middle = root + data + code(kSecurities / 2) + ".WDT";
  Words words{"--home", root + "kora"};
  words.insert(words.end(), update.begin(), update.end());
  const std::uintmax_t size = fs::file_size(middle);
  std::error_code ignored;
  const ProgramResult cut = RunProgram(kora::BinDir() + "/koractl", words, {},
                                       [&] { return fs::file_size(middle, ignored) != size; });
  if (cut.code == 0) GTEST_SKIP() << "it was done before it could be killed";
  ASSERT_EQ(cut.code, 128 + 9);
  ASSERT_TRUE(Waits("15SEP98.d"));
  for (const auto& e : fs::directory_iterator(root + data))
    if (e.path().extension() == ".WDT") {
      EXPECT_EQ(e.file_size() % 50, 0u) << e.path();
    }
  EXPECT_EQ(home.Get(data + "Names.dat").size() % 96, 0u);

  const ProgramResult again = Run(update);
  EXPECT_EQ(again.code, 0) << again.err;
  for (const auto& e : fs::directory_iterator(root + "whole/drive_c/korawin/data")) {
    const std::string name = e.path().filename().string();
    EXPECT_TRUE(home.Get(data + name) == home.Get("whole/drive_c/korawin/data/" + name)) << name;
  }
}
