// A market that takes in a year of days with their bulletins, whose list is carried out every
// Friday, beside one that is worked out here: whole numbers in place of the program's arithmetic,
// plain lists in place of its files.

#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <set>

#include "adjust/adjust_list.h"
#include "adjust/bulletins.h"
#include "adjust/make_adjustments.h"
#include "store/market_folders.h"
#include "tests/update/update_fixture.h"

namespace kora::test {
namespace {

using std::chrono::sys_days;

constexpr const char* kMonths[] = {"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                                   "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};

std::string Text(const char* format, auto... values) {
  char out[160];
  std::snprintf(out, sizeof out, format, values...);
  return out;
}

// "19980309" and "09MAR98".
std::string FileDay(sys_days day) {
  const std::chrono::year_month_day ymd(day);
  return Text("%04d%02u%02u", int(ymd.year()), unsigned(ymd.month()), unsigned(ymd.day()));
}
std::string NameOfDay(const std::string& yyyymmdd) {
  return yyyymmdd.substr(6) + kMonths[std::stoi(yyyymmdd.substr(4, 2)) - 1] + yyyymmdd.substr(2, 2);
}

// ---- Arithmetic in whole numbers

// The exact product of two floats in ten-thousandths, to the nearest, ties to even: both are
// whole numbers of 24 bits times a power of two.
std::int64_t TenThousandths(float price, float factor) {
  int priceExponent = 0, factorExponent = 0;
  const auto p = std::uint64_t(std::ldexp(std::frexp(price, &priceExponent), 24));
  const auto f = std::uint64_t(std::ldexp(std::frexp(factor, &factorExponent), 24));
  const std::uint64_t product = p * f * 10000;  // below 2 to the 62
  const int shift = 48 - priceExponent - factorExponent;
  EXPECT_TRUE(shift > 0 && shift < 62) << price << " " << factor;
  const std::uint64_t whole = product >> shift, rest = product - (whole << shift);
  const std::uint64_t half = std::uint64_t(1) << (shift - 1);
  return std::int64_t(whole + (rest > half || (rest == half && whole % 2 == 1) ? 1 : 0));
}

// The float nearest to a decimal number, by its text.
float FromTenThousandths(std::int64_t units) {
  return std::strtof(Text("%lld.%04lld", units / 10000, units % 10000).c_str(), nullptr);
}

// a / b to so many decimals; what lies on the edge between two of them is no case for this test.
std::int64_t Decimals(std::int64_t a, std::int64_t b, std::int64_t scale) {
  const std::int64_t twice = 2 * a * scale, rest = twice % (2 * b);
  EXPECT_GT(std::abs(rest - b), b / 16) << a << "/" << b;
  return twice / (2 * b) + (rest > b ? 1 : 0);
}

struct HandDay {
  std::string date;
  float prices[4];  // open, high, low, close
  std::int32_t volume = 0;
  float factor = 0;
  std::string desc;
};
using HandDays = std::vector<HandDay>;

struct HandName {
  std::string code, name, indClass;
  int recType = 4;
};

struct HandMarket {
  std::vector<HandName> names;
  std::map<std::string, HandDays> days, old;  // `old`: what was put aside
  // Notes on the charts: date and cents.
  std::map<std::string, std::vector<std::pair<std::string, std::int64_t>>> notes;

  HandName* Find(const std::string& code) {
    for (HandName& one : names)
      if (one.code == code) return &one;
    return nullptr;
  }
  void Drop(const std::string& code) {
    std::erase_if(names, [&](const HandName& one) { return one.code == code; });
  }

  void Take(const HandDay& day, const std::string& code, int recType) {
    if (!days.contains(code)) names.push_back({code, "", "", recType});
    days[code].push_back(day);
  }
  // Whoever was not traded stands where it stood.
  void Rest(const std::string& date) {
    for (const HandName& one : names) {
      HandDays& of = days[one.code];
      if (of.empty() || of.back().date >= date) continue;
      const float last = of.back().prices[3];
      of.push_back({.date = date, .prices = {last, last, last, last}, .desc = {}});
    }
  }

  // The days before the date are multiplied; the last of them carries the note.
  static size_t Before(const HandDays& of, const std::string& date) {
    size_t n = of.size();
    while (n > 0 && of[n - 1].date >= date) --n;
    return n;
  }
  void Scale(const std::string& code, const std::string& date, const std::string& factor,
             const std::string& desc) {
    HandDays& of = days.at(code);
    const size_t n = Before(of, date);
    ASSERT_GE(n, 2u);
    const float f = std::strtof(factor.c_str(), nullptr);
    for (size_t i = 0; i < n; ++i)
      for (float& price : of[i].prices) price = FromTenThousandths(TenThousandths(price, f));
    of[n - 1].factor = f;
    of[n - 1].desc = desc;
    for (auto& [at, cents] : notes[code])
      if (at <= of[n - 1].date)
        cents = (std::int64_t(std::nearbyint(double(cents * 100) * double(f))) + 50) / 100;
  }
  // a for b: b / (a + b), four decimals.
  void Issue(const std::string& code, const std::string& date, int a, int b) {
    Scale(code, date, Text("%.4f", double(Decimals(b, a + b, 10000)) / 1e4), a < 0 ? "ss" : "bi");
  }
  // 1 - amount / close, six decimals. A close is a whole number of ten-thousandths.
  void Dividend(const std::string& code, const std::string& date, std::int64_t amountUnits,
                const std::string& amount) {
    const HandDays& of = days.at(code);
    const std::int64_t close =
        std::llround(double(of[Before(of, date) - 1].prices[3]) * 10000);  // exact
    const std::int64_t millionths = Decimals(close - amountUnits, close, 1000000);
    Scale(code, date, Text("0.%06lld", millionths), "dv" + amount);
  }
  void Correct(const std::string& code, const std::string& date, const std::string& close,
               std::int32_t volume) {
    for (HandDay& day : days.at(code))
      if (day.date == date) {
        day.prices[3] = std::strtof(close.c_str(), nullptr);
        day.volume = volume;
      }
  }
};

// ---- The year

// What a day's bulletin says and what that means.
struct Event {
  std::string date;  // on which it is told, which is the day that it is about
  const char* file;  // ".Asx.Btn" or ".Btn"
  std::string line;  // "@" stands for the day as bulletins write it
  std::function<void(HandMarket&, const std::string& date)> means;
};

const std::vector<Event>& Events() {
  using M = HandMarket;
  using D = const std::string&;
  const auto named = [](const char* code, const char* name, const char* indClass) {
    return [=](M& m, D) {
      if (HandName* one = m.Find(code)) {
        one->name = name;
        one->indClass = indClass;
      }
    };
  };
  const auto nothing = [](M&, D) {};
  static const std::vector<Event> kEvents{
      // The listings of the first day, and what is wanted of none of them.
      {"19980105", ".Asx.Btn", "NL,AAA,ASX.STK,,N,ALPHA AUSTRALIA LIMITED ,010",
       named("AAA", "ALPHA AUST LTD", "010")},
      {"19980105", ".Asx.Btn", "NL,BBB,ASX.STK,,N,BETA EXPLORATION CORPORATION ,020",
       named("BBB", "BETA EXP CORP", "020")},
      {"19980105", ".Asx.Btn", "NI,CCC,ASX.STK,,Y,Ceres Mills,030",
       named("CCC", "Ceres Mills", "030")},
      {"19980105", ".Asx.Btn", "NL,AAAWAB,ASX.WNT,,N,AAA WARRANT ,010", nothing},
      {"19980105", ".Asx.Btn", "NI,BBB,ASX.STK,,Y,DELETE THIS,020", nothing},
      {"19980105", ".Asx.Btn", "EN,,,,N", nothing},
      // Bonus issues and a split, with a dividend between them.
      {"19980309", ".Asx.Btn", "BI,AAA,ASX.STK,,Y,@,1,4",
       [](M& m, D date) { m.Issue("AAA", date, 1, 4); }},
      {"19980722", ".Asx.Btn", "BI,AAA,ASX.STK,,Y,@,2,7",
       [](M& m, D date) { m.Issue("AAA", date, 2, 7); }},
      {"19980512", ".Btn", "DI,AAA,SUM,,N,@,,,12.5",
       [](M& m, D date) { m.Dividend("AAA", date, 1250, "0.125"); }},
      {"19980819", ".Asx.Btn", "SP,BBB,ASX.STK,,Y,@,-9,10",
       [](M& m, D date) { m.Issue("BBB", date, -9, 10); }},
      {"19981013", ".Asx.Btn", "SP,BBB,ASX.STK,,Y,@,4,1",
       [](M& m, D date) { m.Issue("BBB", date, 4, 1); }},
      // Four dividends, one left out by its amount, one marked N by no one.
      {"19980203", ".Asx.Btn", "DI,CCC,ASX.STK,,N,@,,,7.5",
       [](M& m, D date) { m.Dividend("CCC", date, 750, "0.075"); }},
      {"19980505", ".Asx.Btn", "DI,CCC,ASX.STK,,N,@,,,11",
       [](M& m, D date) { m.Dividend("CCC", date, 1100, "0.11"); }},
      {"19980804", ".Asx.Btn", "DI,CCC,ASX.STK,,N,@,,,0", nothing},
      {"19981103", ".Asx.Btn", "DI,CCC,ASX.STK,,N,@,,,33.33",
       [](M& m, D date) { m.Dividend("CCC", date, 3333, "0.3333"); }},
      // A code that goes on under another, whose prices came first, and one whose did not.
      {"19980616", ".Asx.Btn", "NC,DDD,ASX.STK,,Y,@,EEE",
       [](M& m, D date) {
         HandDays merged;
         for (const HandDay& day : m.days["DDD"])
           if (day.date < date) merged.push_back(day);
         for (const HandDay& day : m.days["EEE"])
           if (day.date >= date) merged.push_back(day);
         m.old["DDD"] = m.days["DDD"];
         m.old["EEE"] = m.days["EEE"];
         m.days.erase("DDD");
         m.days["EEE"] = merged;
         m.Drop("DDD");
       }},
      {"19980918", ".Asx.Btn", "NC,GGG,ASX.STK,,Y,@,HHH",
       [](M& m, D) {
         m.Find("GGG")->code = "HHH";
         m.days["HHH"] = m.days["GGG"];
         m.days.erase("GGG");
       }},
      // One that leaves the exchange.
      {"19980814", ".Asx.Btn", "DC,FFF,ASX.STK,,N,@",
       [](M& m, D) {
         m.old["FFF"] = m.days["FFF"];
         m.days.erase("FFF");
         m.Drop("FFF");
       }},
      // Corrections, in cents and hundreds, and one of an index, in tenths.
      {"19980421", ".Asx.Btn", "PC,III,ASX.STK,,Y,@,C:1234 V:55",
       [](M& m, D date) { m.Correct("III", date, "12.34", 5500); }},
      {"19981202", ".Asx.Btn", "PC,XAO,ASX.IDX,,Y,@,C:26543 V:77",
       [](M& m, D date) { m.Correct("XAO", date, "2654.3", 77); }},
      // A bonus issue and a dividend of one week.
      {"19981117", ".Asx.Btn", "BI,III,ASX.STK,,Y,@,1,10",
       [](M& m, D date) { m.Issue("III", date, 1, 10); }},
      {"19981119", ".Asx.Btn", "DI,III,ASX.STK,,N,@,,,4.25",
       [](M& m, D date) { m.Dividend("III", date, 425, "0.0425"); }},
  };
  return kEvents;
}

// Codes as they trade; from and until are days of trading, "" is without end.
struct Trading {
  const char *code, *from, *until;
  int first;  // close of the first day in thousandths
  int every;  // rests each so manyth day; 0 never
};
constexpr Trading kTrading[] = {
    {"AAA", "19980105", "", 10000, 0},       {"BBB", "19980105", "", 850, 0},
    {"CCC", "19980105", "", 4205, 9},        {"DDD", "19980105", "19980615", 2310, 0},
    {"EEE", "19980611", "", 2405, 0},  // both for three days
    {"FFF", "19980105", "19980811", 655, 0}, {"GGG", "19980105", "19980918", 1755, 7},
    {"HHH", "19980921", "", 1800, 0},        {"III", "19980302", "", 12000, 4},
    {"XAO", "19980105", "", 2600000, 0},
};

class YearOfBulletins : public UpdateFixture {
 protected:
  const std::string kHostMarket = "drive_c/m/asx/";

  YearOfBulletins() {
    settings.download.DataService = 3;
    settings.download.ServiceIn = "c:\\bul\\in\\";
    settings.download.ServiceOut = "c:\\bul\\out\\";
    settings.download.ServiceSystem = "c:\\bul\\system\\";
    settings.download.NoWarrants = true;
    settings.AdjDivs = 2;
    settings.paths.ChartMiscPath = "c:\\korawin\\chtmisc\\";
    home.Put("drive_c/bul/out/keep", "");
    home.Put("drive_c/bul/system/WMDef.Lst", "1,general,2\r\n1,indices,0\r\n");
    WmPaths lines;
    lines[kWmAsx] = "c:\\m\\asx\\";
    lines[kWmIndices] = "c:\\m\\idx\\";
    lines[kWmFutures] = "c:\\m\\sfe\\";
    lines[kWmOverseas] = "c:\\m\\ovs\\";
    lines[kWmOptions] = "c:\\m\\opt\\";
    lines[kWmChosen] = "0";
    lines[kWmSum] = "c:\\m\\sum\\";
    WriteWmPaths(home.files(), kSystem, lines);
    for (const char* folder : {"asx", "idx", "sfe", "ovs", "opt", "sum"})
      home.Put("drive_c/m/" + std::string(folder) + "/Names.dat", "");
    home.Put("drive_c/korawin/chtmisc/AAA.Txt",
             "T,8.25,19980202,9.50,Low,99\r\nT,8.25,19981201,8.00,Late,99\r\n");
    hand.notes["AAA"] = {{"19980202", 950}, {"19981201", 800}};
  }

  // The lines of a day, each given to both markets.
  void Trade(const std::string& date, int number) {
    std::string shares, indices;
    for (const Trading& one : kTrading) {
      if (date < one.from || (*one.until && date > one.until)) continue;
      if (one.every > 0 && number % one.every == one.every - 1) continue;
      // A price that wanders by whole thousandths, the same on every machine.
      const int wave = (number * number * 7 + number * int(one.code[0])) % 97 - 48;
      const int close = one.first + one.first / 1000 * wave / 4 + wave % 5;
      const int prices[] = {close - wave % 3, close + 5, close - 5, close};
      const std::int32_t volume = 1000 + number * 13;
      const bool index = std::string_view(one.code) == "XAO";
      HandDay day{.date = date, .prices = {}, .volume = volume, .desc = {}};
      std::string line = std::string(one.code) + "," + date;
      for (size_t i = 0; i < 4; ++i) {
        const std::string price = Text("%d.%03d", prices[i] / 1000, prices[i] % 1000);
        day.prices[i] = std::strtof(price.c_str(), nullptr);
        line += "," + price;
      }
      (index ? indices : shares) += line + "," + std::to_string(volume) + ",0\r\n";
      (index ? handIndices : hand).Take(day, one.code, index ? 5 : 4);
    }
    hand.Rest(date);
    const std::string name = NameOfDay(date);
    Download(name + ".d", "");
    Download(name + ".dsu", shares);
    Download(name + ".dix", indices);
  }

  void Publish(const std::string& date) {
    std::map<std::string, std::string> bulletins;
    for (const Event& event : Events()) {
      if (event.date != date) continue;
      std::string line = event.line;
      if (const size_t at = line.find('@'); at != std::string::npos)
        line.replace(at, 1, NameOfDay(date));
      bulletins[event.file] += line + "\r\n";
      told.push_back(&event);
    }
    for (const auto& [file, text] : bulletins)
      home.Put("drive_c/bul/in/" + NameOfDay(date) + file, text);
  }

  // Which events were told since the last time; names that were given once are given again.
  void CarryOutByHand() {
    for (const Event* event : told) {
      const bool index = event->line.find("XAO") != std::string::npos;
      event->means(index ? handIndices : hand, event->date);
    }
    std::erase_if(told, [](const Event* event) {
      return !event->line.starts_with("N") || event->line.starts_with("NC");
    });
  }

  void CarryOut() {
    const std::string folder = AdjustFolder(home.files(), settings);
    AdjustRows rows = ReadAdjustList(home.files(), folder);
    const AdjustResult result =
        MakeAdjustments({home.files(), settings, 255, display, {}}, rows, folder);
    EXPECT_TRUE(result.failures.empty()) << FailuresText(result);
  }

  void Expect(HandMarket& wanted, const std::string& name) {
    const std::string folder = "c:\\m\\" + name + "\\";
    const auto names = ReadNames(home.files(), folder);
    ASSERT_EQ(names.size(), wanted.names.size());
    for (size_t i = 0; i < names.size(); ++i) {
      EXPECT_EQ(names[i].Code.trimmed(), wanted.names[i].code);
      EXPECT_EQ(names[i].Name.trimmed(), wanted.names[i].name) << wanted.names[i].code;
      EXPECT_EQ(names[i].IndClass.trimmed(), wanted.names[i].indClass) << wanted.names[i].code;
      EXPECT_EQ(int(names[i].RecType), wanted.names[i].recType);
      EXPECT_EQ(int(names[i].NameStatus), 0);
    }
    for (const auto& [code, of] : wanted.days)
      ExpectDays(of, PriceFile(home.files(), folder + code + ".WDT").ReadAll(), code);
    std::set<std::string> there, expected;
    for (const auto& file : home.files().List(folder))
      if (UCase(file).ends_with(".WDT")) there.insert(UCase(file));
    for (const auto& [code, of] : wanted.days) expected.insert(code + ".WDT");
    EXPECT_EQ(there, expected);
    for (const auto& [code, of] : wanted.old)
      ExpectDays(of, PriceFile(home.files(), folder + code + ".OLD").ReadAll(), code + ".OLD");
  }
  static void ExpectDays(const HandDays& wanted, const std::vector<PriceRec>& got,
                         const std::string& code) {
    ASSERT_EQ(got.size(), wanted.size()) << code;
    for (size_t i = 0; i < got.size(); ++i) {
      const HandDay& day = wanted[i];
      const std::string at = code + " " + day.date;
      ASSERT_EQ(got[i].RecDate.raw(), day.date) << at;
      const float prices[] = {got[i].Open, got[i].High, got[i].Low, got[i].Close};
      for (size_t p = 0; p < 4; ++p) ASSERT_EQ(prices[p], day.prices[p]) << at << " price " << p;
      ASSERT_EQ(std::int32_t(got[i].Volume), day.volume) << at;
      ASSERT_EQ(float(got[i].AdjFactor), day.factor) << at;
      ASSERT_EQ(got[i].AdjDesc.trimmed(), day.desc) << at;
    }
  }

  HandMarket hand, handIndices;
  std::vector<const Event*> told;
};

TEST_F(YearOfBulletins, LeavesTheMarketThatIsWorkedOutByHand) {
  using namespace std::chrono;
  int number = 0;
  size_t most = 0;
  for (sys_days day = 1998y / January / 5; day < sys_days(1999y / January / 1); day += days{1}) {
    const weekday of(day);
    if (of == Saturday || of == Sunday) continue;
    const std::string date = FileDay(day);
    Trade(date, number++);
    Publish(date);
    UpdateRun run = Run();
    run.CheckBulletins = [&](const std::string& path, const std::string& baseName) {
      CheckBulletins(home.files(), settings, path, baseName, display);
    };
    entries.clear();
    ASSERT_EQ(BuildDownloadList(home.files(), settings.download, dialogs, entries),
              ListResult::kFilled);
    ASSERT_EQ(UpdateOneDay(run, entries, 0), UpdateEnd::kUpdated) << date << LastSaid();
    if (of != Friday && date != "19981231") continue;
    most = std::max(most, told.size());
    CarryOut();
    CarryOutByHand();
  }
  EXPECT_EQ(number, 259);
  EXPECT_TRUE(dialogs.said.empty()) << LastSaid();
  EXPECT_GT(most, 5u);
  Expect(hand, "asx");
  Expect(handIndices, "idx");
  const auto& notes = hand.notes["AAA"];
  EXPECT_LT(notes[0].second, 700);
  EXPECT_EQ(home.Get("drive_c/korawin/chtmisc/AAA.Txt"),
            Text("T,8.25,19980202,%.2f,Low,255\r\nT,8.25,19981201,8.00,Late,255\r\n",
                 double(notes[0].second) / 100));
  // What stays on the list are the names, which may be given again.
  EXPECT_EQ(home.Get(kHostMarket + "Adjust.Lst"),
            "NL,AAA,05JAN98,,Y,ALPHA AUST LTD ,010\r\n"
            "NL,BBB,05JAN98,,Y,BETA EXP CORP ,020\r\n"
            "NI,CCC,05JAN98,,Y,Ceres Mills,030\r\n"
            "EN,,,,N\r\n");
}

}  // namespace
}  // namespace kora::test
