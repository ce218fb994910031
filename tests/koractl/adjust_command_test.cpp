#include <gtest/gtest.h>

#include <cstring>
#include <filesystem>

#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

constexpr const char* kPrices = "kora/drive_c/korawin/data/ORE.WDT";
constexpr const char* kNotes = "kora/drive_c/korawin/chtmisc/ORE.Txt";

class AdjustCommand : public testing::Test {
 protected:
  AdjustCommand() {
    EXPECT_EQ(Run({"init"}).code, 0);
    home.Put("kora/drive_c/korawin/data/Names.dat",
             Bytes<NameRec>({Security("XAD", 1, kAdvanceDecline), Security("ORE")}));
    Lay();
  }
  void Lay() {
    home.Put(kPrices,
             Bytes<PriceRec>({Day("19981001", 5, 5, 5, 5, 7), Day("19981002", 5, 6, 4, 5, 8),
                              Day("19981005", 4, 4, 4, 4, 9)}));
    home.Put(kNotes, "T,8.25,19981001,5.00,note,1\r\n");
  }
  ProgramResult Run(std::vector<std::string> words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(BinDir() + "/koractl", words);
  }
  ProgramResult Adjust(std::vector<std::string> words) {
    words.insert(words.begin(), "adjust");
    return Run(words);
  }
  PriceRec Record(int n) {
    PriceRec rec;
    std::memcpy(&rec, home.Get(kPrices).data() + size_t(n - 1) * sizeof rec, sizeof rec);
    return rec;
  }

  TempHome home;
};

TEST_F(AdjustCommand, AdjustsFromTheRecordOfItsOptionOrFromTheOneOfTheLookUp) {
  const ProgramResult done =
      Adjust({"bonus", "ore", "--date", "2/10/98", "--new", "1", "--held", "4", "--record", "2"});
  EXPECT_EQ(done.code, 0) << done.err;
  EXPECT_NE(done.err.find("[Data Adjustments] Adjustments made to\nORE"), std::string::npos)
      << done.err;
  EXPECT_EQ(Record(1).Close, 4);
  EXPECT_EQ(Record(2).High, 4.8f);
  EXPECT_EQ(Record(2).AdjFactor, 0.8f);
  EXPECT_EQ(Record(2).AdjDesc.trimmed(), "bi1:4");
  EXPECT_EQ(Record(3).Close, 4);
  EXPECT_EQ(home.Get(kNotes), "T,8.25,19981001,4.00,note,65535\r\n") << "in the colour of titles";
  // The last line of a short list is the one selected.
  EXPECT_EQ(Adjust({"split", "ORE", "--date", "2/10/98", "--new", "2", "--old", "1"}).code, 0);
  EXPECT_EQ(Record(3).AdjFactor, 0.5f);
  EXPECT_EQ(Record(3).AdjDesc.trimmed(), "ss2:1");
  EXPECT_EQ(Record(3).Close, 2);
}

TEST_F(AdjustCommand, EachKindTakesItsFigures) {
  const auto factor = [&](std::vector<std::string> words) {
    Lay();
    words.insert(words.begin() + 1, {"ORE", "--date", "2/10/98", "--record", "2"});
    EXPECT_EQ(Adjust(words).code, 0) << words[0];
    return Record(2).AdjFactor;
  };
  EXPECT_EQ(factor({"cash", "--new", "1", "--held", "4", "--cost", "2"}), 0.88f);
  EXPECT_EQ(Record(2).AdjDesc.trimmed(), "ci1:4 @ 2");
  EXPECT_EQ(factor({"call", "--amount", "0.5"}), 1.1f);
  EXPECT_EQ(factor({"dividend", "--amount", "0.25"}), 0.95f);
  EXPECT_EQ(Record(2).AdjDesc.trimmed(), "dv0.25");
}

TEST_F(AdjustCommand, RemovesTheLatestOrAsManyAsAreAskedFor) {
  const std::string before = home.Get(kPrices);
  for (const char* record : {"2", "3"})
    ASSERT_EQ(Adjust({"split", "ORE", "--date", "2/10/98", "--new", "2", "--old", "1", "--record",
                      record})
                  .code,
              0);
  ProgramResult removed = Adjust({"remove", "ORE"});
  EXPECT_EQ(removed.code, 0);
  EXPECT_EQ(removed.err, "[Remove Adjustment] Latest adjustment removed for ORE\n");
  EXPECT_EQ(Record(3).AdjFactor, 0);
  EXPECT_EQ(Record(2).AdjFactor, 0.5f);
  ASSERT_EQ(
      Adjust({"split", "ORE", "--date", "2/10/98", "--new", "2", "--old", "1", "--record", "3"})
          .code,
      0);
  removed = Adjust({"remove", "ORE", "--times", "5"});
  EXPECT_EQ(removed.code, 0);
  EXPECT_EQ(home.Get(kPrices), before);
  removed = Adjust({"remove", "ORE"});
  EXPECT_EQ(removed.code, 1);
  EXPECT_EQ(removed.err, "[Remove Adjustments] File has not previously been adjusted\n");
}

TEST_F(AdjustCommand, BadInputIsToldAndChangesNothing) {
  const std::string before = home.Get(kPrices), notes = home.Get(kNotes);
  const auto refused = [&](std::vector<std::string> words, const std::string& message) {
    const ProgramResult result = Adjust(words);
    EXPECT_EQ(result.code, 1) << message;
    EXPECT_EQ(result.err, message);
    EXPECT_EQ(home.Get(kPrices), before);
    EXPECT_EQ(home.Get(kNotes), notes);
  };
  const auto bonus = [](std::string date, std::string fresh, std::string held) {
    return std::vector<std::string>{"bonus",          "ORE",           "--date", date,
                                    "--new=" + fresh, "--held=" + held};
  };
  refused(bonus("2/10/98", "0", "4"), "[Adjust Data] Ratio Data incomplete\n");
  refused(bonus("2/10/98", "-1", "4"), "[Adjust Data] Ratio Data incomplete\n");
  refused(bonus("2/10/98", "a", "4"), "[ Data Input ]  Data must be numeric \n");
  refused(bonus("2/10/98", "1e30", "4"), "[Adjust Data] Overflow\n");
  refused(bonus("2/10/98", "1e60", "4"), "[ Data Input ]  Data must be numeric \n");
  refused(bonus("", "1", "4"), "[Adjust Data]  Date must be entered\n");
  for (const char* date : {"soon", "31/2/99", "2.10.98"})
    refused(bonus(date, "1", "4"),
            "[Incorrect Date Format ]  Use  /   or  -  to separate day/month/year\n"
            " eg.  2/10/93\n");
  refused(bonus("1/10/98", "1", "4"), "[Adjust Data] No close price on file for 1/10/98\n");
  refused({"dividend", "ORE", "--date", "2/10/98", "--amount", "5", "--record", "2"},
          "[Adjust Data] Overflow\n");
  refused({"dividend", "ORE", "--date", "2/10/98", "--amount", "0"},
          "[Adjust Data] Data incomplete\n");
  refused({"bonus", "ORE", "--date", "2/10/98", "--new", "1", "--held", "4", "--record", "4"},
          "[Adjust Data] Bad record number\n");
  refused({"bonus", "NONE", "--date", "2/10/98", "--new", "1", "--held", "4"},
          "[Name File] No File For That Name\n");
  refused({"remove", "XAD"}, "[Adjust Data] Only shares and indices can be adjusted\n");
  EXPECT_EQ(Adjust({"bonus", "ORE", "--new", "1", "--held", "4"}).code, 2);
  EXPECT_EQ(Adjust({"remove", "ORE", "--times", "0"}).code, 2);
  EXPECT_EQ(Adjust({}).code, 2);
}

TEST_F(AdjustCommand, ACloseOfZeroAndAReadOnlyFileAreTold) {
  home.Put(kPrices, Bytes<PriceRec>({Day("19981001", 5, 5, 5, 5), Day("19981002", 5, 5, 5, 0)}));
  const std::string before = home.Get(kPrices);
  ProgramResult result =
      Adjust({"dividend", "ORE", "--date", "2/10/98", "--amount", "1", "--record", "2"});
  EXPECT_EQ(result.code, 1);
  EXPECT_EQ(result.err, "[Adjust Data] Division by zero\n");
  std::filesystem::permissions(home.path() + "/" + kPrices, std::filesystem::perms(0444));
  result = Adjust({"bonus", "ORE", "--date", "2/10/98", "--new", "1", "--held", "4"});
  EXPECT_EQ(result.code, 1);
  EXPECT_EQ(result.err, "[Adjust Data] ORE.WDT is read-only\n");
  EXPECT_EQ(home.Get(kPrices), before);
}

TEST_F(AdjustCommand, ANearestDateThatIsAnotherIsToldAndTaken) {
  const ProgramResult result =
      Adjust({"bonus", "ORE", "--date", "4/10/98", "--new", "1", "--held", "4"});
  EXPECT_EQ(result.code, 0);
  EXPECT_NE(result.err.find("[Adjust Data] No close price on file for 4/10/98\n"
                            " Nearest date prior is 02/10/1998\n Close price is 5\n"),
            std::string::npos)
      << result.err;
}

}  // namespace
}  // namespace kora::test
