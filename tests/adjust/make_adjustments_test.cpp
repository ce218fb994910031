#include "adjust/make_adjustments.h"

#include <filesystem>

#include "lists/chart_list.h"
#include "store/market_folders.h"
#include "tests/adjust/adjust_fixture.h"
#include "tests/support/forwarding_io.h"

namespace kora {
namespace {

using test::Bytes;
using test::Day;
using test::kData;
using test::kHostData;
using test::Security;

class MakeTest : public test::AdjustTest {
 protected:
  // Prices before 11 September, the date that the rows of the tests tell, are `before`.
  void ExpectScaled(const std::string& code, float before) {
    EXPECT_EQ(Closes(code), (std::vector<float>{before, before, before, before, 5}));
  }
  void ExpectUntouched(const std::string& code) { ExpectScaled(code, 5); }
};

// ---- The run

TEST_F(MakeTest, AnEmptyListOrOneRowWithoutACodeIsNoRun) {
  EXPECT_FALSE(Make({}).begun);
  EXPECT_FALSE(Make({"There is no bulletin data"}).begun);
  EXPECT_FALSE(There("Adjust.Lst"));
}

TEST_F(MakeTest, OtherServicesHaveNoBulletins) {
  settings.download.DataService = 4;
  EXPECT_FALSE(Make({"DC,ORE,a,,Y"}).begun);
  EXPECT_EQ(Names(), "BHP0 NEW0 ORE0");
}

TEST_F(MakeTest, DoesWhatIsMarkedAndTakesItOffTheList) {
  EXPECT_TRUE(Make({"BI,ORE,a,,Y,11SEP98,1,4", "BI,BHP,a,,N,11SEP98,1,4", "BI,BHP,a,,D,11SEP98,1,4",
                    "EN,ORE,a,,y"})
                  .begun);
  ExpectScaled("ORE", 4);
  ExpectUntouched("BHP");
  EXPECT_EQ(List(), "BI,BHP,a,,N,11SEP98,1,4\r\n");
  EXPECT_EQ(AdjustListText(rows), List());
  EXPECT_EQ(done, (std::vector<size_t>{0, 3}));
  EXPECT_EQ(progress.items[0], "Checking ORE");
  EXPECT_EQ(progress.items[1], "bi  Adjustment :ORE");
}

TEST_F(MakeTest, ARowWhoseActionWasSkippedIsDoneToo) {
  Make({"BI,ZZZ,a,,Y,11SEP98,1,4", "DI,ORE,a,,Y,baddate,,,25", "PC,ORE,a,,Y,11SEP98,nothing",
        "XX,ORE,a,,Y", "BI,ORE,a,,Y"});
  ExpectUntouched("ORE");
  EXPECT_EQ(List(), "");
}

TEST_F(MakeTest, AnUserStopsItBetweenTwoRows) {
  progress.stopAt = 2;
  const AdjustResult result = Make({"DC,ORE,a,,Y", "DC,BHP,a,,Y"});
  EXPECT_TRUE(result.stopped);
  EXPECT_EQ(List(), "DC,BHP,a,,Y\r\n");
  EXPECT_EQ(Names(), "BHP0 NEW0");
}

TEST_F(MakeTest, ARowThatFailsIsToldAndStaysWhileTheOthersAreDone) {
  home.files().Remove(kData + "ORE.WDT");
  Put("ORE.WDT/x", "");  // a folder where its prices would be
  const AdjustResult result = Make({"BI,ORE,a,,Y,11SEP98,1,4", "BI,BHP,a,,Y,11SEP98,1,4"});
  ASSERT_EQ(result.failures.size(), 1u);
  EXPECT_EQ(result.failures[0].substr(0, 5), "ORE: ");
  ExpectScaled("BHP", 4);
  EXPECT_EQ(List(), "BI,ORE,a,,Y,11SEP98,1,4\r\n");
  EXPECT_NE(FailuresText(result).find("ORE: "), std::string::npos);
  EXPECT_EQ(FailuresText({}), "");
}

TEST_F(MakeTest, AReadOnlyPriceFileIsToldByNameAndStays) {
  std::filesystem::permissions(home.path() + "/" + kHostData + "ORE.WDT",
                               std::filesystem::perms(0444));
  const AdjustResult result = Make({"BI,ORE,a,,Y,11SEP98,1,4", "PC,ORE,a,,Y,09SEP98,C:6"});
  ASSERT_EQ(result.failures.size(), 2u);
  EXPECT_NE(result.failures[0].find("ORE.WDT"), std::string::npos);
  ExpectUntouched("ORE");
  EXPECT_EQ(List(), "BI,ORE,a,,Y,11SEP98,1,4\r\nPC,ORE,a,,Y,09SEP98,C:6\r\n");
}

TEST_F(MakeTest, CodesThatAreNoFileNamesDoNothing) {
  for (const char* code : {"..\\ORE", "CON", "ORE.", "A*B", "../ORE", "TOOLONG1", ""}) {
    Make({"DC," + std::string(code) + ",a,,Y", "NC,ORE,a,,Y,11SEP98," + std::string(code)});
    EXPECT_EQ(Names(), "BHP0 NEW0 ORE0") << code;
    EXPECT_TRUE(There("ORE.WDT"));
  }
}

// ---- New names

TEST_F(MakeTest, ANewIssueRenamesAndStaysMarked) {
  for (int i = 0; i < 2; ++i) {  // doing it again rewrites the same name
    Make({"NI,ORE,a,,Y,ORE MINING,010"});
    EXPECT_EQ(NameOf("ORE").Name.trimmed(), "ORE MINING");
    EXPECT_EQ(NameOf("ORE").IndClass.trimmed(), "010");
    EXPECT_EQ(Names(), "BHP0 NEW0 ORE0");
    EXPECT_EQ(List(), "NI,ORE,a,,Y,ORE MINING,010\r\n");
    EXPECT_TRUE(done.empty());
    EXPECT_EQ(progress.items[1], "Adding ORE ORE MINING to Name File");
  }
}

TEST_F(MakeTest, AListingWithAPriceFileIsAddedToTheNameFile) {
  Put("LST.WDT", "");
  Make({"NL,LST,a,,Y,Listed \xE4,011", "NL,ZZZ,a,,Y,No prices,011", "NL,BHP,a,,Y,,011"});
  EXPECT_EQ(Names(), "BHP0 NEW0 ORE0 LST0");
  const NameRec rec = NameOf("LST");
  EXPECT_EQ(rec.Name.trimmed(), "Listed \xE4");
  EXPECT_EQ(rec.IndClass.trimmed(), "011");
  EXPECT_EQ(std::int32_t(rec.Category), 0);
  EXPECT_EQ(std::int32_t(rec.RecType), 4);
  EXPECT_EQ(rec.OtherDetails.trimmed(), "");
  EXPECT_EQ(float(rec.Base), 0);
  EXPECT_EQ(rec.MinMove, 0.05f);
  EXPECT_EQ(NameOf("BHP").IndClass.trimmed(), "");
}

// ---- Changes of name

TEST_F(MakeTest, ANewCodeWithoutPricesTakesTheFileAndTheRecordOver) {
  const auto before = Prices("ORE");
  Make({"NC,ORE,a,,Y,10SEP98,FOR"});
  EXPECT_EQ(Names(), "BHP0 NEW0 FOR0");
  EXPECT_EQ(Bytes(Prices("FOR")), Bytes(before));
  EXPECT_FALSE(There("ORE.WDT"));
  EXPECT_EQ(progress.items[1], "Name Change :OREto  FOR");
}

TEST_F(MakeTest, ANewCodeWithPricesTakesTheHistoryBeforeTheDate) {
  Put("ORE.OLD", "older");
  Make({"NC,ORE,a,,Y,10SEP98,NEW"});
  EXPECT_EQ(Names(), "BHP0 NEW0");
  EXPECT_EQ(Closes("NEW"), (std::vector<float>{5, 5, 5, 9, 9}));
  EXPECT_EQ(Prices("NEW")[3].RecDate.raw(), "19980910");
  EXPECT_FALSE(There("ORE.WDT"));
  EXPECT_EQ(home.Get(kHostData + "ORE.OLD"), Bytes(Days(5)));
  EXPECT_EQ(home.Get(kHostData + "NEW.OLD"), Bytes(Days(9)));
  EXPECT_EQ(home.Get(kHostData + "Names.bak").size(), 3 * 96u);
}

TEST_F(MakeTest, ANameChangeOfOneRecordLeavesTheFiles) {
  Put("ORE.WDT", Bytes(std::vector<PriceRec>{Day("19980907", 5, 5, 5, 5)}));
  Make({"NC,ORE,a,,Y,10SEP98,NEW"});
  EXPECT_EQ(Names(), "BHP0 NEW0");
  EXPECT_TRUE(There("ORE.WDT"));
  EXPECT_EQ(Closes("NEW"), (std::vector<float>{9, 9, 9, 9, 9}));
}

TEST_F(MakeTest, ANameChangeOfAnEmptyFileDropsTheRecord) {
  Put("ORE.WDT", "");
  Make({"NC,ORE,a,,Y,10SEP98,FOR"});
  EXPECT_EQ(Names(), "BHP0 NEW0");
  EXPECT_FALSE(There("FOR.WDT"));
}

TEST_F(MakeTest, ANameChangeWithoutItsInputsDoesNothing) {
  Make({"NC,ORE,a,,Y,bad,FOR", "NC,ZZZ,a,,Y,10SEP98,FOR", "NC,ORE,a,,Y,10SEP98,ORE"});
  EXPECT_EQ(Names(), "BHP0 NEW0 ORE0");
  EXPECT_TRUE(There("ORE.WDT"));
  home.files().Remove(kData + "BHP.WDT");
  Make({"NC,BHP,a,,Y,10SEP98,FOR"});
  EXPECT_EQ(Names(), "BHP0 NEW0 ORE0");
}

// ---- Removals

TEST_F(MakeTest, ARemovedSecurityLeavesItsPricesBesideTheOthers) {
  Put("ORE.OLD", "older");
  Make({"DC,ORE,a,,Y"});
  EXPECT_EQ(Names(), "BHP0 NEW0");
  EXPECT_FALSE(There("ORE.WDT"));
  EXPECT_EQ(home.Get(kHostData + "ORE.OLD"), Bytes(Days(5)));
  EXPECT_EQ(progress.items[1], "Removal :ORE");
}

TEST_F(MakeTest, TheCompactionLeavesOutEveryStatus) {
  std::vector<NameRec> names{Security("AAA"), Security("BBB"), Security("CCC"), Security("DDD")};
  names[0].NameStatus = 9;
  names[2].NameStatus = 1;
  Put("Names.dat", Bytes(names));
  CompactNames(home.files(), kData);
  EXPECT_EQ(Names(), "BBB0 DDD0");
  EXPECT_EQ(home.Get(kHostData + "Names.bak"), Bytes(names));
}

TEST_F(MakeTest, ChartListsFollowTheNameFile) {
  const std::vector<std::string> codes{"BHP", "ORE"};
  SaveSubList(home.files(), kData, kFirstChartList, codes);
  Make({"DC,BHP,a,,Y"});
  const auto list = ReadList(home.files(), kData, kFirstChartList);
  ASSERT_EQ(list.size(), 1u);
  EXPECT_EQ(list[0].ListRecNo, 2);
  EXPECT_EQ(list[0].ListCode.trimmed(), "ORE");
}

// ---- Bonus issues and splits

TEST_F(MakeTest, ABonusScalesWhatLiesBeforeItsDate) {
  Make({"BI,ORE,a,,Y,11SEP98,1,4"});
  ExpectScaled("ORE", 4);
  const auto prices = Prices("ORE");
  EXPECT_EQ(float(prices[3].High), 4.8f);
  EXPECT_EQ(std::int32_t(prices[3].Volume), 1000);
  EXPECT_EQ(prices[3].AdjDesc.trimmed(), "bi");
  EXPECT_EQ(float(prices[3].AdjFactor), 0.8f);
  EXPECT_EQ(float(prices[4].AdjFactor), 0);
}

TEST_F(MakeTest, ASplitHasItsFirstFigureNegative) {
  Make({"SP,ORE,a,,Y,11SEP98,-1,2"});  // 2 / (2 - 1)
  ExpectScaled("ORE", 10);
  EXPECT_EQ(Prices("ORE")[3].AdjDesc.trimmed(), "ss");
}

TEST_F(MakeTest, TheFactorHasFourDecimals) {
  Make({"BI,ORE,a,,Y,11SEP98,1,2"});  // 2 / 3
  EXPECT_EQ(float(Prices("ORE")[3].AdjFactor), 0.6667f);
  ExpectScaled("ORE", 3.3335f);
}

TEST_F(MakeTest, ABonusAtADayWithoutPricesTakesTheRecordBefore) {
  Make({"BI,ORE,a,,Y,15SEP98,1,4"});
  EXPECT_EQ(Closes("ORE"), (std::vector<float>{4, 4, 4, 4, 4}));
}

TEST_F(MakeTest, ABonusAtTheFirstRecordsIsSkipped) {
  for (const char* date : {"07SEP98", "08SEP98", "01SEP98", "06SEP98"}) {
    Make({"BI,ORE,a,,Y," + std::string(date) + ",1,4"});
    ExpectUntouched("ORE");
  }
}

TEST_F(MakeTest, RatiosThatGiveNoFactorAreSkipped) {
  for (const char* ratio : {"0,0", "-1,1", "1,0", "x,y", ",", "0", "-5,4", "5,-4"}) {
    Make({"BI,ORE,a,,Y,11SEP98," + std::string(ratio)});
    ExpectUntouched("ORE");
    EXPECT_EQ(List(), "") << ratio;
  }
}

TEST_F(MakeTest, FiguresThatLeaveTheCurrencyTypeAreToldAndNothingIsChanged) {
  const AdjustResult result = Make({"BI,ORE,a,,Y,11SEP98,1,99999999999999999999"});
  EXPECT_EQ(result.failures, (std::vector<std::string>{"ORE: Overflow"}));
  ExpectUntouched("ORE");
}

TEST_F(MakeTest, ChartNotesFollowThePrices) {
  home.Put(test::kHostMisc + "ORE.Txt",
           "T,8.25,19980910,5.00,Low,99\r\nT,8.25,19980911,5.00,After,99\r\n");
  Make({"BI,ORE,a,,Y,11SEP98,1,4"});
  EXPECT_EQ(home.Get(test::kHostMisc + "ORE.Txt"),
            "T,8.25,19980910,4.00,Low,255\r\nT,8.25,19980911,5.00,After,255\r\n");
}

// ---- Dividends

TEST_F(MakeTest, ADividendScalesByItsShareOfTheClose) {
  Make({"DI,ORE,a,,Y,11SEP98,,,25"});  // 1 - 0.25 / 5
  ExpectScaled("ORE", 4.75f);
  EXPECT_EQ(Prices("ORE")[3].AdjDesc.trimmed(), "dv0.25");
  EXPECT_EQ(float(Prices("ORE")[3].AdjFactor), 0.95f);
}

TEST_F(MakeTest, TheFactorOfADividendHasSixDecimals) {
  Put("ORE.WDT", Bytes(Days(3)));
  Make({"DI,ORE,a,,Y,11SEP98,,,10"});  // 1 - 0.1 / 3 = 0.9666667
  EXPECT_EQ(float(Prices("ORE")[3].AdjFactor), 0.966667f);
}

TEST_F(MakeTest, DividendsThatCanNotBeAreSkipped) {
  for (const char* cents : {"0", "-5", "x", "", "500", "600", "0.001"}) {
    Make({"DI,ORE,a,,Y,11SEP98,,," + std::string(cents)});
    ExpectUntouched("ORE");
  }
  auto days = Days(5);
  days[3].Close = 0;
  Put("ORE.WDT", Bytes(days));
  Make({"DI,ORE,a,,Y,11SEP98,,,25"});
  EXPECT_EQ(Bytes(Prices("ORE")), Bytes(days));
}

// ---- Price changes

TEST_F(MakeTest, ReplacesThePricesOfADay) {
  Make({"PC,ORE,a,,Y,09SEP98,O:5.5 H:7 L:0 C:6.25 V:123"});
  const PriceRec day = Prices("ORE")[2];
  EXPECT_EQ(float(day.Open), 5.5f);
  EXPECT_EQ(float(day.High), 7);
  EXPECT_EQ(float(day.Low), 4);  // 0 leaves it
  EXPECT_EQ(float(day.Close), 6.25f);
  EXPECT_EQ(std::int32_t(day.Volume), 123);
  EXPECT_EQ(float(Prices("ORE")[1].Close), 5);
  EXPECT_EQ(progress.items[1], "Price Changes for ORE");
}

TEST_F(MakeTest, ADayThatIsNotOnFileChangesNothing) {
  Make({"PC,ORE,a,,Y,12SEP98,C:6", "PC,ORE,a,,Y,01SEP98,C:6",
        "PC,ORE,a,,Y,09SEP98,C:x V:", "PC,ORE,a,,Y,09SEP98,C:-1"});
  ExpectUntouched("ORE");
}

TEST_F(MakeTest, OverseasPricesGoByTheirDefinition) {
  const auto defined = [](const std::string& code, const std::string& powers) {
    return std::string(22, ' ') + (code + "      ").substr(0, 6) + std::string(26, ' ') + powers +
           std::string(3, ' ');
  };
  home.Put("drive_c/bul/system/WMMAIN.OVS",
           defined("ORE", "-1 2") + defined("BHP", " 9 2") + defined("ZZZ", " 0 0"));
  Make({"PC,ORE,OVS,,Y,09SEP98,C:60 V:7", "PC,BHP,OVS,,Y,09SEP98,C:60 V:7",
        "PC,NEW,OVS,,Y,09SEP98,C:60 V:7"});
  EXPECT_EQ(float(Prices("ORE")[2].Close), 6);
  EXPECT_EQ(std::int32_t(Prices("ORE")[2].Volume), 700);
  EXPECT_EQ(float(Prices("BHP")[2].Close), 0.6f);  // a power out of range: 0.01, and no volume
  EXPECT_EQ(std::int32_t(Prices("BHP")[2].Volume), 1000);
  EXPECT_EQ(float(Prices("NEW")[2].Close), 0.6f);  // not in the file: 0.01, volume as it is
  EXPECT_EQ(std::int32_t(Prices("NEW")[2].Volume), 7);
}

// ---- The whole market

class MarketTest : public MakeTest {
 protected:
  MarketTest() {
    settings.download.DataService = 3;
    WmPaths lines{kData, "c:\\idx\\", "c:\\sfe\\", "c:\\ovs\\", "c:\\opt\\", "0", kData};
    WriteWmPaths(home.files(), "c:\\korawin\\", lines);
    for (const char* folder : {"idx", "sfe", "ovs", "opt"}) {
      const std::string place = "drive_c/" + std::string(folder) + "/";
      home.Put(place + "Names.dat", Bytes(std::vector<NameRec>{Security("ORE")}));
      home.Put(place + "ORE.WDT", Bytes(Days(5)));
    }
  }
  float CloseIn(const std::string& folder) {
    return PriceFile(home.files(), "c:\\" + folder + "\\ORE.WDT").Read(4).Close;
  }
  std::int32_t VolumeIn(const std::string& folder) {
    return PriceFile(home.files(), "c:\\" + folder + "\\ORE.WDT").Read(4).Volume;
  }
};

TEST_F(MarketTest, EachRowGoesToTheFolderOfItsMarket) {
  Make({"BI,ORE,IDX,,Y,11SEP98,1,4", "BI,ORE,SFE,,Y,11SEP98,1,1", "BI,ORE,OVS,,Y,11SEP98,4,1",
        "BI,ORE,OPT,,Y,11SEP98,3,1"});
  EXPECT_EQ(CloseIn("idx"), 4);
  EXPECT_EQ(CloseIn("sfe"), 2.5f);
  EXPECT_EQ(CloseIn("ovs"), 1);
  EXPECT_EQ(CloseIn("opt"), 1.25f);
  ExpectUntouched("ORE");
  Make({"BI,ORE,15SEP98,,Y,11SEP98,1,4"});
  ExpectScaled("ORE", 4);
}

TEST_F(MarketTest, PricesComeInCentsAndVolumesByTheDefinitions) {
  home.Put("drive_c/bul/system/WMDef.Lst", "1,Market,2\r\n0,Indices,3\r\n");
  Make({"PC,ORE,15SEP98,,Y,10SEP98,C:600 V:7", "PC,ORE,IDX,,Y,10SEP98,C:600 V:7",
        "PC,ORE,OVS,,Y,10SEP98,C:600 V:7"});
  EXPECT_EQ(float(Prices("ORE")[3].Close), 6);
  EXPECT_EQ(std::int32_t(Prices("ORE")[3].Volume), 700);
  EXPECT_EQ(CloseIn("idx"), 60);
  EXPECT_EQ(VolumeIn("idx"), 1000);  // a definition that is not used: 0, which replaces nothing
  EXPECT_EQ(CloseIn("ovs"), 6);      // not in the file of definitions: 0.01
  EXPECT_EQ(VolumeIn("ovs"), 7);
}

TEST_F(MarketTest, TheLastFoldersNameFileAloneIsCompacted) {
  Make({"DC,ORE,IDX,,Y", "DC,ORE,SFE,,Y"});
  EXPECT_EQ(ReadNames(home.files(), "c:\\sfe\\").size(), 0u);
  ASSERT_EQ(ReadNames(home.files(), "c:\\idx\\").size(), 1u);
  EXPECT_EQ(ReadNames(home.files(), "c:\\idx\\")[0].NameStatus, 9);
}

TEST_F(MarketTest, TellsWhichFoldersAreMissing) {
  EXPECT_TRUE(CheckMarketFolders(home.files(), settings, dialogs));
  WriteWmPaths(home.files(), "c:\\korawin\\", {});
  EXPECT_FALSE(CheckMarketFolders(home.files(), settings, dialogs));
  EXPECT_EQ(dialogs.said.back().title, "W/M Paths");
  settings.download.DataService = 1;
  EXPECT_TRUE(CheckMarketFolders(home.files(), settings, dialogs));
}

TEST_F(MarketTest, TheListIsFoundWhereTheBulletinsPutIt) {
  settings.paths.CurrentDataPath = "c:\\idx\\";
  EXPECT_EQ(AdjustFolder(home.files(), settings), "c:\\idx\\");
  Put("Adjust.Lst", "DC,ORE\r\n");
  EXPECT_EQ(AdjustFolder(home.files(), settings), kData);
  home.Put("drive_c/idx/Adjust.Lst", "");
  EXPECT_EQ(AdjustFolder(home.files(), settings), "c:\\idx\\");
}

// ---- Runs that die

// The machine's files without waiting for the disk: what dies here is the program.
class QuickIo : public test::ForwardingIo {
 public:
  class File : public test::ForwardingFile {
   public:
    using ForwardingFile::ForwardingFile;
    void Flush() override {}
  };
  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    return std::make_unique<File>(ForwardingIo::Open(path, mode));
  }
  void FlushFolder(const std::string&) override {}
};

class DyingTest : public MakeTest {
 protected:
  using State = std::map<std::string, std::string>;
  static State StateOf(const test::TempHome& home) {
    State out;
    for (const char* name : {"Names.dat", "Names.bak", "ORE.WDT", "ORE.OLD", "NEW.WDT", "NEW.OLD",
                             "FOR.WDT", "BHP.WDT", "BHP.OLD", "Adjust.Lst", "../chtmisc/ORE.Txt"})
      if (home.Exists(kHostData + name)) out[name] = home.Get(kHostData + name);
    return out;
  }
  // Dies at each of the writes in turn, and is run again: what is on file then is what a run
  // that did not die leaves.
  void DieEverywhere(const std::vector<std::string>& lines,
                     const std::function<void(const test::TempHome&)>& prepare, int by = 1) {
    const auto lay = [&](const test::TempHome& at) {
      Fill(at);
      prepare(at);
      at.Put(kHostData + "Adjust.Lst", AdjustListText(Rows(lines)));
    };
    const auto run = [&](Files& files) {
      try {
        { const auto held = files.lock().Hold(); }  // finishes what died
        AdjustRows list = ReadAdjustList(files, kData);
        MakeAdjustments({files, settings, test::kNoteColour, progress}, list, kData);
      } catch (const RunTimeError&) {
      }
    };
    QuickIo quick;
    test::TempHome whole(quick);
    lay(whole);
    const State laid = StateOf(whole);
    run(whole.files());
    const State wanted = StateOf(whole);
    EXPECT_NE(laid, wanted);
    int deaths = 0;
    for (int at = 1;; at += by) {
      SCOPED_TRACE(at);
      test::FailingIo io(quick);
      io.lasting = true;
      io.torn = true;
      test::TempHome dying(io);
      lay(dying);
      io.Reset(at);
      run(dying.files());
      if (io.calls < at) break;
      ++deaths;
      Files again(dying.path(), quick);
      run(again);
      ASSERT_EQ(StateOf(dying), wanted);
    }
    EXPECT_GT(deaths, 5);
  }
};

TEST_F(DyingTest, ABonusWithChartNotes) {
  DieEverywhere({"BI,ORE,a,,Y,11SEP98,1,4"}, [](const test::TempHome& at) {
    at.Put(test::kHostMisc + "ORE.Txt", "T,8.25,19980910,5.00,Low,99\r\n");
  });
}

TEST_F(DyingTest, ANameChangeToACodeWithPrices) {
  DieEverywhere({"NC,ORE,a,,Y,10SEP98,NEW"},
                [](const test::TempHome& at) { at.Put(kHostData + "ORE.OLD", "older"); });
}

TEST_F(DyingTest, ANameChangeToACodeWithoutPrices) {
  DieEverywhere({"NC,ORE,a,,Y,10SEP98,FOR"}, [](const test::TempHome&) {});
}

TEST_F(DyingTest, ANameChangeOfAnEmptyFile) {
  DieEverywhere({"NC,ORE,a,,Y,10SEP98,FOR"},
                [](const test::TempHome& at) { at.Put(kHostData + "ORE.WDT", ""); });
}

TEST_F(DyingTest, ANameChangeOfOneRecord) {
  DieEverywhere({"NC,ORE,a,,Y,10SEP98,NEW"}, [](const test::TempHome& at) {
    at.Put(kHostData + "ORE.WDT", Bytes(std::vector<PriceRec>{Day("19980907", 5, 5, 5, 5)}));
  });
}

TEST_F(DyingTest, ARemoval) {
  DieEverywhere({"DC,ORE,a,,Y"}, [](const test::TempHome&) {});
}

TEST_F(DyingTest, ADividendAndAPriceChange) {
  DieEverywhere({"DI,ORE,a,,Y,11SEP98,,,25", "PC,BHP,a,,Y,09SEP98,C:6"},
                [](const test::TempHome&) {});
}

// Each row once. The rows change their files in much the same way: steps of seven come to
// each place in it.
TEST_F(DyingTest, AListOfFiftyRows) {
  std::vector<std::string> lines;
  for (int i = 0; i < 47; ++i) lines.push_back("BI,ORE,a,,Y,11SEP98,1,9");
  lines.push_back("DC,BHP,a,,Y");
  lines.push_back("NC,ORE,a,,Y,10SEP98,NEW");
  lines.push_back("BI,NEW,a,,N,11SEP98,1,9");
  DieEverywhere(
      lines, [](const test::TempHome&) {}, 7);
}

// A disk that fills up: told, and every file as it was but for rows that were done before.
TEST_F(DyingTest, AFullDiskLeavesTheRowAsItWas) {
  const auto before = Prices("ORE");
  for (int at = 2;; ++at) {
    QuickIo quick;
    test::FailingIo io(quick);
    test::TempHome full(io);
    Fill(full);
    full.Put(kHostData + "Adjust.Lst", "BI,ORE,a,,Y,11SEP98,1,4\r\n");
    io.Reset(at);
    AdjustRows list = Rows({"BI,ORE,a,,Y,11SEP98,1,4"});
    bool failed = false;
    try {
      MakeAdjustments({full.files(), settings, 0, progress}, list, kData);
    } catch (const RunTimeError& e) {
      failed = true;
      EXPECT_EQ(e.number(), kDiskFull);
    }
    if (io.calls < at) break;
    const bool scaled = full.Get(kHostData + "ORE.WDT") != Bytes(before);
    const std::string text = full.Get(kHostData + "Adjust.Lst");
    if (!scaled) {
      EXPECT_TRUE(failed);
      EXPECT_NE(text.find(",Y,"), std::string::npos) << at;
    }
  }
}

}  // namespace
}  // namespace kora
