// Updates that are killed, or that the disk fails, at each of their writes.

#include <set>

#include "base/file_edits.h"
#include "tests/support/killed_runs.h"
#include "tests/update/update_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

PriceRec Flat(std::string_view date, float price, std::int32_t volume = 0) {
  return Day(date, price, price, price, price, volume);
}

size_t RecordSize(const std::string& name) {
  if (name.ends_with(".WDT")) return sizeof(PriceRec);
  return name.ends_with("Names.dat") ? sizeof(NameRec) : 1;
}

// One day that waits in an installation which can be laid down again and again.
class FaultTest : public UpdateFixture {
 protected:
  using Store = std::map<std::string, std::string>;

  // Lays the installation down; a run of it then takes in everything that waits.
  using Scene = std::function<void()>;

  const std::string kM = "drive_c/korawin/m/";
  const std::string kJournal = kHostSystem + "Update.Jnl";

  void Clear() {
    std::filesystem::remove_all(home.path() + "/drive_c/korawin");
    home.files().MakeFolder(kDown);
  }
  void Lay(const Scene& scene) {
    io.Reset();
    Clear();
    current = {};
    dialogs.said.clear();
    settings.paths.CurrentDataPath = kData;
    scene();
  }
  void Waiting(const std::string& text) { Download("15SEP98.d", text); }

  // Two shares and a total with two days each.
  void LayMarket(std::int16_t service) {
    settings.download.DataService = service;
    settings.download.InternetDLfmt = "DDMMMYY.D";
    Names({Security("ORE"), Security("XAD", 1, kAdvanceDecline), Security("ZAP")});
    Prices("ORE", {Flat("19980911", 1, 10), Flat("19980914", 1, 10)});
    Prices("ZAP", {Flat("19980911", 2, 20), Flat("19980914", 2, 20)});
    Prices("XAD", {Day("19980911", 0, 5, 3, 2), Day("19980914", 0, 4, 5, 1)});
  }
  // Appends, late volumes, a running total, two new securities.
  static std::string DayOf(const std::string& date) {
    std::string text =
        "ORE,D,1,2,1,1,11,12\r\nXAD,D,0,10,4,0,0,0\r\nNEW1,D,7,7,7,7,7,0\r\n"
        "ZAP,D,3,3,3,3,21,22\r\nNEW2,D,8,8,8,8,8,0\r\n";
    for (size_t at; (at = text.find(",D,")) != std::string::npos;) text.replace(at + 1, 1, date);
    return text;
  }
  void LayAppend() {
    LayMarket(1);
    Waiting(DayOf("19980915"));
  }
  void LayReplace() {
    LayMarket(1);
    Waiting(DayOf("19980914"));
  }
  void LayInsert() {
    LayMarket(1);
    for (const char* code : {"ORE", "ZAP"})
      Prices(code, {Flat("19980909", 1, 9), Flat("19980910", 1, 10), Flat("19980914", 2, 14)});
    Prices("XAD",
           {Day("19980909", 0, 5, 3, 2), Day("19980910", 0, 4, 5, 1), Day("19980914", 0, 4, 5, 0)});
    Waiting(DayOf("19980911"));
  }
  // Names of another form, blank lines; every listed share trades.
  void LayInternet() {
    LayMarket(4);
    settings.download.InternetDLfmt = "YYMMDD.D";
    Download("980915.d", "\r\n" + DayOf("19980915") + " \r\n");
  }
  // Six market files, each with two securities on file and a new one; every one trades.
  void LayWholeMarket() {
    settings.download.DataService = 3;
    Names({});
    std::string paths;
    for (const char* n : {"asx", "idx", "sfe", "ovs", "opt", "sum"}) {
      std::vector<NameRec> names{Security("AAA"), Security("BBB")};
      for (NameRec& rec : names) rec.OtherDetails.set("0P1/12/98");
      Names(names, kM + n + "/");
      for (const char* code : {"AAA", "BBB"})
        Prices(code, {Flat("19980911", 1, 10), Flat("19980914", 2, 20)}, kM + n + "/");
      if (std::string(n) == "sum") paths += "2\r\n";
      paths += std::string("c:\\korawin\\m\\") + n + "\\\r\n";
    }
    home.Put(kHostSystem + "WMPaths.lst", paths);
    Waiting("");
    for (const char* extension : {"das", "dix", "dov", "dsu", "dsf", "dop"}) {
      const std::string tail = std::string(extension) == "dop" ? ",30,C\r\n" : ",15\r\n";
      Download(std::string("15SEP98.") + extension, "AAA,19980915,3,3,3,3,30" + tail +
                                                        "BBB,19980915,4,4,4,4,40" + tail +
                                                        "NEW,19980915,5,5,5,5,50" + tail);
    }
  }
  // One of three shares trades.
  void LayNoTrades() {
    LayMarket(5);
    Names({Security("ORE"), Security("NEW"), Security("ZAP"), Security("OLD")});
    Prices("OLD", {Flat("19980914", 7, 70)});
    Waiting("ORE,19980915,1,2,1,1,11,0\r\nORE,19980915,1,2,1,1,11,0\r\n");
  }

  // A run that is done undisturbed.
  Store WholeRun(const Scene& scene) {
    Lay(scene);
    EXPECT_EQ(Update(), UpdateEnd::kUpdated);
    return Everything();
  }

  // In a process of its own that is killed in place of change number `at`. False when it came
  // to its end before.
  bool RunKilledAt(int at) {
    const auto code = InChild([&] {
      io.Reset(at);
      io.kills = true;
      return Update() == UpdateEnd::kUpdated ? 0 : 1;
    });
    EXPECT_EQ(code.value_or(0), 0);
    return !code;
  }

  // Whole records, each an old one or one of the undisturbed run; no file gone or shorter. A
  // file that waited may have been renamed.
  void ExpectSound(const Store& before, const Store& whole, const Store& after) {
    for (const auto& [name, bytes] : before) {
      if (name.starts_with("korawin/download/")) continue;
      ASSERT_EQ(after.count(name), 1u) << name;
      EXPECT_GE(after.at(name).size(), bytes.size()) << name;
    }
    for (const auto& [name, bytes] : after) {
      const size_t size = RecordSize(name);
      EXPECT_EQ(bytes.size() % size, 0u) << name;
      if (size == 1) continue;
      std::set<std::string> known;
      for (const Store* store : {&before, &whole})
        if (const auto it = store->find(name); it != store->end())
          for (size_t at = 0; at < it->second.size(); at += size)
            known.insert(it->second.substr(at, size));
      for (size_t at = 0; at + size <= bytes.size(); at += size)
        EXPECT_TRUE(known.contains(bytes.substr(at, size))) << name << " at byte " << at;
    }
  }

  // The days that can be taken in.
  size_t Listed() {
    size_t n = 0;
    for (const std::string& name : home.files().List(kDown))
      n += EqualNoCase(name.substr(name.size() - 2), ".d");
    return n;
  }

  // Killed at every write; the next run then brings the undisturbed run's bytes, and asks nothing
  // once the journal stands: it knows the mode.
  int ExpectTakenUpAgain(const Scene& scene) {
    const Store whole = WholeRun(scene);
    for (int at = 1;; ++at) {
      SCOPED_TRACE("write " + std::to_string(at));
      Lay(scene);
      const Store before = Everything();
      if (!RunKilledAt(at)) {
        EXPECT_TRUE(Everything() == whole);
        return at - 1;
      }
      ExpectSound(before, whole, Everything());
      const bool journal = home.Exists(kJournal);
      if (Listed() == 1) {
        EXPECT_EQ(Update(), UpdateEnd::kUpdated);
        EXPECT_TRUE(!journal || dialogs.said.empty());
      } else {
        // Killed behind the renaming: all is there, and the journal waits to be swept.
        EXPECT_TRUE(journal);
        home.files().Remove(kSystem + "Update.Jnl");
      }
      EXPECT_TRUE(Everything() == whole);
      if (HasFailure()) return 0;
    }
  }

  // What the host can fail at, each in turn.
  struct Fault {
    const char* name;
    int error;
    bool torn, lasting, reading;
    const char* text;
  };
  static constexpr Fault kFaults[] = {
      {"full disk", kDiskFull, false, true, false, "There is an unexpected error - Disk full"},
      {"full disk in a write", kDiskFull, true, false, false,
       "There is an unexpected error - Disk full"},
      {"no access", kPathAccess, false, false, false,
       "There is a file access problem. Check directory paths option."},
      {"device", kDeviceError, false, false, true, "There is a device problem. Check and retry"},
  };

  // Without the downloaded files, which keep a name that could not be changed, and the journal of a
  // day that is in.
  static Store Kept(Store store) {
    std::erase_if(store, [](const auto& file) {
      return file.first.starts_with("korawin/download/") || file.first == "korawin/Update.Jnl";
    });
    return store;
  }

  // A fault at every call is told, loses nothing and leaves a day that can be taken in.
  void ExpectFaultsTold(const Scene& scene) {
    const Store whole = WholeRun(scene);
    for (const Fault& fault : kFaults) {
      for (int at = 1;; ++at) {
        SCOPED_TRACE(std::string(fault.name) + " at call " + std::to_string(at));
        Lay(scene);
        const Store before = Everything();
        io.Reset(fault.reading ? 0 : at);
        io.failReadAt = fault.reading ? at : 0;
        io.error = io.readError = fault.error;
        io.torn = fault.torn;
        io.lasting = fault.lasting;
        const UpdateEnd end = Update();
        const bool met = (fault.reading ? io.reads : io.calls) >= at;
        io.Reset();
        io.failReadAt = 0;
        io.torn = io.lasting = false;
        if (!met) break;
        ExpectSound(before, whole, Everything());
        if (end == UpdateEnd::kUpdated) {
          // Names that can't be changed are passed over: the entry may stay listed.
          EXPECT_NE(LastTitle(), "Error");
        } else {
          if (!fault.reading || LastTitle() != "W/M Paths") {  // a list that can't be read
            EXPECT_EQ(LastTitle(), "Error");
            EXPECT_EQ(LastSaid().substr(0, LastSaid().find('\n')), fault.text);
            EXPECT_NE(LastSaid().find("\nc:\\korawin\\"), std::string::npos) << LastSaid();
          }
          // Who can't look at what did not trade is behind the renaming.
          EXPECT_TRUE(Listed() == 1 || (fault.reading && Waits("15SEP98.dX")));
        }
        EXPECT_FALSE(display.running);
        if (Listed() == 1) {
          current = {};
          EXPECT_EQ(Update(), UpdateEnd::kUpdated);
        }
        EXPECT_EQ(Listed(), 0u);
        EXPECT_TRUE(Kept(Everything()) == Kept(whole));
        if (HasFailure()) return;
      }
    }
  }
};

}  // namespace

// A journal makes 5 writes: opened, written, flushed, renamed, its folder flushed; one that replaces
// another takes its access and keeps it aside, which makes 7. Then the name file makes one, each
// price file one, a new one another as it is made, and the disk is flushed once. The day's file is
// renamed, the journal removed.

TEST_F(FaultTest, AnAppendedDayIsTakenUpAgainWhereverItWasKilled) {
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayAppend(); }), 5 + 1 + 3 + 2 * 2 + 1 + 2);
}

TEST_F(FaultTest, AReplacedDayIsTakenUpAgainWhereverItWasKilled) {
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayReplace(); }), 5 + 1 + 3 + 2 * 2 + 1 + 2);
}

TEST_F(FaultTest, AnInsertedDayIsTakenUpAgainWhereverItWasKilled) {
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayInsert(); }), 5 + 1 + 3 + 2 * 2 + 1 + 2);
}

TEST_F(FaultTest, AnInternetDayIsTakenUpAgainWhereverItWasKilled) {
  // Renamed to the list's form; without its blank lines: made, written, flushed and renamed twice.
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayInternet(); }), 1 + 6 + 5 + 1 + 3 + 2 * 2 + 1 + 2);
}

TEST_F(FaultTest, AWholeMarketIsTakenUpAgainWhereverItWasKilled) {
  // Six files of two securities on file and a new one; the entry is deleted.
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayWholeMarket(); }), 6 * (5 + 1 + 2 + 2 + 1) + 5 * 2 + 2);
}

TEST_F(FaultTest, FlatRecordsAreTakenUpAgainWhereverTheRunWasKilled) {
  // ORE trades, ZAP and OLD are flat; NEW has no prices.
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayNoTrades(); }), 5 + 3 + 1 + 2);
}

// Each security is made for itself: a day of which the first lines were taken goes on behind them.
TEST_F(FaultTest, ADayInManyPartsIsTakenUpAgainWhereverItWasKilled) {
  mostHeld = 1;
  const Scene append = [this] { LayAppend(); }, insert = [this] { LayInsert(); };
  // A journal, its files and a flush for each of five securities, two of them new; then the part
  // that ends the day, which has nothing to write.
  const int writes = 5 * (5 + 1 + 1) + 2 * 2 + 5 + 5 * 2 + 2;
  EXPECT_EQ(ExpectTakenUpAgain(append), writes);
  EXPECT_EQ(ExpectTakenUpAgain(insert), writes);
  EXPECT_EQ(ExpectTakenUpAgain([this] { LayNoTrades(); }), 4 * (5 + 1 + 1) + 5 + 4 * 2 + 2);
}

TEST_F(FaultTest, FaultsOfAnAppendedDayAreTold) {
  ExpectFaultsTold([this] { LayAppend(); });
}
TEST_F(FaultTest, FaultsOfAReplacedDayAreTold) {
  ExpectFaultsTold([this] { LayReplace(); });
}
TEST_F(FaultTest, FaultsOfAnInsertedDayAreTold) {
  ExpectFaultsTold([this] { LayInsert(); });
}
TEST_F(FaultTest, FaultsOfAnInternetDayAreTold) {
  ExpectFaultsTold([this] { LayInternet(); });
}
TEST_F(FaultTest, FaultsOfAWholeMarketAreTold) {
  ExpectFaultsTold([this] { LayWholeMarket(); });
}

// Half a record at the end of a file, as a machine that went down may leave it, is no record.
TEST_F(FaultTest, AWriteThatIsTornAtTheEndOfAFileIsNoRecord) {
  const Scene scene = [this] { LayAppend(); };
  const Store whole = WholeRun(scene);
  Lay(scene);
  home.Put(kHostData + "ORE.WDT", home.Get(kHostData + "ORE.WDT") + std::string(25, 'x'));
  EXPECT_EQ(PricesOf("ORE").size(), 2u);
  ASSERT_EQ(Update(), UpdateEnd::kUpdated);
  EXPECT_EQ(Everything(), whole);
}

// ---- What a run leaves that dies, and what is done to it meanwhile

TEST_F(FaultTest, AJournalOfADayThatIsInIsSweptByTheNextDay) {
  Lay([this] { LayAppend(); });
  ASSERT_TRUE(RunKilledAt(16));  // the journal's removal
  ASSERT_EQ(Listed(), 0u);
  ASSERT_TRUE(home.Exists(kJournal));
  Prices("ORE", {Flat("19980911", 5, 10)});  // edited since: a journal that is done is not redone
  Download("16SEP98.d", "ORE,19980916,1,2,1,1,11,0\r\nZAP,19980916,3,3,3,3,21,0\r\n");
  EXPECT_EQ(Update(), UpdateEnd::kUpdated);
  EXPECT_FALSE(home.Exists(kJournal));
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Shown("ORE"), "19980911 5 10; 19980916 1 11");
}

TEST_F(FaultTest, AnotherDayFinishesTheOneThatWasCutOffFirst) {
  Lay([this] { LayAppend(); });
  const Store whole = WholeRun([this] { LayAppend(); });
  Lay([this] { LayAppend(); });
  ASSERT_TRUE(RunKilledAt(7));
  Download("16SEP98.d", "ORE,19980916,9,9,9,9,11,0\r\nZAP,19980916,3,3,3,3,21,0\r\n");
  EXPECT_EQ(Update("16SEP98.d"), UpdateEnd::kUpdated);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_TRUE(Waits("15SEP98.dX"));
  EXPECT_EQ(Shown("ORE"), "19980911 1 10; 19980914 1 12; 19980915 1 11; 19980916 9 11");
  EXPECT_EQ(Everything().at("korawin/data/NEW1.WDT"), whole.at("korawin/data/NEW1.WDT"));
}

TEST_F(FaultTest, APriceFileThatWasChangedSinceIsLeftAsItIsAndTold) {
  Lay([this] { LayAppend(); });
  ASSERT_TRUE(RunKilledAt(7));  // the name file is written
  const std::vector<PriceRec> edited{Flat("19980911", 1, 10), Flat("19980914", 77, 10)};
  Prices("ORE", edited);
  std::filesystem::remove(home.path() + "/" + kHostData + "ZAP.WDT");
  EXPECT_EQ(Update(), UpdateEnd::kUpdatedInPart);
  EXPECT_EQ(Bytes(PricesOf("ORE")), Bytes(edited));
  EXPECT_FALSE(home.Exists(kHostData + "ZAP.WDT"));
  EXPECT_EQ(PricesOf("XAD").size(), 3u);
  EXPECT_NE(LastSaid().find("ORE.WDT was changed since"), std::string::npos) << LastSaid();
  EXPECT_NE(LastSaid().find("ZAP.WDT was changed since"), std::string::npos) << LastSaid();
}

// A delivery of the same name with other lines is a day of its own.
TEST_F(FaultTest, AFileThatWasDeliveredAnewIsAskedAboutAsEver) {
  Lay([this] { LayAppend(); });
  ASSERT_TRUE(RunKilledAt(13));  // all of it is written
  Waiting("ORE,19980915,8,8,8,8,88,0\r\nZAP,19980915,3,3,3,3,21,0\r\n");
  EXPECT_EQ(Update(), UpdateEnd::kUpdated);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(LastSaid().substr(0, 40), " There is already data on file with this");
  EXPECT_EQ(Shown("ORE"), "19980911 1 10; 19980914 1 12; 19980915 8 88");
}

// What a machine leaves that lost its power: the file has grown, its bytes are zeros or half of
// the new ones.
TEST_F(FaultTest, HalfWrittenRecordsOfAPowerCutAreWrittenAgain) {
  const Store whole = WholeRun([this] { LayInsert(); });
  for (const char* damage : {"grown", "half", "mixed"}) {
    Lay([this] { LayInsert(); });
    const std::string old = home.Get(kHostData + "ORE.WDT");
    ASSERT_TRUE(RunKilledAt(7));
    const std::string fresh = whole.at("korawin/data/ORE.WDT");
    ASSERT_EQ(fresh.size(), old.size() + 50);
    std::string torn = old + std::string(50, '\0');
    if (damage[0] == 'h') torn.replace(0, 120, fresh, 0, 120);
    if (damage[0] == 'm')
      for (size_t i = 0; i < torn.size(); i += 3) torn[i] = fresh[i];
    home.Put(kHostData + "ORE.WDT", torn);
    EXPECT_EQ(Update(), UpdateEnd::kUpdated) << damage;
    EXPECT_TRUE(dialogs.said.empty()) << damage;
    EXPECT_TRUE(Everything() == whole) << damage;
  }
}

// Who is given a folder of data is given its journal too.
TEST_F(FaultTest, AJournalThatChangesOtherFilesThanAnUpdateDoesCountsAsNone) {
  for (const std::string path :
       {"c:\\korawin\\mine.txt", "c:\\mine\\xNames.dat", "c:\\.WDT\\mine"}) {
    Lay([this] { LayAppend(); });
    home.files().MakeFolder("c:\\mine");
    home.files().MakeFolder("c:\\.WDT");
    FileEdit edit;
    edit.path = path;
    edit.existed = false;
    edit.changes.push_back({0, "", "foreign"});
    WriteEditJournal(home.files(), kSystem + "Update.Jnl", "Entry=\r\nLeaving=0\r\n",
                     std::vector{edit});
    EXPECT_EQ(Update(), UpdateEnd::kUpdated) << path;
    EXPECT_FALSE(home.files().CheckFile(path)) << path;
    EXPECT_FALSE(home.Exists(kJournal)) << path;
  }
}

TEST_F(FaultTest, AJournalThatIsCutShortOrDamagedCountsAsNone) {
  Lay([this] { LayAppend(); });
  ASSERT_TRUE(RunKilledAt(7));
  const std::string journal = home.Get(kJournal);
  ASSERT_GT(journal.size(), 100u);
  for (size_t size = 0; size < journal.size(); size += 7) {
    home.Put(kJournal, journal.substr(0, size));
    EXPECT_FALSE(ReadEditJournal(home.files(), kSystem + "Update.Jnl")) << size;
  }
  for (size_t at = 0; at < journal.size(); at += 5) {
    std::string damaged = journal;
    damaged[at] = char(damaged[at] ^ 0x41);
    home.Put(kJournal, damaged);
    EXPECT_FALSE(ReadEditJournal(home.files(), kSystem + "Update.Jnl")) << at;
  }
  // Without a journal the day's data are found on file and asked about, or none of them were.
  EXPECT_EQ(Update(), UpdateEnd::kUpdated);
  EXPECT_FALSE(home.Exists(kJournal));
}
