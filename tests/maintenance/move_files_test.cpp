#include "maintenance/move_files.h"

#include "tests/maintenance/maintenance_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class MoveFilesTest : public MaintenanceTest {
 protected:
  const std::string kA = "c:\\m\\a\\", kB = "c:\\m\\b\\";
  const std::string kHostA = "drive_c/m/a/", kHostB = "drive_c/m/b/";
  MoveFilesTest() {
    Names({Security("AAA"), Security("ORE", 7), Security("ZAP")}, kHostA);
    Names({Security("BBB"), Security("PPP")}, kHostB);
  }
  bool Move(const std::string& code = "ORE") {
    return MoveDataFile(home.files(), kA, kB, code, progress, dialogs);
  }
  // What the target holds behind a move of `source` onto `target`.
  std::string Merged(const std::vector<PriceRec>& source, const std::vector<PriceRec>& target) {
    Prices("ORE", source, kHostA);
    Prices("ORE", target, kHostB);
    std::filesystem::remove(home.path() + "/" + kHostB + "ORE.OLD");
    EXPECT_TRUE(Move()) << LastSaid();
    EXPECT_EQ(Bytes(PricesOf("ORE", kA)), Bytes(source));
    // The old target is kept where it was replaced, and only then.
    const bool same = Bytes(PricesOf("ORE", kB)) == Bytes(target);
    EXPECT_EQ(home.Exists(kHostB + "ORE.OLD"), !same);
    if (!same) {
      EXPECT_EQ(home.Get(kHostB + "ORE.OLD"), Bytes(target));
    }
    return Shown("ORE", kB);
  }
};

const PriceRec k1 = Flat("19980901", 1), k2 = Flat("19980902", 2), k3 = Flat("19980903", 3),
               k4 = Flat("19980904", 4);
const PriceRec m1 = Flat("19980901", 11), m2 = Flat("19980902", 12), m3 = Flat("19980903", 13),
               m4 = Flat("19980904", 14);

}  // namespace

TEST_F(MoveFilesTest, CopiesAFileThatIsNotThereAndPlacesItsNameByCode) {
  Prices("ORE", {k1, k2}, kHostA);
  ASSERT_TRUE(Move("ore"));
  EXPECT_EQ(Shown("ORE", kB), "19980901 1; 19980902 2");
  EXPECT_EQ(Shown("ORE", kA), "19980901 1; 19980902 2");  // the source stays
  EXPECT_EQ(CodesOfNames(kB), "BBB ORE PPP");
  EXPECT_EQ(int(NamesOf(kB)[1].Category), 7);
  EXPECT_EQ(CodesOfNames(kA), "AAA ORE ZAP");
  EXPECT_FALSE(home.Exists(kHostB + "ORE.OLD"));
  EXPECT_EQ(progress.states, (std::vector<std::string>{"COMPLETED"}));
}

TEST_F(MoveFilesTest, ASourceThatCoversTheTargetReplacesIt) {
  EXPECT_EQ(Merged({k1, k2, k3}, {m2}), "19980901 1; 19980902 2; 19980903 3");
  EXPECT_EQ(Merged({k1, k2, k3}, {m2, m3}), "19980901 1; 19980902 2; 19980903 3");  // ends alike
  EXPECT_EQ(progress.states,
            (std::vector<std::string>{"Merging Files", "COMPLETED", "Merging Files", "COMPLETED"}));
}

// On a common date the file that starts earlier wins, up to its end.
TEST_F(MoveFilesTest, TheFileThatStartsEarlierWinsUpToItsEnd) {
  EXPECT_EQ(Merged({k1, k2, k3}, {m2, m3, m4}), "19980901 1; 19980902 2; 19980903 3; 19980904 14");
  EXPECT_EQ(Merged({k2, k3, k4}, {m1, m2, m3}),
            "19980901 11; 19980902 12; 19980903 13; 19980904 4");
}

TEST_F(MoveFilesTest, FilesThatStartAlikeGoByTheTarget) {
  EXPECT_EQ(Merged({k1, k2, k3}, {m1, m2}), "19980901 11; 19980902 12; 19980903 3");
}

TEST_F(MoveFilesTest, ATargetThatCoversTheSourceStaysAsItIs) {
  EXPECT_EQ(Merged({k2, k3}, {m1, m2, m3, m4}),
            "19980901 11; 19980902 12; 19980903 13; 19980904 14");
  EXPECT_EQ(Merged({k1, k2}, {m1, m2}), "19980901 11; 19980902 12");
  EXPECT_EQ(Merged({}, {m1}), "19980901 11");
}

TEST_F(MoveFilesTest, FilesThatDoNotMeetAreJoined) {
  EXPECT_EQ(Merged({k1, k2}, {m3, m4}), "19980901 1; 19980902 2; 19980903 13; 19980904 14");
  EXPECT_EQ(Merged({k3, k4}, {m1, m2}), "19980901 11; 19980902 12; 19980903 3; 19980904 4");
}

TEST_F(MoveFilesTest, AnOlderOldFileIsReplaced) {
  home.Put(kHostB + "ORE.OLD", "older");
  Prices("ORE", {k1, k2}, kHostA);
  Prices("ORE", {m2}, kHostB);
  ASSERT_TRUE(Move());
  EXPECT_EQ(home.Get(kHostB + "ORE.OLD"), Bytes(std::vector{m2}));
}

TEST_F(MoveFilesTest, OneFolderByAnyNameIsRefused) {
  Prices("ORE", {k1}, kHostA);
  std::filesystem::create_directory_symlink("a", home.path() + "/drive_c/m/link");
  for (const char* folder : {"c:\\m\\a\\", "C:\\M\\A", "c:\\m\\link\\"}) {
    EXPECT_FALSE(MoveDataFile(home.files(), kA, folder, "ORE", progress, dialogs)) << folder;
    EXPECT_EQ(LastSaid(), "You have the same folder selected for both Source and Destination");
  }
}

TEST_F(MoveFilesTest, FailuresAreToldInTheWordsOfCopying) {
  EXPECT_FALSE(Move());
  EXPECT_EQ(LastTitle(), "Copy Error");
  EXPECT_EQ(LastSaid(), "Cannot copy - reselect file and try again");
  EXPECT_FALSE(Move("../X"));
  EXPECT_EQ(LastSaid(), "Cannot copy - reselect file and try again");
  EXPECT_FALSE(MoveDataFile(home.files(), kA, "c:\\nowhere\\", "ORE", progress, dialogs));
  EXPECT_EQ(LastSaid(),
            "Cannot copy - there is a path or file access error. Reselect file and try again");
  Prices("ORE", {k1}, kHostA);
  io.Reset(2);
  EXPECT_FALSE(Move());
  EXPECT_EQ(LastSaid(), "Cannot copy - destination disk is full");
}

TEST_F(MoveFilesTest, AFailureLeavesEverything) {
  Prices("ORE", {k1, k2}, kHostA);
  Prices("ORE", {m2, m3}, kHostB);
  EXPECT_GT(FailedEverywhere([&] { return Move(); }), 6);
}

TEST_F(MoveFilesTest, AKilledMoveIsCompletedByTheSameOne) {
  const auto names = [&] {
    Names({Security("AAA"), Security("ORE", 7)}, kHostA);
    Names({Security("BBB"), Security("PPP")}, kHostB);
    Prices("ORE", {k1, k2}, kHostA);
  };
  EXPECT_GT(KilledEverywhere(names, [&] { return Move(); }), 4);
  // A rerun finds the file merged, and keeps the target of the first run as it is.
  EXPECT_GT(KilledEverywhere(
                [&] {
                  names();
                  Prices("ORE", {m2, m3}, kHostB);
                },
                [&] { return Move(); }),
            6);
}
