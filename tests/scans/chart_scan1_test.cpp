#include "scans/chart_scan1.h"

#include <filesystem>
#include <limits>

#include "base/runtime_error.h"
#include "scans/result_list.h"
#include "tests/scans/scan_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

using Texts = std::vector<std::string>;

class Scan1Test : public ScanMarket {
 protected:
  Scan1Test() {
    for (const char* key : {"StochK", "WmsA", "RocP", "RocA", "MMA", "RsiP"})
      osc.periods[key] = {2, 2};
  }
  // What is wrong with the choices: text, title and control.
  Texts FaultOf() {
    Scan1Criteria criteria;
    const auto fault = ReadScan1(choices, osc, criteria);
    return fault ? Texts{fault->text, fault->title, fault->field} : Texts{};
  }
  Scan1Result Scan() {
    Scan1Criteria criteria;
    EXPECT_EQ(ReadScan1(choices, osc, criteria), std::nullopt);
    return RunScan1(Run(), criteria);
  }
  // "code percent stochastic williams roc momentum rsi" of each hit, "-" for an empty cell.
  Texts Rows() {
    Texts out;
    for (const Scan1Hit& hit : Scan().hits) {
      const Texts cells = CellsOf(hit);
      std::string line = cells[0];
      for (size_t i = 2; i < 8; ++i) line += " " + (cells[i].empty() ? "-" : cells[i]);
      out.push_back(line);
    }
    return out;
  }
  // A share that stood between 10 and 20 each day and closed at these.
  void Between(std::string_view code, const std::vector<float>& closes) {
    std::vector<PriceRec> days = DaysOf(closes);
    for (PriceRec& day : days) day.High = 20, day.Low = 10;
    Add(Security(code), days);
  }
  void RiseOf(const std::string& percent) {
    choices.Check1 = true;
    choices.Text1 = percent;
  }
  void FallOf(const std::string& percent) {
    choices.Check15 = true;
    choices.Text6 = percent;
    choices.Text1 = "10";
  }
  void AllBoxes() { choices.Check9 = choices.Check10 = choices.Check11 = choices.Check12 = true; }

  Scan1Choices choices;
  OscSettings osc;
};

}  // namespace

namespace kora {
std::ostream& operator<<(std::ostream& out, const ScanFault& fault) { return out << fault.text; }
bool operator==(const ScanFault& a, const ScanFault& b) { return a.text == b.text; }
}  // namespace kora

// ---- Percentages

TEST_F(Scan1Test, ARiseOfExactlyThePercentIsAHit) {
  Closes("EXACT", {1, 2, 2.2f});
  Closes("LESS", {1, 2, 2.19f});
  Closes("CENTS", {1, 0.7f, 0.77f});
  RiseOf("10");
  EXPECT_EQ(Rows(), (Texts{"EXACT 10%U - - - - -", "CENTS 10%U - - - - -"}));
}

TEST_F(Scan1Test, AFallOfExactlyThePercentIsAHit) {
  Closes("EXACT", {1, 2, 1.8f});
  Closes("LESS", {1, 2, 1.81f});
  Closes("MORE", {1, 2, 0.5f});
  FallOf("10");
  EXPECT_EQ(Rows(), (Texts{"EXACT -10%D - - - - -", "MORE -75%D - - - - -"}));
}

TEST_F(Scan1Test, PercentagesAreRoundedToEven) {
  Closes("DOWN", {1, 2, 2.25f});  // 12.5
  Closes("UP", {1, 2, 2.75f});    // 37.5
  RiseOf("10");
  EXPECT_EQ(Rows(), (Texts{"DOWN 12%U - - - - -", "UP 38%U - - - - -"}));
}

TEST_F(Scan1Test, EqualClosesHitOnlyAFallOfZero) {
  Closes("SAME", {1, 2, 2});
  RiseOf("10");
  FallOf("1");
  EXPECT_EQ(Rows(), Texts{});
  FallOf("0");
  EXPECT_EQ(Rows(), (Texts{"SAME 0%D - - - - -"}));
}

TEST_F(Scan1Test, TwoRecordsAreTooFewForAPercentage) {
  Closes("TWO", {1, 2});
  Closes("THREE", {1, 1, 2});
  Closes("ONE", {2});
  RiseOf("10");
  EXPECT_EQ(Rows(), (Texts{"THREE 100%U - - - - -"}));
  EXPECT_EQ(Scan().unread.total(), 1);  // the file of one record alone
}

TEST_F(Scan1Test, ACloseOfZeroEndsThePercentage) {
  Closes("BEFORE", {1, 0, 2});
  Closes("LAST", {1, 2, 0});
  RiseOf("10");
  FallOf("10");
  EXPECT_EQ(Rows(), Texts{});
}

// ---- What is passed over

TEST_F(Scan1Test, PriceRangesAreInclusive) {
  Closes("LOW", {0.1f, 0.1f, 0.49f});
  Closes("MIN", {0.1f, 0.1f, 0.5f});
  Closes("MAX", {0.1f, 0.1f, 5});
  Closes("HIGH", {0.1f, 0.1f, 5.01f});
  RiseOf("10");
  choices.Check7 = true;
  EXPECT_EQ(Rows(), (Texts{"MIN 400%U - - - - -", "MAX 4900%U - - - - -"}));
}

TEST_F(Scan1Test, CategoryClassWarrantsAndKindsArePassedOver) {
  const auto days = DaysOf({1, 1, 2});
  Add(Security("CAT1", 1, kShare, "121"), days);
  Add(Security("CAT2", 2, kShare, "122"), days);
  Add(Security("INDEX", 2, kIndex, "131"), days);
  Add(Security("ADVDEC", 2, kAdvanceDecline, "121"), days);
  Add(Security("BHPWAB", 2, kShare, "12"), days);
  RiseOf("10");
  const auto codes = [&] {
    Texts out;
    for (const Scan1Hit& hit : Scan().hits) out.push_back(hit.code);
    return out;
  };
  EXPECT_EQ(codes(), (Texts{"CAT1", "CAT2", "INDEX", "BHPWAB"}));
  choices.Check16 = true;
  EXPECT_EQ(codes(), (Texts{"CAT1", "CAT2", "INDEX"}));
  choices.Check8 = true;
  choices.Text4 = "2";
  EXPECT_EQ(codes(), (Texts{"CAT2", "INDEX"}));
  choices.Check8 = choices.Check16 = false;
  choices.Check14 = true;
  choices.Text5 = "120";  // the group, of classes of three characters
  EXPECT_EQ(codes(), (Texts{"CAT1", "CAT2"}));
  choices.Text5 = "122";
  EXPECT_EQ(codes(), (Texts{"CAT2"}));
}

TEST_F(Scan1Test, TheLatestDateIsOfAllThatWasLookedAt) {
  Add(Security("OLD"), {Day("19990104", 1, 1, 1, 1), Day("19990105", 1, 1, 1, 1)});
  Add(Security("NEW"), {Day("19990901", 1, 1, 1, 1), Day("19990904", 1, 1, 1, 1)});
  Add(Security("MID"), {Day("19990104", 1, 1, 1, 1), Day("19990810", 1, 1, 1, 1)});
  RiseOf("10");
  EXPECT_EQ(Scan().latest, "19990904");
  EXPECT_EQ(LatestText("19990904"), "04/9/1999");
  EXPECT_EQ(LatestText("20261030"), "30/10/2026");
  EXPECT_EQ(LatestText(""), "");
  EXPECT_EQ(LatestText("2026x030"), "");
}

// ---- Oscillators

// A hand-made series for each outcome of the rule. Closes between 10 and 20: 17.5 and more is at the
// upper line of the Stochastic, 12.5 and less at the lower one.
TEST_F(Scan1Test, EachOutcomeOfTheRule) {
  Between("UP", {15, 15, 15, 14, 18});
  Between("OVER", {15, 15, 15, 18, 19});
  Between("DOWN", {15, 15, 15, 15, 12});
  Between("UNDER", {15, 15, 15, 12, 11});
  Between("OFF", {15, 15, 15, 18, 15});
  Between("BACK", {15, 15, 15, 12, 15});
  Between("NONE", {15, 15, 15, 15, 16});
  choices.oscillators[kStochastic] = true;
  AllBoxes();
  const auto cells = [&] {
    Texts out;
    for (const Scan1Hit& hit : Scan().hits) out.push_back(hit.code + " " + CellsOf(hit)[3]);
    return out;
  };
  EXPECT_EQ(cells(), (Texts{"UP Cut OB UP", "OVER OB", "DOWN Cut OS DN", "UNDER OS",
                            "OFF Cut OB DN", "BACK Cut OS UP"}));
  choices.Check9 = choices.Check10 = choices.Check11 = false;
  EXPECT_EQ(cells(), (Texts{"UP Cut OB UP", "OFF Cut OB DN"}));
  choices.Check12 = false;
  EXPECT_EQ(cells(), Texts{});
}

TEST_F(Scan1Test, EachOscillatorHasItsColumn) {
  // By hand in oscillator_tests_test: Williams 52 after 92, ROC and Momentum in the middle, RSI above.
  Closes("ALL", {10, 20, 10, 20, 15, 20});
  AllBoxes();
  for (size_t i = 0; i < kScanOscillators; ++i) {
    choices.oscillators = {};
    choices.oscillators[i] = true;
    for (const Scan1Hit& hit : Scan().hits) {
      const Texts cells = CellsOf(hit);
      for (size_t column = 0; column < kScanOscillators; ++column) {
        EXPECT_EQ(cells[3 + column].empty(), column != i) << i;
      }
    }
  }
  choices.oscillators.fill(true);
  // Stochastic over 3 closes: 100 after 0 percent. Changes over 2 bars: 0, 0, 5, 0: the end of ROC
  // and Momentum is in the middle after the top. RSI over the change -5, then 5: 0, then 5 / 2.
  EXPECT_EQ(Rows(), (Texts{"ALL - Cut OB UP - Cut OB DN Cut OB DN Cut OB UP"}));
}

TEST_F(Scan1Test, MomentumIsWorkedOverThePeriodOfRoc) {
  // Over 2 bars the changes are 0, 0, 5, 0; over 1 they are -10, 10, -5, 5, and 5 is no signal.
  Closes("ROC", {10, 20, 10, 20, 15, 20});
  osc.periods["MMA"] = {1, 1};
  choices.oscillators[kMomentum] = true;
  AllBoxes();
  EXPECT_EQ(Rows(), (Texts{"ROC - - - - Cut OB DN -"}));
  osc.periods["RocP"] = {1, 1};
  EXPECT_EQ(Rows(), Texts{});
}

// An oscillator sees the last 261 days and no more.
TEST_F(Scan1Test, OscillatorsSeeTheLastDaysAlone) {
  // A jump of 10000 hundredths lies 261 days back: within the range it would press the change of
  // the last day, 1, into the middle.
  std::vector<float> closes(300, 100);
  closes[299] = 101;
  for (int i = 0; i < 39; ++i) closes[size_t(i)] = 200;
  osc.periods["RocP"] = {1, 1};
  choices.oscillators[kMomentum] = true;
  AllBoxes();
  Closes("FAR", closes);
  closes[39] = closes[40] = 200;
  Closes("NEAR", closes);
  EXPECT_EQ(Rows(), (Texts{"FAR - - - - Cut OB UP -"}));
}

// ---- Bad files

TEST_F(Scan1Test, FilesThatCantBeReadArePassedOverAndCounted) {
  const auto days = DaysOf({1, 1, 2});
  auto nan = days;
  nan[2].High = std::numeric_limits<float>::quiet_NaN();
  Add(Security("GOOD"), days);
  Add(Security("NAN"), nan);
  Add(Security("ZERO"), DaysOf({0, 0, 0}));
  Add(Security("TORN"), days);
  home.Put(kHostData + "TORN.WDT", Bytes(days).substr(0, 120));
  Add(Security("NONE"), {});
  std::filesystem::remove(home.path() + "/" + kHostData + "NONE.WDT");
  Add(Security("ONE"), DaysOf({2}));
  Add(Security("LAST"), days);
  RiseOf("10");
  EXPECT_EQ(Rows(), (Texts{"GOOD 100%U - - - - -", "LAST 100%U - - - - -"}));
  EXPECT_EQ(UnreadText(Scan().unread), "5 files could not be read");
}

TEST_F(Scan1Test, NameFilesOfNoAndOneAndTwentyThousandRecords) {
  RiseOf("10");
  EXPECT_TRUE(Rows().empty());  // no file
  home.Put(kHostData + "Names.dat", "");
  EXPECT_TRUE(Rows().empty());
  Closes("ONE", {1, 1, 2});
  EXPECT_EQ(Rows().size(), 1u);
  // Twenty thousand names of one price file, the last a code that has none.
  names.assign(19999, Security("ONE"));
  names.push_back(Security("NONE"));
  home.Put(kHostData + "Names.dat", Bytes(names));
  const Scan1Result result = Scan();
  EXPECT_EQ(result.hits.size(), 19999u);
  EXPECT_EQ(result.hits.back().record, 19999);
  EXPECT_EQ(result.unread.missing, 1);
}

TEST_F(Scan1Test, AStopKeepsTheHitsSoFar) {
  for (const char* code : {"A", "B", "C", "D"}) Closes(code, {1, 1, 2});
  RiseOf("10");
  progress.stopAt = 3;
  const Scan1Result result = Scan();
  EXPECT_TRUE(result.stopped);
  EXPECT_EQ(result.hits.size(), 2u);
}

// ---- What is refused

TEST_F(Scan1Test, PriceRangesThatAreNone) {
  const Texts kMin{"Invalid price range", "Analysis", "Text3"};
  const Texts kMax{"Invalid price range", "Analysis", "Text2"};
  choices.Check7 = true;
  EXPECT_EQ(FaultOf(), Texts{});
  choices.Text3 = "";
  EXPECT_EQ(FaultOf(), kMin);
  choices.Text3 = "-1";
  EXPECT_EQ(FaultOf(), kMin);
  choices.Text3 = "5.01";
  EXPECT_EQ(FaultOf(), kMin);
  choices.Text3 = "5.00";
  EXPECT_EQ(FaultOf(), Texts{});
  choices.Text2 = " ";
  EXPECT_EQ(FaultOf(), kMax);
  choices.Text2 = "-0.01";
  EXPECT_EQ(FaultOf(), kMax);
  choices.Text2 = std::string(60, '9');
  EXPECT_EQ(FaultOf(), kMax);
  choices.Check7 = false;
  EXPECT_EQ(FaultOf(), Texts{});
}

TEST_F(Scan1Test, PercentagesOutsideTheirRange) {
  const Texts kRise{"Percentage Not valid - Valid Range 1 to 200 ", "Analysis", "Text1"};
  const Texts kFall{"Percentage Not valid - Valid Range 1 to 200 ", "Analysis", "Text6"};
  choices.Check1 = true;
  for (const char* bad : {"", "0", "-5", "200.5", "x"}) {
    choices.Text1 = bad;
    EXPECT_EQ(FaultOf(), kRise) << bad;
  }
  for (const char* good : {"1", "200", "0.5", "12abc"}) {
    choices.Text1 = good;
    EXPECT_EQ(FaultOf(), Texts{}) << good;
  }
  choices.Check15 = true;
  choices.Text6 = "";
  EXPECT_EQ(FaultOf(), kFall);
  choices.Text6 = "500";  // the range is that of the rise field
  EXPECT_EQ(FaultOf(), Texts{});
  choices.Text6 = "99999";
  EXPECT_EQ(FaultOf(), kFall);
}

TEST_F(Scan1Test, AFallNeedsTheRiseField) {
  choices.Check15 = true;
  choices.Text6 = "10";
  EXPECT_EQ(FaultOf()[0], "Percentage Not valid - Valid Range 1 to 200 ");
  choices.Text1 = "10";
  EXPECT_EQ(FaultOf(), Texts{});
}

TEST_F(Scan1Test, CategoriesAndClasses) {
  choices.Check8 = true;
  for (const char* bad : {"", "-1", "99999"}) {
    choices.Text4 = bad;
    EXPECT_EQ(FaultOf(), (Texts{"Category invalid", "Analysis", "Text4"})) << bad;
  }
  choices.Text4 = "0";
  choices.Check14 = true;
  choices.Text5 = "  ";
  EXPECT_EQ(FaultOf(), (Texts{"Industry Classification invalid", "Analysis", "Text5"}));
  choices.Text5 = "121";
  EXPECT_EQ(FaultOf(), Texts{});
}

TEST_F(Scan1Test, OscillatorsWithoutTheirPeriods) {
  const struct {
    ScanOscillator oscillator;
    const char* key;
    const char* name;
    const char* box;
  } cases[] = {{kStochastic, "StochK", "STOCHASTIC", "Check2"},
               {kWilliams, "WmsA", "WILLIAMS %R", "Check3"},
               {kRoc, "RocA", "RATE OF CHANGE", "Check5"},
               {kMomentum, "MMA", "MOMENTUM", "Check6"},
               {kRsi, "RsiP", "R.S.I", "Check13"}};
  for (const auto& c : cases) {
    osc.periods[c.key] = {0, 9};
    choices.oscillators = {};
    EXPECT_EQ(FaultOf(), Texts{});
    choices.oscillators[c.oscillator] = true;
    EXPECT_EQ(FaultOf(),
              (Texts{"Invalid " + std::string(c.name) +
                         " Oscillator Values. Correct the values in the CHART DEFAULTS List",
                     "Analysis", c.box}));
    osc.periods[c.key] = {2, 2};
  }
}

TEST_F(Scan1Test, TheFirstFaultInTheirOrderIsTold) {
  choices.Check7 = choices.Check1 = choices.Check8 = choices.Check14 = true;
  choices.Text3 = "";
  EXPECT_EQ(FaultOf()[2], "Text3");
  choices.Text3 = "1";
  EXPECT_EQ(FaultOf()[2], "Text1");
  choices.Text1 = "1";
  EXPECT_EQ(FaultOf()[2], "Text4");
  choices.Text4 = "1";
  EXPECT_EQ(FaultOf()[2], "Text5");
}

TEST(ScanFilterTest, ClassIdsArePadded) {
  EXPECT_EQ(PaddedIndustry("10"), "010");
  EXPECT_EQ(PaddedIndustry(" 121 "), "121");
  EXPECT_EQ(PaddedIndustry(""), "");
  EXPECT_EQ(PaddedIndustry("1a"), std::nullopt);
  EXPECT_EQ(PaddedIndustry("-1"), std::nullopt);
}

// ---- What is kept, told and stored

TEST_F(Scan1Test, ChoicesAreKept) {
  choices.Check7 = true;
  choices.Text3 = "0.20";
  choices.Text2 = "1,5";
  choices.Check1 = true;
  choices.Text1 = "10";
  choices.Text6 = "20";
  choices.Check8 = true;
  choices.Text4 = "12";
  const std::string kept = KeptScan1(choices);
  EXPECT_EQ(kept, "1,0.20,15,1,10,0,20,1,12,0,12");
  Scan1Choices back;
  TakeKeptScan1(kept, back);
  EXPECT_TRUE(back.Check7 && back.Check1 && !back.Check15 && back.Check8 && !back.Check16);
  EXPECT_EQ(back.Text3 + " " + back.Text1 + " " + back.Text6 + " " + back.Text4, "0.20 10 20 12");
  // What is missing leaves the defaults.
  Scan1Choices fresh;
  TakeKeptScan1("unknown", fresh);
  EXPECT_EQ(fresh.Text3 + fresh.Text2, "0.505.00");
  TakeKeptScan1("1,0.10", fresh);
  EXPECT_EQ(fresh.Text3 + fresh.Text2, "0.105.00");
}

TEST_F(Scan1Test, ClosingMessages) {
  Scan1Criteria c;
  EXPECT_EQ(Scan1Ending(c, true),
            "The codes have been stored in list Chart Scan Results List\n"
            " This list can be selected to view charts from the\n Chart Selection form.");
  EXPECT_EQ(Scan1Ending(c, false), "There were no Buy/Sell Indications ");
  c.rise = 10;
  c.riseText = "10";
  EXPECT_EQ(Scan1Ending(c, false), "There were no rises of 10%\n or Buy/Sell Indications ");
  c.fall = 5;
  c.fallText = "5.4";
  EXPECT_EQ(Scan1Ending(c, false),
            "There were no rises of 10% or falls of 5.4%\n or Buy/Sell Indications ");
  c.rise.reset();
  EXPECT_EQ(Scan1Ending(c, false), "There were no falls of 5.4%\n or Buy/Sell Indications ");
}

TEST(SortByPercentageTest, IsByTheTextOfTheCell) {
  const Texts cells{"9%U", "12%U", "", "-3%D", "-12%D", "100%U"};
  Texts sorted;
  for (const size_t i : SortByPercentage(cells)) sorted.push_back(cells[i]);
  EXPECT_EQ(sorted, (Texts{"", "-12%D", "-3%D", "100%U", "12%U", "9%U"}));
  EXPECT_TRUE(SortByPercentage({}).empty());
}

TEST_F(Scan1Test, CellsOfAHit) {
  Scan1Hit hit{.code = "ORE", .last = 1.5f, .percent = "-3%D", .signals = {}, .record = 12};
  hit.signals[kRoc] = Signal::kOs;
  EXPECT_EQ(CellsOf(hit), (Texts{"ORE", "1.50", "-3%D", "", "", "OS", "", "", "12"}));
  EXPECT_TRUE(hit.fell());
  hit.last = 0;
  EXPECT_EQ(CellsOf(hit)[1], "");
  EXPECT_EQ(CellsOf(hit).size(), Scan1Columns().size());
}

TEST_F(Scan1Test, TheResultListHoldsNumbersAndCodes) {
  SaveScan(home.files(), kData, {{" ore ", 2}, {"BHP", 32767}});
  const auto list = ReadList(home.files(), kData, kResultList);
  ASSERT_EQ(list.size(), 2u);
  EXPECT_EQ(list[0].ListRecNo, 2);
  EXPECT_EQ(list[0].ListCode.raw(), "ORE   ");
  EXPECT_EQ(list[1].ListRecNo, 32767);
  // A number beyond 16 bits leaves the list as it was.
  EXPECT_EQ(ErrorOf([&] { SaveScan(home.files(), kData, {{"A", 1}, {"B", 32768}}); }), kOverflow);
  EXPECT_EQ(ResultCodes(), (Texts{"ORE", "BHP"}));
}
