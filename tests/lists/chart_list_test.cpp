#include "lists/chart_list.h"

#include <gtest/gtest.h>

#include "base/runtime_error.h"
#include "platform/settings_file.h"
#include "store/name_rec.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/mutate.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::ErrorOf;
using kora::test::FailingIo;
using kora::test::Mutator;
using kora::test::TempHome;

namespace {

constexpr std::string_view kData = "drive_c/korawin/data/";

struct ListFixture {
  explicit ListFixture(Io& io = MachineIo()) : home(io) {}

  TempHome home;
  std::string dataPath = "c:\\korawin\\data\\";
  SettingsFile user{home.files(), "c:\\windows\\KoraUser.ini"};

  void Names(const std::vector<std::string>& codes) const {
    std::string bytes;
    for (const std::string& code : codes) {
      const NameRec rec = NewNameRec(code);
      bytes.append(reinterpret_cast<const char*>(&rec), sizeof rec);
    }
    home.Put(std::string(kData) + "Names.dat", bytes);
  }
  void Put(const std::string& file, std::string_view bytes) const {
    home.Put(std::string(kData) + file, bytes);
  }
  std::string Get(const std::string& file) const { return home.Get(std::string(kData) + file); }
  ListCodes Save(std::int16_t list, const ListCodes& codes) {
    return SaveSubList(home.files(), dataPath, list, codes);
  }
  std::vector<ListRec> Read(std::int16_t list) { return ReadList(home.files(), dataPath, list); }
};

// A record as it lies in the file.
std::string Record(int number, std::string_view code) {
  std::string out;
  out += char(number & 0xFF);
  out += char((number >> 8) & 0xFF);
  return out + PadRight(code, 6);
}

std::vector<size_t> At(std::initializer_list<size_t> places) { return places; }

}  // namespace

TEST(ChartListTest, WhatIsMovedIsSavedInBothListsOrInNone) {
  FailingIo io;
  ListFixture f(io);
  f.Names({"AAA", "BHP", "WOW"});
  const std::string a = Record(1, "AAA") + Record(2, "BHP"), b = Record(3, "WOW");
  for (int at = 1;; ++at) {
    SCOPED_TRACE(at);
    f.Put("SubListA.Dat", a);
    f.Put("SubListB.Dat", b);
    std::vector<ListSide> sides{{2, {"AAA", "BHP"}}, {3, {"WOW"}}};
    ASSERT_EQ(MoveItems(sides[0], sides[1], At({1})), "");
    io.Reset(at);
    const int error = ErrorOf([&] { SaveSides(f.home.files(), f.dataPath, sides); });
    const bool met = io.calls >= at;
    io.Reset();
    if (!met) {
      EXPECT_EQ(f.Get("SubListA.Dat"), Record(1, "AAA"));
      EXPECT_EQ(f.Get("SubListB.Dat"), b + Record(2, "BHP"));
      EXPECT_GT(at, 4);
      break;
    }
    EXPECT_EQ(error, kDiskFull);
    EXPECT_EQ(f.Get("SubListA.Dat"), a);
    EXPECT_EQ(f.Get("SubListB.Dat"), b);
  }
}

TEST(ChartListTest, ASideThatHasNotChangedIsNotSaved) {
  ListFixture f;
  f.Names({"AAA"});
  f.Put("SubListA.Dat", Record(9, "AAA"));
  EXPECT_TRUE(SaveSides(f.home.files(), f.dataPath,
                        std::vector<ListSide>{{2, {"AAA"}, false}, {3, {}, false}})
                  .empty());
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(9, "AAA"));
  EXPECT_FALSE(f.home.Exists(std::string(kData) + "SubListB.Dat"));
}

TEST(ChartListTest, ElevenFilesByNumber) {
  const char* names[] = {"SubListA.Dat", "SubListB.Dat", "SubListC.Dat", "SubListD.Dat",
                         "SubListE.Dat", "SubListF.Dat", "SubListG.Dat", "SubListH.Dat",
                         "SubListJ.Dat", "SubListK.Dat", "SubListZ.Dat"};
  for (int i = 0; i < 11; ++i) EXPECT_EQ(ListFileName(std::int16_t(2 + i)), names[i]);
  for (const int number : {-1, 0, 1, 13, 32767})
    EXPECT_EQ(ErrorOf([&] { ListFileName(std::int16_t(number)); }), kBadCall) << number;
}

TEST(ChartListTest, NamesShowTheirDefaultsUntilKept) {
  ListFixture f;
  EXPECT_EQ(ChartListName(f.user, 2), "Chart List A");
  EXPECT_EQ(ChartListName(f.user, 9), "Chart List H");
  EXPECT_EQ(ChartListName(f.user, 10), "Chart List J");
  EXPECT_EQ(ChartListName(f.user, 11), "Chart List K");
  EXPECT_EQ(ChartListName(f.user, 12), "Chart Scan Results");
  EXPECT_EQ(ErrorOf([&] { ChartListName(f.user, 1); }), kBadCall);
}

TEST(ChartListTest, NamesAreSavedAndABlankOneBringsItsOwnBack) {
  ListFixture f;
  UserListNames names = GetSubLists(f.user);
  names[0] = "Banks";
  names[9] = "  Gold miners ";
  names[3] = "";
  ASSERT_TRUE(SaveSLNames(f.user, names));
  const SettingsFile again(f.home.files(), "c:\\windows\\KoraUser.ini");
  EXPECT_EQ(ChartListName(again, 2), "Banks");
  EXPECT_EQ(ChartListName(again, 3), "Chart List B");
  EXPECT_EQ(ChartListName(again, 5), "Chart List D");
  EXPECT_EQ(ChartListName(again, 11), "Gold miners");
  EXPECT_EQ(ChartListName(again, 12), "Chart Scan Results");
}

TEST(ChartListTest, NoFileAndAnEmptyFileAreEmptyLists) {
  ListFixture f;
  EXPECT_TRUE(f.Read(2).empty());
  f.Put("SubListA.Dat", "");
  EXPECT_TRUE(f.Read(2).empty());
  f.Names({"AAA"});
  EXPECT_TRUE(f.Save(2, {}).empty());
  EXPECT_TRUE(f.home.Exists(std::string(kData) + "SubListA.Dat"));
}

TEST(ChartListTest, SaveWritesRecordNumbersAndPaddedCodes) {
  ListFixture f;
  f.Names({"AAA", "BHP", "WOW"});
  f.Put("SubListA.Dat", std::string(80, 'x'));
  EXPECT_TRUE(f.Save(2, {"wow", " BHP "}).empty());
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(3, "WOW") + Record(2, "BHP"));
}

TEST(ChartListTest, SaveDropsCodesThatLeftAndBlankOnes) {
  ListFixture f;
  f.Names({"AAA", "BHP"});
  EXPECT_EQ(f.Save(12, {"GONE", "BHP", "", "   ", "BHPTOOLONG", "..\\X"}),
            (ListCodes{"GONE", "BHPTOOLONG", "..\\X"}));
  EXPECT_EQ(f.Get("SubListZ.Dat"), Record(2, "BHP"));
}

TEST(ChartListTest, SaveTakesTheFirstRecordOfACode) {
  ListFixture f;
  f.Names({"AAA", "BHP", "BHP"});
  f.Save(3, {"BHP"});
  EXPECT_EQ(f.Get("SubListB.Dat"), Record(2, "BHP"));
}

TEST(ChartListTest, StaleNumbersStayUntilTheListIsSavedAgain) {
  ListFixture f;
  f.Names({"AAA", "BHP", "WOW"});
  f.Save(2, {"WOW", "AAA"});
  f.Names({"AAA", "BBB", "BHP", "WOW"});
  ASSERT_EQ(f.Read(2).size(), 2u);
  EXPECT_EQ(f.Read(2)[0].ListRecNo, 3);  // BHP now stands there
  f.Save(2, CodesOf(f.Read(2)));
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(4, "WOW") + Record(1, "AAA"));
}

TEST(ChartListTest, ImpossibleRecordNumbersAreReadAsTheyStandAndMendedBySaving) {
  ListFixture f;
  f.Names({"AAA", "BHP"});
  f.Put("SubListC.Dat",
        Record(0, "AAA") + Record(-1, "BHP") + Record(32767, "AAA") + Record(-32768, "BHP"));
  const auto records = f.Read(4);
  ASSERT_EQ(records.size(), 4u);
  EXPECT_EQ(records[0].ListRecNo, 0);
  EXPECT_EQ(records[1].ListRecNo, -1);
  EXPECT_EQ(records[2].ListRecNo, 32767);
  EXPECT_EQ(records[3].ListRecNo, -32768);
  f.Save(4, CodesOf(records));
  EXPECT_EQ(f.Get("SubListC.Dat"),
            Record(1, "AAA") + Record(2, "BHP") + Record(1, "AAA") + Record(2, "BHP"));
}

TEST(ChartListTest, TornRecordAtTheEndDoesNotCount) {
  ListFixture f;
  f.Put("SubListA.Dat", Record(1, "AAA") +
                            "\x02\x01"
                            "BHP  ");
  ASSERT_EQ(f.Read(2).size(), 1u);
  f.Put("SubListA.Dat", "1234567");
  EXPECT_TRUE(f.Read(2).empty());
}

TEST(ChartListTest, CodesOfABinaryFileAreNoCodesOfTheNameFile) {
  ListFixture f;
  f.Names({"AAA"});
  std::string bytes;
  for (int i = 0; i < 256; ++i) bytes += char(i);
  f.Put("SubListA.Dat", bytes + std::string(8, '\0') + Record(7, "AAA"));
  const ListCodes codes = CodesOf(f.Read(2));
  EXPECT_EQ(codes.size(), 33u);  // the record of NULs is blank
  EXPECT_EQ(f.Save(2, codes).size(), 32u);
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(1, "AAA"));
}

TEST(ChartListTest, MoreRecordsThanSixteenBitsAreAnOverflow) {
  ListFixture f;
  f.Names({"AAA"});
  f.Put("SubListA.Dat", std::string(32768 * 8, ' '));
  EXPECT_EQ(ErrorOf([&] { f.Read(2); }), kOverflow);
  EXPECT_EQ(ErrorOf([&] { f.Save(2, ListCodes(32768, "AAA")); }), kOverflow);
  EXPECT_EQ(f.Get("SubListA.Dat").size(), 32768u * 8);
  f.Put("SubListA.Dat", std::string(32767 * 8 + 7, ' '));
  EXPECT_EQ(f.Read(2).size(), 32767u);
}

TEST(ChartListTest, SaveWithoutANameFileLeavesTheList) {
  ListFixture f;
  f.Put("SubListA.Dat", Record(1, "AAA"));
  EXPECT_EQ(ErrorOf([&] { f.Save(2, {"AAA"}); }), kFileNotFound);
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(1, "AAA"));
}

TEST(ChartListTest, FolderInPlaceOfAListIsAnAccessError) {
  ListFixture f;
  f.Put("SubListA.Dat/inside", "x");
  EXPECT_EQ(ErrorOf([&] { f.Read(2); }), kPathAccess);
}

TEST(ChartListTest, SaveCutOffAnywhereLeavesTheOldListOrTheNew) {
  for (int at = 1;; ++at) {
    FailingIo io;
    ListFixture f(io);
    f.Names({"AAA", "BHP"});
    const std::string before = Record(9, "AAA"), after = Record(2, "BHP") + Record(1, "AAA");
    f.Put("SubListA.Dat", before);
    io.torn = io.lasting = true;
    io.Reset(at);
    const int error = ErrorOf([&] { f.Save(2, {"BHP", "AAA"}); });
    if (error == 0) {
      EXPECT_EQ(f.Get("SubListA.Dat"), after);
      EXPECT_GT(at, 3);
      break;
    }
    EXPECT_EQ(error, kDiskFull);
    // The seventh call flushes the folder: on a disk that stays broken the new list stays.
    EXPECT_EQ(f.Get("SubListA.Dat"), at < 7 ? before : after) << at;
  }
}

TEST(ChartListTest, CheckAllListsRefreshesEveryFileThatIsThere) {
  ListFixture f;
  f.Names({"AAA", "BHP", "WOW"});
  f.Put("SubListA.Dat", Record(9, "WOW") + Record(1, "GONE"));
  f.Put("SubListK.Dat", "");
  f.Put("SubListZ.Dat", Record(0, "BHP") + Record(3, "AAA") + "\x01");
  const ListCheck check = CheckAllLists(f.home.files(), f.dataPath);
  EXPECT_EQ(check.lists, 3);
  EXPECT_EQ(check.removed, 1);
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(3, "WOW"));
  EXPECT_EQ(f.Get("SubListK.Dat"), "");
  EXPECT_EQ(f.Get("SubListZ.Dat"), Record(2, "BHP") + Record(1, "AAA"));
  EXPECT_FALSE(f.home.Exists(std::string(kData) + "SubListB.Dat"));
}

TEST(ChartListTest, CheckCanLeaveTheResultListOut) {
  ListFixture f;
  f.Names({"AAA"});
  f.Put("SubListK.Dat", Record(9, "AAA"));
  f.Put("SubListZ.Dat", Record(9, "AAA"));
  EXPECT_EQ(CheckAllLists(f.home.files(), f.dataPath, kLastUserList).lists, 1);
  EXPECT_EQ(f.Get("SubListK.Dat"), Record(1, "AAA"));
  EXPECT_EQ(f.Get("SubListZ.Dat"), Record(9, "AAA"));
}

TEST(ChartListTest, CheckWithoutANameFileLeavesEveryList) {
  ListFixture f;
  f.Put("SubListA.Dat", Record(9, "AAA"));
  EXPECT_EQ(ErrorOf([&] { CheckAllLists(f.home.files(), f.dataPath); }), kFileNotFound);
  EXPECT_EQ(f.Get("SubListA.Dat"), Record(9, "AAA"));
}

TEST(ChartListTest, DamagedListsAreMendedByACheck) {
  ListFixture f;
  f.Names({"AAA", "BHP", "WOW"});
  const std::string good = Record(1, "AAA") + Record(2, "BHP") + Record(3, "WOW");
  Mutator(9).Run({good, good + good, Record(-1, "AAA"), ""}, 150, [&](const std::string& bytes) {
    f.Put("SubListA.Dat", bytes);
    ASSERT_EQ(f.Read(2).size(), bytes.size() / 8);
    CheckAllLists(f.home.files(), f.dataPath);
    for (const ListRec& rec : f.Read(2)) {
      ASSERT_GE(rec.ListRecNo, 1);
      ASSERT_LE(rec.ListRecNo, 3);
      const std::string_view codes[] = {"AAA   ", "BHP   ", "WOW   "};
      ASSERT_EQ(rec.ListCode.raw(), codes[rec.ListRecNo - 1]);
    }
  });
}

TEST(ChartListTest, CodesAreAddedOnceInUpperCase) {
  ListCodes list;
  EXPECT_TRUE(AddCode(list, " bhp "));
  EXPECT_FALSE(AddCode(list, "BHP"));
  EXPECT_FALSE(AddCode(list, "   "));
  EXPECT_TRUE(AddCode(list, "AAA"));
  EXPECT_EQ(list, (ListCodes{"BHP", "AAA"}));
}

TEST(ChartListTest, TypedCodeIsLookedUpInAnyCase) {
  const ListCodes names{"AAA", "BHP", "BHPWX1"};
  EXPECT_EQ(FindTypedCode(names, " bhp"), 1u);
  EXPECT_EQ(FindTypedCode(names, "bh"), std::nullopt);
  EXPECT_EQ(FindTypedCode(names, ""), std::nullopt);
  EXPECT_EQ(kCodeNotFound, "Code not found");
}

TEST(ChartListTest, ItemsAreDeletedByPlace) {
  ListCodes list{"A", "B", "C", "D"};
  DeleteItems(list, At({3, 1, 3, 9}));
  EXPECT_EQ(list, (ListCodes{"A", "C"}));
  DeleteItems(list, {});
  EXPECT_EQ(list, (ListCodes{"A", "C"}));
}

TEST(ChartListTest, Questions) {
  EXPECT_EQ(DeleteQuestion("BHP"), "Delete BHP  ?");
  EXPECT_EQ(DeleteAllFromQuestion("Banks"), "Delete all items from Banks");
  EXPECT_EQ(ChangedQuestion("Banks"), "Banks has changed. SAVE Changes?");
  EXPECT_EQ(ChangedQuestion(""), "List has changed. SAVE Changes?");
}

TEST(TwoListsTest, BothMustBeShownAndDiffer) {
  ListSide a{2, {"A"}}, b{0, {}}, c{2, {}};
  EXPECT_EQ(CopyItems(a, b, At({0})), "Both lists must be displayed");
  EXPECT_EQ(MoveItems(b, a, At({0})), "Both lists must be displayed");
  EXPECT_EQ(CopyItems(a, c, At({0})), "Lists cannot be same");
  EXPECT_EQ(MoveItems(a, c, At({0})), "Lists cannot be same");
  EXPECT_EQ(a.Codes, (ListCodes{"A"}));
  EXPECT_TRUE(b.Codes.empty() && c.Codes.empty());
  EXPECT_FALSE(a.Changed || b.Changed || c.Changed);
}

TEST(TwoListsTest, CopyAppendsInListOrderWhatIsNotThere) {
  ListSide from{2, {"A", "B", "C"}}, to{3, {"B"}};
  EXPECT_EQ(CopyItems(from, to, At({2, 1, 0})), "");
  EXPECT_EQ(to.Codes, (ListCodes{"B", "A", "C"}));
  EXPECT_TRUE(to.Changed);
  EXPECT_EQ(from.Codes, (ListCodes{"A", "B", "C"}));
}

TEST(TwoListsTest, CopyOfWhatIsThereChangesNothing) {
  ListSide from{2, {"A"}}, to{3, {"A"}};
  EXPECT_EQ(CopyItems(from, to, At({0})), "");
  EXPECT_FALSE(to.Changed);
}

TEST(TwoListsTest, MoveTakesItemsOutThoseTooThatTheOtherHad) {
  ListSide from{2, {"A", "B", "C"}}, to{3, {"B"}};
  EXPECT_EQ(MoveItems(from, to, At({1, 2})), "");
  EXPECT_EQ(from.Codes, (ListCodes{"A"}));
  EXPECT_EQ(to.Codes, (ListCodes{"B", "C"}));
  EXPECT_TRUE(from.Changed && to.Changed);
  EXPECT_EQ(MoveItems(from, to, At({7})), "");
  EXPECT_EQ(from.Codes, (ListCodes{"A"}));
}
