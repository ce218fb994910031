#include "update/master_list.h"

#include "tests/support/error_of.h"
#include "tests/support/mutate.h"
#include "tests/update/update_fixture.h"

using namespace kora;
using namespace kora::test;

namespace {

class MasterTest : public UpdateFixture {
 protected:
  std::optional<std::int32_t> Make(std::string_view text) {
    home.Put("list.csv", text);
    return MakeMasterList(home.files(), kSystem, home.path() + "/list.csv", dialogs);
  }
  MasterEntry Find(const std::string& code, std::int32_t start = 1) {
    return FindMaster(ReadMasterList(home.files(), kSystem), code, start);
  }
  const std::string kList =
      "Code,Type,Category,Class,Name,Details\n"
      "ZAP,5,50,,Zap Index,\n"
      "ore,4,1,121,Ore Mining Ltd,Ord\n"
      "BHP,4,22,7,Big Hole,\n"
      "aux,4,,,Auxiliary,\n"  // kept as 1AUX, as its prices are
      "OAK,4,3,341,Oak,\n";
};

}  // namespace

TEST_F(MasterTest, MakesRecordsOrderedByCodeAndAnIndex) {
  EXPECT_EQ(Make(kList), 5);
  const std::string bytes = home.Get(kHostSystem + "KoraName.Mas");
  ASSERT_EQ(bytes.size(), 5u * 62);
  EXPECT_EQ(bytes.substr(0, 6), "1AUX  ");
  EXPECT_EQ(bytes.substr(3 * 62, 62),
            "ORE   4 1121"
            "Ore Mining Ltd                    "
            " "
            "Ord            ");
  EXPECT_EQ(home.Get(kHostSystem + "KoraName.idx"),
            "0,2,0,0,0,0,0,0,0,0,0,0,0,0,3,0,0,0,0,0,0,0,0,0,0,5\r\n");
}

TEST_F(MasterTest, FindsAnEntryFromItsLetterOn) {
  Make(kList);
  const MasterList list = ReadMasterList(home.files(), kSystem);
  EXPECT_EQ(list.StartOf("ore"), 3);
  const MasterEntry e = FindMaster(list, " ore", list.StartOf("ore"));
  EXPECT_EQ(e.code, "ORE");
  EXPECT_EQ(e.type, "4");
  EXPECT_EQ(e.category, "1");
  EXPECT_EQ(e.IndClass, "121");
  EXPECT_EQ(e.name, "Ore Mining Ltd");
  EXPECT_EQ(e.details, "Ord");
  EXPECT_EQ(Find("OAK", 2).code, "OAK");  // from a record of an earlier letter
}

TEST_F(MasterTest, AStartBeyondTheListFindsNothing) {
  Make(kList);
  EXPECT_EQ(Find("ZAP", 6).code, "");
  EXPECT_EQ(Find("ZAP", 0).code, "");
  EXPECT_EQ(Find("ORE", 5).code, "");  // begins behind it
  EXPECT_EQ(Find("OBX").code, "");
}

TEST_F(MasterTest, ALetterWithoutEntryFindsNothingAndTheRowsStay) {
  Make(kList);
  std::vector<EditorRow> rows{{"QQQ", "Keep", "", "4", "1", "001"},
                              {"1AUX", "Keep", "", "", "", ""}};
  EXPECT_TRUE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(rows[0].name, "Keep");
  EXPECT_EQ(rows[1].name, "Keep");
  EXPECT_EQ(rows[1].type, "");
}

TEST_F(MasterTest, TickedItemsKeepWhatTheyHave) {
  Make(kList);
  std::vector<EditorRow> rows{{"BHP", "Mine", "", "", "7", ""}, {"", "Blank", "", "", "", ""}};
  EXPECT_TRUE(
      UpdateFromMaster(home.files(), kSystem, rows, {true, true, true, true, true}, dialogs));
  EXPECT_EQ(rows[0].name, "Mine");
  EXPECT_EQ(rows[0].details, "");
  EXPECT_EQ(rows[0].type, "4");
  EXPECT_EQ(rows[0].category, "7");
  EXPECT_EQ(rows[0].IndClass, "007");
  EXPECT_EQ(rows[1].name, "Blank");
  EXPECT_TRUE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(rows[0].name, "Big Hole");
  EXPECT_EQ(rows[0].category, "22");
}

TEST_F(MasterTest, AnItemThatTheMasterLacksStays) {
  Make(kList);
  std::vector<EditorRow> rows{{"ZAP", "Mine", "Details", "4", "7", "121"}};
  EXPECT_TRUE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(rows[0].details, "Details");
  EXPECT_EQ(rows[0].IndClass, "121");
  EXPECT_EQ(rows[0].type, "5");
}

TEST_F(MasterTest, AMissingListIsTold) {
  std::vector<EditorRow> rows;
  EXPECT_FALSE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(LastTitle(), "KORA Master List");
  EXPECT_EQ(LastSaid(),
            "There is no master list (KoraName.Mas) in folder c:\\korawin\\Either "
            "download a current file from the KORA web page or ring KORA ");
}

TEST_F(MasterTest, AnIndexThatCannotBeReadIsTold) {
  Make(kList);
  for (const char* text : {"", "1,2,3\r\n", "\xFF\xFE"}) {
    home.Put(kHostSystem + "KoraName.idx", text);
    std::vector<EditorRow> rows{{"BHP", "", "", "", "", ""}};
    EXPECT_FALSE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
    EXPECT_EQ(LastTitle(), "Master List");
    EXPECT_EQ(rows[0].name, "");
  }
  std::filesystem::remove(home.path() + "/" + kHostSystem + "KoraName.idx");
  std::vector<EditorRow> rows;
  EXPECT_FALSE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(LastSaid(), "There is a problem with the Master list");
}

TEST_F(MasterTest, AHostileIndexLeadsNowhere) {
  Make(kList);
  home.Put(kHostSystem + "KoraName.idx",
           "-5,99999,0,0,0,0,0,0,0,0,0,0,0,0,2147483647,0,0,0,0,0,0,0,0,0,0,1\r\n");
  const MasterList list = ReadMasterList(home.files(), kSystem);
  EXPECT_EQ(FindMaster(list, "AAA", list.StartOf("AAA")).code, "");
  EXPECT_EQ(FindMaster(list, "BHP", list.StartOf("BHP")).code, "");
  EXPECT_EQ(FindMaster(list, "ORE", list.StartOf("ORE")).code, "");
}

TEST_F(MasterTest, ATableBesideTheListUnscramblesIt) {
  // Each digit and letter for the one behind it, the last for the first; nothing for the signs
  // between them, which stay.
  std::string table;
  for (int c = 48; c <= 122; ++c) {
    const int next = c == '9' ? 'A' : c == 'Z' ? 'a' : c == 'z' ? '0' : c + 1;
    const bool sign = (c > '9' && c < 'A') || (c > 'Z' && c < 'a');
    table += std::to_string(sign ? 0 : next) + "\r\n";
  }
  home.Put(kHostSystem + "KoraName.Tab", table);
  EXPECT_EQ(Make(kList), 5);
  const std::string bytes = home.Get(kHostSystem + "KoraName.Mas");
  EXPECT_EQ(bytes.substr(3 * 62, 26), "ORE   3 0010Nqd Lhmhmf Ksc");
  EXPECT_EQ(Find("ORE").name, "Ore Mining Ltd");
  EXPECT_EQ(Find("BHP").category, "22");
  EXPECT_EQ(Make("AAA,4,1,,A:B [Z] @9a0,\nBBB,4,1,,b,\n"), 2);
  EXPECT_EQ(home.Get(kHostSystem + "KoraName.Mas").substr(12, 13), "9:A [Y] @8Zz ");
  EXPECT_EQ(Find("AAA").name, "A:B [Z] @9a0");
  home.Put(kHostSystem + "KoraName.Tab", "48\r\n49\r\n");
  EXPECT_EQ(ErrorOf([&] { LoadMasterTable(home.files(), kSystem); }), kBadCall);
}

TEST_F(MasterTest, ALineThatCannotBeTakenRefusesTheList) {
  Make(kList);
  const auto before = Everything();
  for (const char* line : {"..,4,1,1,x,", "ORE,x,1,1,x,", "ORE,4,100,1,x,", "ORE,4,1,1234,x,",
                           "ORE,4,1,1,12345678901234567890123456789012345,",
                           "ORE,4,1,1,x,123456789012345", "ORE,4,1,1,x,y,z", "ORE,4,1,1,\x01,"}) {
    EXPECT_FALSE(Make("BHP,4,1,1,a,b\n" + std::string(line) + "\n")) << line;
    EXPECT_NE(LastSaid().find("list.csv line 2: "), std::string::npos) << LastSaid();
    EXPECT_EQ(LastTitle(), "KORA Master List");
  }
  EXPECT_FALSE(Make("BHP,4,1,1,a,b\n"));  // fewer than 2 count as none
  EXPECT_EQ(Everything(), before);
}

TEST_F(MasterTest, AShortListCountsAsMissing) {
  home.Put(kHostSystem + "KoraName.Mas", std::string(123, 'A'));
  EXPECT_TRUE(ReadMasterRecords(home.files(), kSystem).empty());
  home.Put(kHostSystem + "KoraName.Mas", std::string(124, 'A'));
  EXPECT_EQ(ReadMasterRecords(home.files(), kSystem).size(), 2u);
  EXPECT_EQ(MasterMissingLines()[2], "or ring KORA ");
  EXPECT_EQ(LookUpStart(3), 1);
  EXPECT_EQ(LookUpStart(4), 1);
  EXPECT_EQ(LookUpStart(10), 7);
}

TEST_F(MasterTest, AStartRecordAboveTheCountReturnsEmptyFields) {
  Make(kList);
  const MasterEntry e = Find("ZAP", 6);
  EXPECT_EQ(e.code + e.type + e.category + e.IndClass + e.name + e.details, "");
  EXPECT_EQ(Find("ZAP", 2147483647).name, "");
  EXPECT_EQ(Find("ZAP", 5).name, "Zap Index");
}

TEST_F(MasterTest, ACodeWhoseLetterHasNoEntryFindsNothingAndTheGridKeepsItsValues) {
  Make(kList);
  const MasterList list = ReadMasterList(home.files(), kSystem);
  EXPECT_EQ(list.StartOf("QQQ"), 0);
  EXPECT_EQ(FindMaster(list, "QQQ", list.StartOf("QQQ")).code, "");
  std::vector<EditorRow> rows{{"QQQ", "Keep", "d", "4", "1", "001"}};
  EXPECT_TRUE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(rows[0].name + rows[0].details + rows[0].type + rows[0].category + rows[0].IndClass,
            "Keepd41001");
}

TEST_F(MasterTest, TheCharacterBetweenNameAndDetailsIsReadForBoth) {
  std::string rec = "AAA   4 1121" + std::string(34, 'n') + "X" + std::string(14, 'd') + "?";
  ASSERT_EQ(rec.size(), 62u);
  home.Put(kHostSystem + "KoraName.Mas", rec + rec);
  MasterList list;
  list.Records = ReadMasterRecords(home.files(), kSystem);
  EXPECT_EQ(list.Entry(1).name, std::string(34, 'n') + "X");
  EXPECT_EQ(list.Entry(1).details, "X" + std::string(14, 'd'));
}

TEST_F(MasterTest, BlanksInTheIndexDoNotCount) {
  Make(kList);
  std::string text = "0, 2 ,";
  for (int i = 2; i < 26; ++i) text += i == 14 ? " 3" : i == 25 ? ",5 " : i == 2 ? "0" : ", 0";
  text.replace(text.find(" 3"), 2, " , 3");
  home.Put(kHostSystem + "KoraName.idx", text);
  const MasterList list = ReadMasterList(home.files(), kSystem);
  EXPECT_EQ(list.StartOf("BHP"), 2);
  EXPECT_EQ(list.StartOf("ORE"), 3);
  EXPECT_EQ(list.StartOf("ZAP"), 5);
}

// A list read with a table that is not its own must not fill the name file with rubbish.
TEST_F(MasterTest, NumbersOfAForeignListAreNotTaken) {
  std::string rec = "AAA   x9E9E9Name" + std::string(46, ' ');
  rec.resize(62, ' ');
  home.Put(kHostSystem + "KoraName.Mas", rec + rec);
  home.Put(kHostSystem + "KoraName.idx", "1,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0");
  std::vector<EditorRow> rows{{"AAA", "", "", "4", "7", "121"}};
  EXPECT_TRUE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(rows[0].type, "4");
  EXPECT_EQ(rows[0].category, "7");
  EXPECT_EQ(rows[0].IndClass, "121");
}

TEST_F(MasterTest, StoppingInTheMiddleLeavesTheRows) {
  struct Stopping : ScriptedDialogs {
    std::unique_ptr<Progress> StartProgress(std::string_view) override {
      struct Two : Progress {
        bool Step(int done, int) override { return done < 2; }
      };
      return std::make_unique<Two>();
    }
  } stopping;
  Make(kList);
  std::vector<EditorRow> rows{{"BHP", "a", "", "", "", ""}, {"ORE", "b", "", "", "", ""}};
  EXPECT_FALSE(UpdateFromMaster(home.files(), kSystem, rows, {}, stopping));
  EXPECT_EQ(rows[0].name, "a");
}

TEST_F(MasterTest, OddListsIndexesAndTablesEndInAMessageOrNothing) {
  const std::string mas =
      "AAA   4 1121" + std::string(50, 'n') + "BBB   4 1121" + std::string(50, 'n');
  std::string table;
  for (int c = 48; c <= 122; ++c) table += std::to_string(c) + "\n";
  const std::string idx = "1,2,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0\r\n";
  const std::map<std::string, std::string> whole{
      {"KoraName.Mas", mas}, {"KoraName.idx", idx}, {"KoraName.Tab", table}};
  int refused = 0, taken = 0;
  for (const auto& [name, text] : whole) {
    for (const auto& [other, bytes] : whole) home.Put(kHostSystem + other, bytes);
    Mutator(11).Run({text, ""}, 200, [&, file = name](const std::string& damaged) {
      home.Put(kHostSystem + file, damaged);
      std::vector<EditorRow> rows{{"AAA", "", "", "", "", ""}, {"ZZZ", "z", "", "", "", ""}};
      dialogs.said.clear();
      if (UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs)) {
        ++taken;
        EXPECT_TRUE(dialogs.said.empty());
      } else {
        ++refused;
        EXPECT_EQ(LastTitle(), "Master List");
        EXPECT_EQ(rows[0].name, "");
      }
      EXPECT_EQ(rows[1].name, "z");
    });
  }
  EXPECT_GT(refused, 0);
  EXPECT_GT(taken, 0);
}

TEST_F(MasterTest, AHugeListIsRefused) {
  home.Put(kHostSystem + "KoraName.idx", "1,2,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0");
  home.Put(kHostSystem + "KoraName.Mas", "AAA");
  std::filesystem::resize_file(home.path() + "/" + kHostSystem + "KoraName.Mas", 300u << 20);
  EXPECT_EQ(ErrorOf([&] { ReadMasterRecords(home.files(), kSystem); }), kOutOfMemory);
  std::vector<EditorRow> rows{{"AAA", "", "", "", "", ""}};
  EXPECT_FALSE(UpdateFromMaster(home.files(), kSystem, rows, {}, dialogs));
  EXPECT_EQ(LastSaid(), "There is a problem with the Master list");
  home.Put(kHostSystem + "KoraName.Tab", "");
  std::filesystem::resize_file(home.path() + "/" + kHostSystem + "KoraName.Tab", 300u << 20);
  EXPECT_EQ(ErrorOf([&] { LoadMasterTable(home.files(), kSystem); }), kOutOfMemory);
}

TEST_F(MasterTest, HostilePlainListsAreRefusedWithTheirLine) {
  Make(kList);
  const auto before = Everything();
  const std::string utf16(
      "\xFF\xFE"
      "B\0H\0P\0,\0",
      10),
      nul("BHP,4,1,1,a\0b,c\n", 16);
  for (const std::string& text :
       {utf16, nul, std::string(3u << 20, 'q'), std::string("ORE,4,1,1,a,b\rBHP,4,1,1,a,b\r"),
        std::string("../X,4,1,1,a,b\n"), std::string("NUL,4,1,1,a,b\n")}) {
    EXPECT_FALSE(Make(text));
    EXPECT_NE(LastSaid().find("list.csv line 1: "), std::string::npos) << LastSaid();
  }
  std::filesystem::resize_file(home.path() + "/list.csv", 65u << 20);
  EXPECT_FALSE(MakeMasterList(home.files(), kSystem, home.path() + "/list.csv", dialogs));
  EXPECT_EQ(Everything(), before);
}

TEST_F(MasterTest, AFullDiskLeavesTheOldListAndIndex) {
  Make(kList);
  const std::string mas = home.Get(kHostSystem + "KoraName.Mas");
  const std::string idx = home.Get(kHostSystem + "KoraName.idx");
  home.Put("list.csv", "AAA,4,1,1,a,\nBBB,4,1,1,b,\nCCC,4,1,1,c,\n");
  for (int at = 1;; ++at) {
    io.Reset(at);
    const auto count = MakeMasterList(home.files(), kSystem, home.path() + "/list.csv", dialogs);
    const bool cut = io.calls >= at;
    io.Reset();
    EXPECT_EQ(count.has_value(), !cut);
    if (!cut) break;
    EXPECT_EQ(home.Get(kHostSystem + "KoraName.Mas"), mas) << at;
    EXPECT_EQ(home.Get(kHostSystem + "KoraName.idx"), idx) << at;
  }
}
