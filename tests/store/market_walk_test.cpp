#include "store/market_walk.h"

#include <gtest/gtest.h>
#include <sys/stat.h>

#include <cmath>
#include <filesystem>
#include <limits>
#include <mutex>
#include <new>
#include <set>
#include <thread>

#include "store/name_file.h"
#include "tests/support/counting_io.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

const std::string kData = "c:\\korawin\\data\\";
const std::string kHostData = "drive_c/korawin/data/";

// Keeps what was shown, and stops at a step.
struct KeptProgress : Progress {
  std::vector<std::string> items;
  std::vector<std::pair<int, int>> steps;
  int stopAt = 0;
  std::set<std::thread::id> threads;
  void Show(ProgressLine line, std::string_view text) override {
    if (line == ProgressLine::kItem) items.emplace_back(text);
  }
  bool Step(int done, int total) override {
    steps.push_back({done, total});
    threads.insert(std::this_thread::get_id());
    return int(steps.size()) != stopAt;
  }
};

// The machine's file system, noting who calls; a file named in `breaks` is out of memory.
struct WatchedIo : CountingIo {
  explicit WatchedIo(bool any) : any_(any) {}
  bool AnyThread() const override { return any_; }
  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    const std::lock_guard lock(mutex);
    threads.insert(std::this_thread::get_id());
    if (!breaks.empty() && path.ends_with(breaks)) throw std::bad_alloc();
    return MachineIo().Open(path, mode);
  }
  std::mutex mutex;
  std::set<std::thread::id> threads;
  std::string breaks;

 private:
  bool any_;
};

std::string CodeOf(int n) { return "S" + std::to_string(1000 + n); }

// Day `d` of security `n`: a close that no other has.
PriceRec DayOf(int n, int d) {
  const float close = float(n * 100 + d);
  return Day(std::to_string(20000100 + d), close, close, close, close, d);
}

struct Market {
  explicit Market(Io& io = MachineIo()) : home(io) {}

  // Securities S1000, S1001, ...; security n has n % 7 + 1 records.
  void Fill(int securities) {
    std::vector<NameRec> names;
    for (int n = 0; n < securities; ++n) {
      names.push_back(Security(CodeOf(n), std::int16_t(n % 5)));
      std::vector<PriceRec> days;
      for (int d = 1; d <= n % 7 + 1; ++d) days.push_back(DayOf(n, d));
      Prices(CodeOf(n), days);
    }
    Names(names);
  }
  void Names(const std::vector<NameRec>& recs) { home.Put(kHostData + "Names.dat", Bytes(recs)); }
  void Prices(const std::string& code, const std::vector<PriceRec>& recs) {
    home.Put(kHostData + code + ".WDT", Bytes(recs));
  }
  // "number code count: closes" a visit.
  std::vector<std::string> Walk(const WalkPlan& plan, MarketWalk::Wants wants = {}) {
    std::vector<std::string> out;
    MarketWalk walk(home.files(), kData);
    EXPECT_TRUE(walk.Run(plan, progress, wants, [&](const MarketItem& item) {
      std::string line = std::to_string(item.number) + " " + std::string(item.code) + " " +
                         std::to_string(item.count) + ":";
      for (const PriceRec& rec : item.records) line += " " + std::to_string(int(rec.Close));
      out.push_back(line);
    }));
    unread = walk.unread();
    return out;
  }

  TempHome home;
  KeptProgress progress;
  UnreadFiles unread;
};

}  // namespace

TEST(MarketWalkTest, VisitsInTheOrderOfTheFileWithTheLastRecords) {
  Market market;
  market.Fill(4);
  EXPECT_EQ(market.Walk({.records = 3}),
            (std::vector<std::string>{"1 S1000 1: 1", "2 S1001 2: 101 102",
                                      "3 S1002 3: 201 202 203", "4 S1003 4: 302 303 304"}));
  EXPECT_EQ(market.Walk({.records = kWholeFile}).back(), "4 S1003 4: 301 302 303 304");
  EXPECT_EQ(market.unread.total(), 0);
}

TEST(MarketWalkTest, NumbersTheFirstRecordThatWasRead) {
  Market market;
  market.Fill(4);
  MarketWalk walk(market.home.files(), kData);
  std::vector<std::int32_t> firsts;
  walk.Run({.records = 3}, market.progress, {},
           [&](const MarketItem& item) { firsts.push_back(item.first()); });
  EXPECT_EQ(firsts, (std::vector<std::int32_t>{1, 1, 1, 2}));
}

TEST(MarketWalkTest, WithoutRecordsNoPriceFileIsOpened) {
  CountingIo io;
  Market market(io);
  market.Names({Security("NONE"), Security("A/B")});
  io.opens = 0;
  EXPECT_EQ(market.Walk({}), (std::vector<std::string>{"1 NONE 0:", "2 A/B 0:"}));
  EXPECT_EQ(io.opens, 1);
  EXPECT_EQ(market.unread.total(), 0);
}

TEST(MarketWalkTest, OnlyWhatIsWantedIsReadAndShown) {
  CountingIo io;
  Market market(io);
  market.Fill(10);
  io.opens = 0;
  EXPECT_EQ(market.Walk({.records = 1}, [](const NameRec& rec) { return rec.Category == 3; }),
            (std::vector<std::string>{"4 S1003 4: 304", "9 S1008 2: 802"}));
  EXPECT_EQ(io.opens, 3);  // the names and two files
  EXPECT_EQ(market.progress.items, (std::vector<std::string>{"4 S1003", "9 S1008"}));
  EXPECT_EQ(market.progress.steps, (std::vector<std::pair<int, int>>{{4, 10}, {9, 10}, {10, 10}}));
}

TEST(MarketWalkTest, AnEmptyOrMissingNameFileIsAnEmptyMarket) {
  Market market;
  market.home.files().MakeFolder(kData);
  EXPECT_TRUE(market.Walk({.records = 1}).empty());
  market.Names({});
  EXPECT_TRUE(market.Walk({.records = 1}).empty());
  EXPECT_EQ(market.progress.steps, (std::vector<std::pair<int, int>>{{0, 0}, {0, 0}}));
  market.home.Put(kHostData + "Names.dat", std::string(95, 'x'));
  EXPECT_TRUE(market.Walk({.records = 1}).empty());
}

TEST(MarketWalkTest, WhatCantBeReadIsPassedOverAndCounted) {
  Market market;
  PriceRec day = Day("20000103", 1, 1, 1, 1);
  PriceRec nan = day, inf = day, zero = NewPriceRec("20000103");
  nan.Low = std::numeric_limits<float>::quiet_NaN();
  inf.Open = std::numeric_limits<float>::infinity();
  market.Names({Security("GOOD"), Security("GONE"), Security("A\\B"), Security(""),
                Security("TORN"), Security("SHORT"), Security("EMPTY"), Security("NAN"),
                Security("INF"), Security("ZERO"), Security("DIR"), Security("PIPE"),
                Security("LAST")});
  market.Prices("GOOD", {day, day});
  market.home.Put(kHostData + "TORN.WDT", Bytes(std::vector{day, day, day}).substr(0, 149));
  market.Prices("SHORT", {day});
  market.Prices("EMPTY", {});
  market.Prices("NAN", {day, nan});
  market.Prices("INF", {inf, day});
  market.Prices("ZERO", {zero, zero});
  market.Prices("LAST", {zero, day});
  market.home.files().MakeFolder(kData + "DIR.WDT");
  ASSERT_EQ(::mkfifo((market.home.path() + "/" + kHostData + "PIPE.WDT").c_str(), 0600), 0);

  const WalkPlan plan{.records = 2, .fewest = 2, .soundPrices = true};
  EXPECT_EQ(market.Walk(plan), (std::vector<std::string>{"1 GOOD 2: 1 1", "13 LAST 2: 0 1"}));
  EXPECT_EQ(market.unread.missing, 3);
  EXPECT_EQ(market.unread.torn, 1);
  EXPECT_EQ(market.unread.tooShort, 2);
  EXPECT_EQ(market.unread.unsound, 3);
  EXPECT_EQ(market.unread.refused, 2);
  EXPECT_EQ(market.unread.total(), 11);
  EXPECT_EQ(market.progress.items.size(), 13u);
  // Only what is read is judged, and only where the plan says so.
  EXPECT_EQ(market.Walk({.records = 1, .soundPrices = true}).size(), 4u);  // GOOD SHORT INF LAST
  EXPECT_EQ(market.Walk({.records = 2}).size(), 6u);
}

TEST(MarketWalkTest, PricesNearTheEndOfFloatsAreSound) {
  Market market;
  const float most = std::numeric_limits<float>::max();
  market.Names({Security("BIG")});
  market.Prices("BIG", {Day("20000103", most, most, most, most)});
  EXPECT_EQ(market.Walk({.records = 1, .soundPrices = true}).size(), 1u);
  EXPECT_EQ(market.unread.total(), 0);
}

TEST(MarketWalkTest, AFileThatNoChartCouldNumberIsRefused) {
  Market market;
  market.Names({Security("FULL"), Security("HUGE")});
  for (const auto& [code, records] : {std::pair("FULL", 32767), std::pair("HUGE", 32768)}) {
    market.Prices(code, {Day("20000103", 1, 1, 1, 1)});
    std::filesystem::resize_file(market.home.path() + "/" + kHostData + std::string(code) + ".WDT",
                                 50ull * records);
  }
  for (const std::int32_t records : {1, kWholeFile}) {
    EXPECT_EQ(market.Walk({.records = records}).size(), 1u);
    EXPECT_EQ(market.unread.refused, 1);
  }
}

TEST(MarketWalkTest, TheUnreadAreToldInOneLine) {
  UnreadFiles unread;
  EXPECT_EQ(UnreadText(unread), "");
  unread.torn = 1;
  EXPECT_EQ(UnreadText(unread), "1 file could not be read");
  unread.missing = 1;
  unread.refused = 2;
  unread.tooShort = 3;
  unread.unsound = 4;
  EXPECT_EQ(UnreadText(unread), "11 files could not be read");
}

TEST(MarketWalkTest, AStopLeavesTheRestUnvisited) {
  Market market;
  market.Fill(200);
  market.progress.stopAt = 3;
  MarketWalk walk(market.home.files(), kData);
  int visits = 0;
  EXPECT_FALSE(walk.Run({.records = 5}, market.progress, {}, [&](const MarketItem&) { ++visits; }));
  EXPECT_EQ(visits, 2);
  // The same walk can be made again, from the beginning.
  market.progress.stopAt = 0;
  visits = 0;
  EXPECT_TRUE(walk.Run({.records = 5}, market.progress, {}, [&](const MarketItem&) { ++visits; }));
  EXPECT_EQ(visits, 200);
}

// Whether or not a second thread reads, and however many blocks there are, visits are the same.
TEST(MarketWalkTest, ReadingAheadChangesNothing) {
  WatchedIo plain(false), ahead(true);
  for (const int securities : {1, 31, 32, 33, 64, 128, 129, 300}) {
    for (const std::int32_t records : {1, 5, kWholeFile}) {
      const WalkPlan plan{.records = records, .fewest = 3};
      Market one(plain), two(ahead);
      one.Fill(securities);
      two.Fill(securities);
      EXPECT_EQ(one.Walk(plan), two.Walk(plan)) << securities;
      EXPECT_EQ(one.unread.tooShort, two.unread.tooShort);
      EXPECT_EQ(one.progress.steps, two.progress.steps);
    }
  }
  EXPECT_EQ(plain.threads, std::set<std::thread::id>{std::this_thread::get_id()});
  if (std::thread::hardware_concurrency() > 1) {
    EXPECT_GT(ahead.threads.size(), 1u);
  }
}

TEST(MarketWalkTest, TheCallersThreadDoesAllButReading) {
  WatchedIo io(true);
  Market market(io);
  market.Fill(300);
  std::set<std::thread::id> threads;
  MarketWalk walk(market.home.files(), kData);
  const auto note = [&] { threads.insert(std::this_thread::get_id()); };
  walk.Run(
      {.records = 5}, market.progress,
      [&](const NameRec&) {
        note();
        return true;
      },
      [&](const MarketItem&) { note(); });
  threads.insert(market.progress.threads.begin(), market.progress.threads.end());
  EXPECT_EQ(threads, std::set<std::thread::id>{std::this_thread::get_id()});
}

TEST(MarketWalkTest, FailuresComeOutOfTheWalk) {
  WatchedIo io(true);
  Market market(io);
  market.Fill(300);
  MarketWalk walk(market.home.files(), kData);
  int visits = 0;
  const auto visit = [&](const MarketItem&) {
    if (++visits == 5) throw RunTimeError(kDiskFull);
  };
  EXPECT_EQ(ErrorOf([&] { walk.Run({.records = 5}, market.progress, {}, visit); }), kDiskFull);
  // The other thread's own failure, too.
  io.breaks = CodeOf(150) + ".WDT";
  EXPECT_THROW(walk.Run({.records = 5}, market.progress, {}, visit), std::bad_alloc);
}

// The second record of a code sees what the visit of the first wrote.
TEST(MarketWalkTest, AVisitorThatWritesSeesItsOwnWrites) {
  Market market;
  std::vector<NameRec> names;
  for (int n = 0; n < 100; ++n) names.push_back(Security("SAME"));
  market.Names(names);
  market.Prices("SAME", {DayOf(0, 1)});
  MarketWalk walk(market.home.files(), kData);
  walk.Run({.records = 1, .ahead = false}, market.progress, {}, [&](const MarketItem& item) {
    EXPECT_EQ(item.count, item.number);
    EXPECT_EQ(std::int32_t(item.records[0].Volume), item.number);
    PriceFile(market.home.files(), kData + "SAME.WDT", OpenMode::kReadWrite)
        .Append(DayOf(0, item.number + 1));
  });
  EXPECT_EQ(market.progress.steps.size(), 101u);
}

// The walk keeps the names that it began with.
TEST(MarketWalkTest, ANameFileThatIsReplacedMeanwhileDoesNotDisturb) {
  Market market;
  market.Fill(100);
  MarketWalk walk(market.home.files(), kData);
  int visits = 0;
  walk.Run({.records = 1}, market.progress, {}, [&](const MarketItem&) {
    if (++visits == 1) market.home.files().WriteAll(kData + "Names.dat", "");
  });
  EXPECT_EQ(visits, 100);
}

TEST(MarketWalkTest, FindsFilesInAnyCase) {
  Market market;
  market.Names({Security("ABC"), Security("XYZ")});
  market.Prices("ABC", {DayOf(0, 1)});
  market.home.Put(kHostData + "xyz.wdt", Bytes(std::vector{DayOf(1, 1)}));
  EXPECT_EQ(market.Walk({.records = 1}).size(), 2u);
}
