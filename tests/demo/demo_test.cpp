#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <map>
#include <set>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "demo/calendar.h"
#include "demo/demo_market.h"
#include "demo/market.h"
#include "looks/colours.h"
#include "settings/settings.h"
#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/failing_io.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::FailingIo;
using test::ScriptedDialogs;
using test::TempHome;

const std::string kData = "c:\\korawin\\data\\";

bool Make(TempHome& home, Dialogs& dialogs, const DemoOptions& options = {}) {
  SettingsFile ini(home.files(), "c:\\windows\\Kora.ini");
  SettingsFile user(home.files(), "c:\\windows\\KoraUser.ini");
  return MakeDemo(home.files(), ini, user, dialogs, options);
}

bool Make(TempHome& home, const DemoOptions& options = {}) {
  ScriptedDialogs dialogs;
  return Make(home, dialogs, options);
}

// Without the file of the lock, which stays behind: another program may wait at it.
std::vector<std::string> FilesOf(const TempHome& home) {
  std::vector<std::string> names;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(home.path()))
    if (entry.is_regular_file() && entry.path().filename() != "Kora.lock")
      names.push_back(std::filesystem::relative(entry.path(), home.path()).generic_string());
  std::sort(names.begin(), names.end());
  return names;
}

// 64-bit FNV-1a over the names and bytes of all files of a home.
std::uint64_t HashOf(const TempHome& home) {
  std::uint64_t hash = 14695981039346656037u;
  const auto add = [&hash](const std::string& bytes) {
    for (const char c : bytes) hash = (hash ^ static_cast<unsigned char>(c)) * 1099511628211u;
    hash = (hash ^ 0x100) * 1099511628211u;
  };
  for (const std::string& name : FilesOf(home)) {
    add(name);
    add(home.Get(name));
  }
  return hash;
}

// A price record out of its packed form, whose fields can't be referred to.
struct Day {
  explicit Day(const PriceRec& r)
      : date(r.RecDate.raw()),
        Open(r.Open),
        High(r.High),
        Low(r.Low),
        Close(r.Close),
        Volume(r.Volume),
        AdjFactor(r.AdjFactor),
        AdjDesc(r.AdjDesc.trimmed()),
        RecSpare(r.RecSpare.raw()) {}
  std::string date;
  float Open, High, Low, Close;
  std::int32_t Volume;
  float AdjFactor;
  std::string AdjDesc, RecSpare;
};

struct Security {
  NameRec name;
  std::vector<Day> records;
  std::string code() const { return std::string(name.Code.trimmed()); }
};

// A market that was made, read back.
struct Market {
  explicit Market(const DemoOptions& options) {
    made = Make(home, options);
    for (const NameRec& rec : ReadNames(home.files(), kData)) {
      const std::string path = kData + CodeFileName(rec.Code.raw(), ".WDT");
      const std::vector<PriceRec> records = PriceFile(home.files(), path).ReadAll();
      all.push_back({rec, {records.begin(), records.end()}});
    }
  }
  const Security& operator[](const std::string& code) const {
    for (const Security& s : all)
      if (s.code() == code) return s;
    throw std::runtime_error("no " + code);
  }
  mutable TempHome home;
  bool made = false;
  std::vector<Security> all;
};

// Ordinary shares: dollars, no warrants or options.
bool IsOrdinary(const Security& s) { return s.name.RecType == kShare && s.code().size() == 3; }

// In thousandths, a whole number of steps, and the very float of that number.
bool FitsTick(float price) {
  const long n = std::lround(double(price) * 1000);
  const long tick = n < 100 ? 1 : n < 2000 ? 5 : 10;
  return n > 0 && n % tick == 0 && price == float(double(n) / 1000);
}

bool HasDecimals(float price, double unit) {
  return price == float(std::round(double(price) * unit) / unit);
}

std::vector<std::string> Lines(const std::string& text) {
  std::vector<std::string> lines;
  LineReader reader(text);
  std::string_view line;
  while (reader.Next(line)) lines.emplace_back(line);
  return lines;
}

std::string Show(const DemoOptions& o) {
  return Str(std::int32_t(o.securities)) + " x " + Str(std::int32_t(o.years)) + " seed " +
         Str(std::int32_t(o.seed));
}

const std::vector<DemoOptions> kMarkets = {
    {60, 6, 1}, {5, 1, 2}, {10, 2, 3}, {300, 3, 4}, {60, 20, 5}};

TEST(Demo, TheSameSeedGivesTheSameBytesInAnyHome) {
  TempHome first, second;
  ASSERT_TRUE(Make(first));
  ASSERT_TRUE(Make(second));
  EXPECT_EQ(FilesOf(first), FilesOf(second));
  EXPECT_EQ(HashOf(first), HashOf(second));
  // For comparing two machines.
  RecordProperty("hash", std::to_string(HashOf(first)));
}

TEST(Demo, AnotherSeedGivesAnotherMarket) {
  TempHome first, second;
  ASSERT_TRUE(Make(first, {60, 6, 1}));
  ASSERT_TRUE(Make(second, {60, 6, 2}));
  EXPECT_NE(HashOf(first), HashOf(second));
  EXPECT_NE(first.Get("drive_c/korawin/data/XBRD.WDT"),
            second.Get("drive_c/korawin/data/XBRD.WDT"));
}

TEST(Demo, TheNameFileHoldsAsManySecuritiesAsAskedFor) {
  for (const int n : {5, 7, 8, 9, 10, 11, 60, 333}) {
    const Market market({n, 1, 1});
    EXPECT_EQ(market.all.size(), size_t(n));
    EXPECT_EQ(market.home.Get("drive_c/korawin/data/Names.dat").size(), size_t(n) * 96);
    std::set<std::string> codes;
    for (const Security& s : market.all) codes.insert(s.code());
    EXPECT_EQ(codes.size(), size_t(n));
  }
}

TEST(Demo, ThousandsOfSecuritiesHaveCodesAndNamesOfTheirOwn) {
  const Market market({5000, 1, 1});
  std::set<std::string> codes, names;
  size_t shares = 0;
  for (const Security& s : market.all) {
    codes.insert(s.code());
    if (!IsOrdinary(s)) continue;
    ++shares;
    names.insert(std::string(s.name.Name.trimmed()));
  }
  EXPECT_EQ(codes.size(), 5000u);
  EXPECT_GT(shares, 3500u);
  EXPECT_EQ(names.size(), shares);
}

TEST(Demo, FilesAreWholeRecords) {
  const Market market({60, 6, 1});
  for (const std::string& name : FilesOf(market.home)) {
    const size_t size = market.home.Get(name).size();
    if (name.ends_with(".WDT")) {
      EXPECT_EQ(size % 50, 0u) << name;
      EXPECT_GT(size, 0u) << name;
    }
    if (name.find("SubList") != std::string::npos) {
      EXPECT_EQ(size % 8, 0u) << name;
    }
  }
}

TEST(Demo, NamesAreSortedByCategoryTypeAndCode) {
  for (const DemoOptions& options : kMarkets) {
    const Market market(options);
    for (size_t i = 1; i < market.all.size(); ++i) {
      const auto key = [](const Security& s) {
        return std::make_tuple(s.name.Category, s.name.RecType, s.code());
      };
      EXPECT_LT(key(market.all[i - 1]), key(market.all[i])) << Show(options);
    }
  }
}

TEST(Demo, NameRecordsHoldWhatTheirFieldsAllow) {
  const Market market({300, 3, 4});
  std::set<std::string> classes;
  for (const std::string& line : Lines(market.home.Get("drive_c/korawin/IndClass.dat"))) {
    ASSERT_GE(line.size(), 5u);
    EXPECT_EQ(line[3], ',');
    EXPECT_EQ(std::count(line.begin(), line.end(), ','), 1) << line;
    EXPECT_TRUE(classes.insert(line.substr(0, 3)).second) << line;
  }
  EXPECT_GE(classes.size(), 25u);
  for (const std::string& id : classes) EXPECT_TRUE(classes.count(id.substr(0, 2) + "0")) << id;
  for (const Security& s : market.all) {
    EXPECT_EQ(s.name.NameStatus, 0);
    EXPECT_TRUE(IsFileCode(s.code())) << s.code();
    EXPECT_FALSE(s.name.Name.trimmed().empty()) << s.code();
    EXPECT_EQ(s.name.Name.raw().find(','), std::string_view::npos);
    EXPECT_EQ(s.name.OtherDetails.raw().find(','), std::string_view::npos);
    EXPECT_EQ(s.name.MinMove, 0.05f);
    EXPECT_TRUE(s.name.RecType >= 1 && s.name.RecType <= 5);
    EXPECT_TRUE(s.name.Category >= 0 && s.name.Category <= 99);
    const std::string industry(s.name.IndClass.trimmed());
    // Warrants and options have none: it can be taken from their share.
    EXPECT_EQ(industry.empty(), s.code().size() > 4) << s.code();
    EXPECT_TRUE(industry.empty() || classes.count(industry)) << s.code() << industry;
    EXPECT_LE(s.name.Base, s.name.Top);
  }
  const auto some = [&market](auto test) {
    return std::any_of(market.all.begin(), market.all.end(), test);
  };
  EXPECT_TRUE(some([](const Security& s) { return s.name.Top > 0; }));
  EXPECT_TRUE(some([](const Security& s) { return s.name.PFInc > 0; }));
  EXPECT_TRUE(some([](const Security& s) { return s.name.BandUp > 0 && s.name.BandDown > 0; }));
  EXPECT_TRUE(some([](const Security& s) { return !s.name.OtherDetails.trimmed().empty(); }));
}

TEST(Demo, EveryKindOfDataIsThere) {
  const Market market({60, 6, 1});
  std::map<std::int16_t, int> types;
  int warrants = 0, options = 0;
  for (const Security& s : market.all) {
    ++types[s.name.RecType];
    const std::string code = s.code();
    if (s.name.Category >= 80 && s.name.Category <= 89) {
      ++warrants;
      ASSERT_EQ(code.size(), 6u);
      EXPECT_EQ(s.name.Category, code[3] == 'W' ? 84 : code[3] == 'E' ? 86 : 87) << code;
      EXPECT_NO_THROW(market[code.substr(0, 3)]) << code;
    }
    if (s.name.OtherDetails.raw().substr(0, 2) == "0C" ||
        s.name.OtherDetails.raw().substr(0, 2) == "0P")
      ++options;
  }
  for (std::int16_t type = 1; type <= 5; ++type) EXPECT_GT(types[type], 0) << type;
  EXPECT_EQ(warrants, 5);
  EXPECT_EQ(options, 3);
  EXPECT_EQ(types[kIndex], 7);
}

TEST(Demo, DatesAscendOverTradingDaysOnly) {
  for (const DemoOptions& options : kMarkets) {
    const Market market(options);
    for (const Security& s : market.all) {
      std::string last;
      for (const Day& rec : s.records) {
        const std::string& date = rec.date;
        const auto calendar = ParseFileDate(date);
        ASSERT_TRUE(calendar) << s.code();
        ASSERT_TRUE(demo::IsTradingDay(*calendar)) << s.code() << " " << date;
        ASSERT_LT(last, date) << s.code();
        last = date;
      }
      ASSERT_LE(last, "20261030");
    }
    EXPECT_EQ(market["XBRD"].records.back().date, "20261030");
    const std::string year = Str(std::int32_t(2026 - options.years));
    EXPECT_EQ(market["XBRD"].records.front().date.substr(0, 4), year);
  }
}

TEST(Demo, OpenAndCloseLieBetweenLowAndHigh) {
  for (const DemoOptions& options : kMarkets) {
    const Market market(options);
    for (const Security& s : market.all) {
      for (const Day& rec : s.records) {
        ASSERT_GT(rec.Close, 0) << s.code();
        ASSERT_GE(rec.Volume, 0) << s.code();
        ASSERT_EQ(rec.RecSpare, "    ");
        ASSERT_EQ(rec.AdjFactor == 0, rec.AdjDesc.empty()) << s.code();
        if (s.name.RecType == kAdvanceDecline) continue;
        if (rec.High == 0) {  // the close alone is known
          ASSERT_EQ(s.name.RecType, kShare);
          ASSERT_EQ(rec.Open, 0);
          ASSERT_EQ(rec.Low, 0);
          continue;
        }
        ASSERT_LE(rec.Low, std::min(rec.Open, rec.Close)) << s.code() << rec.date;
        ASSERT_GE(rec.High, std::max(rec.Open, rec.Close)) << s.code() << rec.date;
        ASSERT_GT(rec.Low, 0) << s.code();
        if (s.name.RecType <= kCloseOnly) {
          ASSERT_EQ(rec.Open, rec.Close);
          ASSERT_EQ(rec.High, rec.Low);
        }
        ASSERT_TRUE(s.name.RecType != kCloseOnly || rec.Volume == 0) << s.code();
      }
    }
  }
}

TEST(Demo, PricesFitTheirTickAfterTheLastAdjustmentAndFourDecimalsBefore) {
  for (const DemoOptions& options : kMarkets) {
    const Market market(options);
    for (const Security& s : market.all) {
      size_t inNewTerms = 0;
      for (size_t i = 0; i < s.records.size(); ++i)
        if (s.records[i].AdjFactor != 0) inNewTerms = i + 1;
      for (size_t i = 0; i < s.records.size(); ++i) {
        const Day& rec = s.records[i];
        for (const float price : {rec.Open, rec.High, rec.Low, rec.Close}) {
          if (price == 0 || s.name.RecType == kAdvanceDecline) continue;
          const bool fits = s.name.RecType == kIndex       ? HasDecimals(price, 10)
                            : s.name.RecType == kCloseOnly ? HasDecimals(price, 100)
                            : i >= inNewTerms              ? FitsTick(price)
                                                           : HasDecimals(price, 10000);
          ASSERT_TRUE(fits) << s.code() << " " << rec.date << " " << price;
        }
      }
    }
  }
}

TEST(Demo, AdjustmentsAreMarkedAndThePricesBeforeThemRescaled) {
  const Market market({60, 6, 1});
  std::set<std::string> kinds;
  for (const Security& s : market.all) {
    double after = 1;  // product of the factors after the record
    for (size_t i = s.records.size(); i-- > 0;) {
      const Day& rec = s.records[i];
      if (rec.AdjFactor == 0) continue;
      after *= double(rec.AdjFactor);
      ASSERT_LT(i + 1, s.records.size()) << s.code();
      const std::string& text = rec.AdjDesc;
      ASSERT_GE(text.size(), 5u);
      kinds.insert(text.substr(0, 2));
      const double first = Val(text.substr(2));
      const double second = Val(text.substr(text.find(':') + 1));
      double factor = 0;
      if (text[0] == 'b') factor = second / (first + second);
      if (text[0] == 's') factor = second / first;
      if (text[0] == 'c') {
        const double cost = Val(text.substr(text.find('@') + 1));
        const double close = double(rec.Close) / after;  // as it was traded
        const double worth = (cost * first + second * close) / (first + second);
        factor = 1 - (close - worth) / close;
      }
      // Six decimals are kept; the price that a cash issue was made at is known to about 1/1000.
      EXPECT_NEAR(rec.AdjFactor, factor, text[0] == 'c' ? 1e-3 : 6e-7) << s.code() << text;
      // Across the mark the price moves as on any other day.
      const double move = double(s.records[i + 1].Close) / double(rec.Close);
      EXPECT_GT(move, 0.6) << s.code() << text;
      EXPECT_LT(move, 1.6) << s.code() << text;
    }
  }
  EXPECT_EQ(kinds, (std::set<std::string>{"bi", "ci", "ss"}));
}

TEST(Demo, TheCumulativeTotalRunsOverRisesAndFallsOfTheShares) {
  for (const DemoOptions& options : {DemoOptions{60, 6, 1}, DemoOptions{300, 2, 9}}) {
    const Market market(options);
    std::map<std::string, int> rises, falls;
    for (const Security& s : market.all) {
      if (!IsOrdinary(s)) continue;
      for (size_t i = 1; i < s.records.size(); ++i) {
        const std::string& date = s.records[i].date;
        if (s.records[i].Close > s.records[i - 1].Close) ++rises[date];
        if (s.records[i].Close < s.records[i - 1].Close) ++falls[date];
      }
    }
    const std::vector<Day>& series = market["ADVD"].records;
    ASSERT_EQ(series.size(), market["XBRD"].records.size());
    double total = double(series[0].Close);
    EXPECT_EQ(std::fmod(total, 1000), 0);
    EXPECT_EQ(series[0].High, 0);
    for (size_t i = 1; i < series.size(); ++i) {
      const std::string& date = series[i].date;
      ASSERT_EQ(series[i].High, rises[date]) << date;
      ASSERT_EQ(series[i].Low, falls[date]) << date;
      total += rises[date] - falls[date];
      ASSERT_EQ(series[i].Close, total) << date;
    }
  }
}

TEST(Demo, SharesHaltFloatAndStop) {
  const Market market({60, 6, 1});
  const std::vector<Day>& days = market["XBRD"].records;
  int halts = 0, closeOnly = 0, floats = 0, stopped = 0;
  for (const Security& s : market.all) {
    if (!IsOrdinary(s)) continue;
    int flat = 0;
    for (size_t i = 1; i < s.records.size(); ++i) {
      const Day& rec = s.records[i];
      if (rec.High == 0) ++closeOnly;
      const bool same = rec.Volume == 0 && rec.High == rec.Low && rec.High == rec.Close &&
                        rec.Close == s.records[i - 1].Close;
      flat = same ? flat + 1 : 0;
      if (flat == 2) ++halts;
    }
    if (s.records.front().date > days.front().date) ++floats;
    if (s.records.back().date < days.back().date) {
      ++stopped;
      EXPECT_EQ(s.name.Category, 98);  // out of the reach of flat records
    }
  }
  EXPECT_GT(halts, 5);
  EXPECT_GT(closeOnly, 5);
  EXPECT_GT(floats, 0);
  EXPECT_GT(stopped, 0);
}

TEST(Demo, OptionsEndAtTheirExpiry) {
  const Market market({300, 3, 4});
  int live = 0, lapsed = 0;
  for (const Security& s : market.all) {
    const std::string details(s.name.OtherDetails.trimmed());
    if (details.substr(0, 2) != "0C" && details.substr(0, 2) != "0P") continue;
    const auto expiry = ParseUserDate(details.substr(2));
    ASSERT_TRUE(expiry) << details;
    const bool over = FormatFileDate(*expiry) <= "20261030";
    EXPECT_EQ(s.name.Name.trimmed() == "**EXPIRED**", over) << s.code();
    if (over) {
      ++lapsed;
      // The last trading day not after the expiry.
      CalendarDate day = *expiry;
      while (!demo::IsTradingDay(day)) day = DateOfDayNumber(DayNumber(day) - 1);
      EXPECT_EQ(s.records.back().date, FormatFileDate(day)) << s.code();
    } else {
      ++live;
      EXPECT_EQ(s.records.back().date, "20261030") << s.code();
    }
  }
  EXPECT_GT(live, 0);
  EXPECT_GT(lapsed, 0);
}

TEST(Demo, LargeMovesBringVolume) {
  const Market market({60, 6, 1});
  double quiet = 0, loud = 0;
  int quietDays = 0, loudDays = 0;
  const std::vector<Day>& r = market.all[0].records;
  ASSERT_EQ(market.all[0].name.Category, 1);
  std::vector<double> moves;
  for (size_t i = 1; i < r.size(); ++i)
    moves.push_back(std::fabs(double(r[i].Close) / double(r[i - 1].Close) - 1));
  std::vector<double> sorted = moves;
  std::sort(sorted.begin(), sorted.end());
  for (size_t i = 1; i < r.size(); ++i) {
    if (moves[i - 1] <= sorted[sorted.size() / 2]) quiet += r[i].Volume, ++quietDays;
    if (moves[i - 1] >= sorted[sorted.size() * 9 / 10]) loud += r[i].Volume, ++loudDays;
  }
  EXPECT_GT(loud / loudDays, 1.5 * quiet / quietDays);
}

TEST(Demo, ListsHoldTheRecordNumbersOfTheirCodes) {
  for (const DemoOptions& options : kMarkets) {
    const Market market(options);
    for (const char* list : {"SubListA.Dat", "SubListB.Dat"}) {
      const std::string bytes = market.home.Get(std::string("drive_c/korawin/data/") + list);
      ASSERT_GE(bytes.size(), 16u) << Show(options) << list;
      for (size_t at = 0; at < bytes.size(); at += 8) {
        const size_t number = static_cast<unsigned char>(bytes[at]) +
                              256u * static_cast<unsigned char>(bytes[at + 1]);
        ASSERT_TRUE(number >= 1 && number <= market.all.size());
        EXPECT_EQ(market.all[number - 1].name.Code.raw(), bytes.substr(at + 2, 6));
      }
    }
  }
}

TEST(Demo, SettingsLeadToTheFiles) {
  TempHome home;
  ASSERT_TRUE(Make(home));
  SettingsFile ini(home.files(), "c:\\windows\\Kora.ini");
  SettingsFile user(home.files(), "c:\\windows\\KoraUser.ini");
  ScriptedDialogs dialogs;
  Settings settings;
  ASSERT_TRUE(ReadSettings(ini, home.files(), dialogs, settings));
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_TRUE(EqualNoCase(settings.paths.CurrentDataPath, kData));
  EXPECT_EQ(settings.download.DataService, 1);
  EXPECT_TRUE(home.files().IsFolder(settings.download.DLPath));
  EXPECT_EQ(UCase(settings.download.InternetDLfmt), "DDMMMYY.D");
  EXPECT_EQ(settings.download.VolumeDivisor, 1);
  const std::string compare = ini.GetSetting("OscDef", "CompFile");
  EXPECT_TRUE(compare.ends_with("\\XBRD.WDT")) << compare;
  EXPECT_TRUE(home.files().CheckFile(compare));
  EXPECT_EQ(user.GetSetting("KORA Charting System", "SubListA"), "Leaders");
  EXPECT_EQ(user.GetSetting("KORA Charting System", "SubListB"), "Other shares");
  for (const char* folder : {"chtmisc", "chtsave", "download", "backup"})
    EXPECT_TRUE(home.files().IsFolder(std::string("c:\\korawin\\") + folder)) << folder;
  const PrinterColours printer = ReadPrinterColours(home.files(), "c:\\korawin\\");
  EXPECT_TRUE(printer.asked);
  EXPECT_EQ(printer.ColourPrinter, 1);
}

TEST(Demo, BulletinsOfThreeDaysHaveEveryKindOfEvent) {
  const Market market(kMarkets[0]);
  std::set<std::string> acts, codes;
  for (const Security& s : market.all) codes.insert(s.code());
  for (const char* day : {"02NOV26", "03NOV26", "04NOV26"})
    for (const std::string& line :
         Lines(market.home.Get("drive_c/korawin/download/in/" + std::string(day) + ".Asx.Btn"))) {
      const auto fields = Split(line, ',');
      ASSERT_GE(fields.size(), 6u) << line;
      acts.emplace(fields[0]);
      EXPECT_TRUE(codes.contains(std::string(fields[1]))) << line;
    }
  EXPECT_EQ(acts, (std::set<std::string>{"BI", "DC", "DI", "EN", "NC", "NI", "NL", "PC", "SP"}));
}

// With the service that the demo market starts with, the update itself fills the list.
TEST(Demo, TheBulletinOfItsServiceHasThemAll) {
  const Market market(kMarkets[0]);
  const std::string in = "drive_c/korawin/download/in/";
  std::string all;
  for (const char* day : {"02NOV26", "03NOV26", "04NOV26"})
    all += market.home.Get(in + day + ".Asx.Btn");
  EXPECT_EQ(market.home.Get(in + ".Asx.Btn"), all);
}

TEST(Demo, ThreeDaysOfDownloadsCoverTheWholeMarket) {
  for (const DemoOptions& options : kMarkets) {
    const Market market(options);
    EXPECT_EQ(market.home.files().List("c:\\korawin\\download"),
              (std::vector<std::string>{"02NOV26.d", "03NOV26.d", "04NOV26.d", "in", "out"}));
    std::map<std::string, double> totals;  // of the advance/decline series
    for (const Security& s : market.all)
      if (s.name.RecType == kAdvanceDecline) totals[s.code()] = double(s.records.back().Close);
    for (int day = 2; day <= 4; ++day) {
      const std::string digit = Str(std::int32_t(day));
      const std::string date = "2026110" + digit;
      std::set<std::string> codes;
      for (const std::string& line :
           Lines(market.home.Get("drive_c/korawin/download/0" + digit + "NOV26.d"))) {
        const std::vector<std::string_view> f = Split(line, ',');
        ASSERT_EQ(f.size(), 8u) << line;
        const Security& s = market[std::string(f[0])];
        EXPECT_TRUE(codes.insert(s.code()).second) << line;
        EXPECT_EQ(f[1], date);
        EXPECT_EQ(f[7], "0");
        const double open = Val(f[2]), high = Val(f[3]), low = Val(f[4]), close = Val(f[5]);
        if (s.name.RecType == kAdvanceDecline) {
          EXPECT_EQ(close, totals[s.code()] + high - low);
          totals[s.code()] = close;
        } else if (high != 0) {
          EXPECT_LE(low, std::min(open, close)) << line;
          EXPECT_GE(high, std::max(open, close)) << line;
        }
        EXPECT_TRUE(s.name.RecType != kShare || FitsTick(float(close))) << line;
        EXPECT_GT(close, 0) << line;
      }
      for (const Security& s : market.all) {
        const bool quoted = s.records.back().date == "20261030";
        EXPECT_EQ(codes.count(s.code()) > 0, quoted) << s.code();
      }
      EXPECT_GE(codes.size() * 10, market.all.size() * 8) << Show(options);
    }
  }
}

TEST(Demo, AHomeInUseIsRefusedBeforeAnythingIsWritten) {
  for (const char* file :
       {"Kora.ini", "drive_c/korawin/data/Names.dat", "drive_c/korawin/data/ABC.wdt"}) {
    TempHome home;
    home.Put(file, "mine");
    const std::uint64_t before = HashOf(home);
    try {
      Make(home);
      FAIL() << file;
    } catch (const RunTimeError& e) {
      EXPECT_EQ(e.number(), kPathAccess);
      EXPECT_NE(std::string(e.what()).find("there is an installation in this home already"),
                std::string::npos);
    }
    EXPECT_EQ(HashOf(home), before);
    EXPECT_EQ(FilesOf(home), (std::vector<std::string>{file}));
  }
}

TEST(Demo, OptionsOutOfRangeAreRefused) {
  for (const DemoOptions& options :
       {DemoOptions{4, 6, 1}, DemoOptions{5001, 6, 1}, DemoOptions{60, 0, 1},
        DemoOptions{60, 41, 1}, DemoOptions{-1, -1, 1}}) {
    TempHome home;
    try {
      Make(home, options);
      FAIL() << Show(options);
    } catch (const RunTimeError& e) {
      EXPECT_EQ(e.number(), kBadCall);
    }
    EXPECT_TRUE(FilesOf(home).empty());
  }
}

TEST(Demo, AFullDiskAtAnyWriteLeavesNoMarketBehind) {
  int failures = 0;
  for (int at = 1;; ++at) {
    FailingIo io;
    TempHome home(io);
    io.Reset(at);
    bool made = false;
    try {
      made = Make(home, {5, 1, 1});
    } catch (const RunTimeError& e) {
      EXPECT_TRUE(e.number() == kDiskFull || e.number() == kPathAccess) << e.number();
      EXPECT_TRUE(FilesOf(home).empty()) << at << " " << FilesOf(home).front();
      ++failures;
    }
    const bool past = io.calls < at;
    io.Reset();
    if (made) {
      // List names apart, which are passed over when they can't be kept, all is there.
      EXPECT_EQ(ReadNames(home.files(), kData).size(), 5u) << at;
      EXPECT_TRUE(home.Exists("Kora.ini")) << at;
    }
    if (past) break;
  }
  EXPECT_GT(failures, 20);
}

TEST(Demo, AStopByTheUserLeavesNoMarketBehind) {
  struct Stopping : ScriptedDialogs {
    struct After : Progress {
      bool Step(int done, int total) override {
        EXPECT_EQ(total, 60);
        return done < 20;
      }
    };
    std::unique_ptr<Progress> StartProgress(std::string_view) override {
      return std::make_unique<After>();
    }
  } dialogs;
  TempHome home;
  EXPECT_FALSE(Make(home, dialogs));
  EXPECT_TRUE(FilesOf(home).empty());
}

TEST(DemoCalendar, HolidaysAreNoTradingDays) {
  const auto trades = [](int year, int month, int day) {
    return demo::IsTradingDay({year, month, day});
  };
  EXPECT_FALSE(trades(2026, 1, 1));
  EXPECT_TRUE(trades(2026, 1, 2));
  EXPECT_FALSE(trades(2022, 1, 3));  // for Saturday, 1 January
  EXPECT_FALSE(trades(2023, 1, 2));  // for Sunday, 1 January
  EXPECT_FALSE(trades(2026, 1, 26));
  EXPECT_FALSE(trades(2025, 1, 27));  // for Sunday, 26 January
  EXPECT_TRUE(trades(2026, 1, 27));
  EXPECT_FALSE(trades(2026, 4, 3));  // Good Friday
  EXPECT_FALSE(trades(2026, 4, 6));
  EXPECT_TRUE(trades(2026, 4, 7));
  EXPECT_FALSE(trades(2024, 3, 29));  // Good Friday in March
  EXPECT_FALSE(trades(2024, 4, 1));
  EXPECT_FALSE(trades(2000, 4, 21));
  EXPECT_FALSE(trades(1987, 4, 17));
  EXPECT_FALSE(trades(2024, 4, 25));
  EXPECT_TRUE(trades(2021, 4, 26));  // 25 April on a Sunday is not made up for
  EXPECT_FALSE(trades(2026, 6, 8));  // second Monday
  EXPECT_TRUE(trades(2026, 6, 1));
  EXPECT_TRUE(trades(2026, 6, 15));
  EXPECT_TRUE(trades(2026, 12, 24));
  EXPECT_FALSE(trades(2026, 12, 25));
  EXPECT_FALSE(trades(2026, 12, 28));  // for Saturday, 26 December
  EXPECT_TRUE(trades(2026, 12, 29));
  EXPECT_FALSE(trades(2021, 12, 27));  // for Saturday and Sunday
  EXPECT_FALSE(trades(2021, 12, 28));
  EXPECT_TRUE(trades(2021, 12, 29));
  EXPECT_FALSE(trades(2022, 12, 27));  // for Sunday, 25 December
  EXPECT_TRUE(trades(2022, 12, 28));
  EXPECT_FALSE(trades(2026, 10, 31));  // Saturday
  EXPECT_FALSE(trades(2026, 11, 1));
}

TEST(DemoCalendar, TheDaysAfterTheHistorySkipTheWeekend) {
  const std::vector<CalendarDate> days = demo::NextTradingDays({2026, 10, 30}, 3);
  ASSERT_EQ(days.size(), 3u);
  EXPECT_EQ(days[0], (CalendarDate{2026, 11, 2}));
  EXPECT_EQ(days[2], (CalendarDate{2026, 11, 4}));
}

TEST(DemoTicks, AStepGrowsWithThePrice) {
  EXPECT_EQ(demo::ToThousandths(0.0494), 49);
  EXPECT_EQ(demo::ToThousandths(0.0996), 100);
  EXPECT_EQ(demo::ToThousandths(0.1019), 100);
  EXPECT_EQ(demo::ToThousandths(0.1030), 105);
  EXPECT_EQ(demo::ToThousandths(1.9960), 1995);
  EXPECT_EQ(demo::ToThousandths(2.0140), 2010);
  EXPECT_EQ(demo::ToThousandths(0.0001), 1);
  EXPECT_EQ(demo::FromThousandths(2010), 2.01f);
}

TEST(DemoRandom, DrawsAreEvenlySpreadAndBellShaped) {
  demo::Random random(7, 9);
  double sum = 0, squares = 0, units = 0;
  const int n = 200000;
  for (int i = 0; i < n; ++i) {
    const double z = random.Noise();
    ASSERT_LT(std::fabs(z), 3.47);
    sum += z;
    squares += z * z;
    const double u = random.Unit();
    ASSERT_TRUE(u >= 0 && u < 1);
    units += u;
  }
  EXPECT_NEAR(sum / n, 0, 0.01);
  EXPECT_NEAR(squares / n, 1, 0.01);
  EXPECT_NEAR(units / n, 0.5, 0.005);
}

}  // namespace
}  // namespace kora
