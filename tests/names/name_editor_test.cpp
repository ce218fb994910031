#include "names/name_editor.h"

#include <gtest/gtest.h>

#include <cstring>

#include "lists/chart_list.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

using C = NameColumn;
constexpr const char* kHost = "drive_c/korawin/data/Names.dat";

class NameEditorTest : public testing::Test {
 protected:
  NameEditorTest() {
    home.Put("drive_c/korawin/data/x", "");
    Put({Security("CCC", 2), Security("AAA", 2), Security("BBB", 1)});
  }
  void Put(const std::vector<NameRec>& rows) {
    home.Put(kHost, Bytes(rows));
    editor.Load();
  }
  std::string Codes() {
    std::string out;
    for (const NameRec& rec : ReadNames(home.files(), data)) out += NameCell(rec, C::kCode) + ".";
    return out;
  }
  std::string Shown() {
    std::string out;
    for (const NameRec& rec : editor.rows()) out += NameCell(rec, C::kCode) + ".";
    return out;
  }
  static std::vector<ListRec> List(
      const std::vector<std::pair<std::int16_t, const char*>>& records) {
    std::vector<ListRec> out(records.size());
    for (size_t i = 0; i < out.size(); ++i) {
      out[i].ListRecNo = records[i].first;
      out[i].ListCode.set(records[i].second);
    }
    return out;
  }
  std::string Numbers(std::int16_t list) {
    std::string out;
    for (const ListRec& rec : ReadList(home.files(), data, list))
      out += std::to_string(rec.ListRecNo) + std::string(rec.ListCode.trimmed()) + " ";
    return out;
  }
  std::string Said() {
    std::string out;
    for (const auto& said : dialogs.said) out += "[" + said.title + "] " + said.text + "|";
    dialogs.said.clear();
    return out;
  }

  const std::string data = "c:\\korawin\\data\\", system = "c:\\korawin\\";
  FailingIo io;
  TempHome home{io};
  ScriptedDialogs dialogs;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  DownloadSettings download;
  NameEditor editor{{home.files(), data, system, dialogs, ini, download}};
};

TEST_F(NameEditorTest, SavesInOrderOfCategoryAndShowsThatOrder) {
  const std::string old = home.Get(kHost);
  editor.Sort(NameSort::kCode);
  EXPECT_EQ(Shown(), "AAA.BBB.CCC.");
  EXPECT_TRUE(editor.changed());
  EXPECT_EQ(home.Get(kHost), old);  // a view until it is saved
  EXPECT_TRUE(editor.SaveNames().saved);
  EXPECT_EQ(Codes(), "BBB.AAA.CCC.");
  EXPECT_EQ(Shown(), "BBB.AAA.CCC.");
  EXPECT_FALSE(editor.changed());
  EXPECT_EQ(home.Get("drive_c/korawin/data/names.bak"), old);
}

// Another program fills its blanks in its own way, and has bytes where this one has none.
TEST_F(NameEditorTest, AForeignFileKeepsWhatNoCellShows) {
  std::vector<NameRec> rows{Security("AAA", 1), Security("BBB", 1), Security("CCC", 1)};
  const auto bytes = [](NameRec& rec) { return reinterpret_cast<char*>(&rec); };
  std::memcpy(bytes(rows[0]) + 10, "Caf\xE9\0\x01\0 x", 9);  // behind the name
  std::memcpy(bytes(rows[1]) + 90, "\x01\x02\xFF\0Z ", 6);   // what is kept free
  std::memset(bytes(rows[2]) + 45, 0, 15);                   // details of nothing
  rows[2].BandUp = -7;
  Put(rows);
  ASSERT_FALSE(editor.Put(1, C::kDetails, "Float"));
  ASSERT_TRUE(editor.SaveNames().saved);
  rows[1].OtherDetails.set("Float");
  EXPECT_EQ(home.Get(kHost), Bytes(rows));
}

// Lists go by record numbers, which a save deals anew.
TEST_F(NameEditorTest, ASaveGivesTheChartListsTheNewNumbers) {
  WriteList(home.files(), data, kFirstChartList, List({{1, "CCC"}, {3, "BBB"}, {9, "GONE"}}));
  WriteList(home.files(), data, kResultList, List({{2, "AAA"}}));
  home.Put("drive_c/korawin/data/SubListB.Dat/folder", "");  // no list
  editor.Put(2, C::kCategory, "3");
  ASSERT_TRUE(editor.SaveNames().saved);
  EXPECT_EQ(Codes(), "AAA.CCC.BBB.");
  EXPECT_EQ(Numbers(kFirstChartList), "2CCC 3BBB ");
  EXPECT_EQ(Numbers(kResultList), "1AAA ");
  EXPECT_EQ(Said(), "");
}

TEST_F(NameEditorTest, NamesAndChartListsChangeTogetherOrNotAtAll) {
  const auto lay = [&] {
    io.Reset();
    Put({Security("CCC", 2), Security("AAA", 2), Security("BBB", 1)});
    WriteList(home.files(), data, kFirstChartList, List({{1, "CCC"}, {3, "BBB"}}));
    WriteList(home.files(), data, kResultList, List({{2, "AAA"}}));
    editor.Load();
    editor.Put(0, C::kCategory, "0");  // in front of both
    editor.Delete(1, 1);
  };
  int failures = 0;
  for (int at = 1; at < 200; ++at) {
    lay();
    io.Reset(at);
    const bool saved = editor.SaveNames().saved;
    const int calls = io.calls;
    io.Reset();
    EXPECT_EQ(Codes() + Numbers(kFirstChartList) + Numbers(kResultList),
              saved ? "CCC.BBB.1CCC 2BBB " : "CCC.AAA.BBB.1CCC 3BBB 2AAA ")
        << at;
    if (!saved) ++failures;
    if (calls < at) break;
  }
  EXPECT_GT(failures, 5);
}

TEST_F(NameEditorTest, ARowWithoutACodeThatHasOtherContentIsRefusedWithItsPlace) {
  editor.Insert(1);
  EXPECT_FALSE(editor.Put(1, C::kName, "Nobody"));
  const std::string old = home.Get(kHost);
  const auto end = editor.SaveNames();
  EXPECT_FALSE(end.saved);
  ASSERT_TRUE(end.fault);
  EXPECT_EQ(end.fault->row, 1u);
  EXPECT_EQ(Said(), "[Name File] Code must be entered|");
  EXPECT_EQ(home.Get(kHost), old);
  EXPECT_FALSE(home.Exists("drive_c/korawin/data/names.bak"));
}

TEST_F(NameEditorTest, ARowWithoutATypeIsRefused) {
  editor.Insert(0);
  EXPECT_FALSE(editor.Put(0, C::kCode, "new"));
  EXPECT_FALSE(editor.SaveNames().saved);
  EXPECT_EQ(Said(), "[Name File] Record Type must be entered|");
}

TEST_F(NameEditorTest, EmptyRowsAreLeftOutAndTwoRecordsOfOneCodeAreAllowed) {
  editor.Insert(0);
  editor.Insert(99);
  ASSERT_FALSE(editor.Put(4, C::kCode, "AAA"));
  ASSERT_FALSE(editor.Put(4, C::kType, "4"));
  EXPECT_TRUE(editor.SaveNames().saved);
  EXPECT_EQ(Codes(), "AAA.BBB.AAA.CCC.");  // category 0 first
}

TEST_F(NameEditorTest, AFileChangedFromOutsideAsksBeforeItIsReplaced) {
  ASSERT_FALSE(editor.Put(0, C::kName, "Mine"));
  const std::string theirs = Bytes<NameRec>({Security("ZZZ")});
  home.Put(kHost, theirs);
  dialogs.answers = {Answer::kNo};
  EXPECT_FALSE(editor.SaveNames().saved);
  EXPECT_EQ(home.Get(kHost), theirs);
  EXPECT_EQ(Said(), "[Name File] " + std::string(kNamesChangedOutside) + "|");
  dialogs.answers = {Answer::kYes};
  EXPECT_TRUE(editor.SaveNames().saved);
  EXPECT_EQ(home.Get("drive_c/korawin/data/names.bak"), theirs);
}

TEST_F(NameEditorTest, WarrantsGoFromTheFileAndStayOutOfUpdates) {
  Put({Security("BHPWMA", 84), Security("BHP", 1), Security("ANZIZB", 87)});
  EXPECT_TRUE(editor.DeleteWarrants());
  EXPECT_EQ(Codes(), "BHP.");
  EXPECT_EQ(Said(),
            "[Warrants] Warrants will be deleted from the Name File.\nDo you want to continue ?|"
            "[Name File]  Warrants removed|");
  EXPECT_TRUE(download.UpdateAll && download.NoWarrants);
  EXPECT_EQ(ini.GetSetting("Download", "NoWarrants"), "True");
  EXPECT_EQ(ini.GetSetting("Download", "UpdateAll"), "True");
}

TEST_F(NameEditorTest, WarrantsStayWhenTheQuestionIsDeniedOrThereAreNone) {
  Put({Security("BHPWMA", 84), Security("BHP", 1)});
  dialogs.answers = {Answer::kNo};
  EXPECT_FALSE(editor.DeleteWarrants());
  EXPECT_EQ(Shown(), "BHPWMA.BHP.");
  Put({Security("AAA"), Security("BHP", 1)});
  Said();
  EXPECT_FALSE(editor.DeleteWarrants());
  EXPECT_FALSE(download.NoWarrants);
  EXPECT_FALSE(home.Exists("drive_c/korawin/data/names.bak"));
}

TEST_F(NameEditorTest, AFailingSaveLeavesTheWarrantsWhereTheyWere) {
  Put({Security("BHPWMA", 84), Security("BHP", 1)});
  const std::string old = home.Get(kHost);
  for (int at = 1;; ++at) {
    editor.Load();
    io.Reset(at);
    const bool done = editor.DeleteWarrants();
    const bool cut = io.calls >= at && !done;
    io.Reset();
    if (!cut) break;
    EXPECT_EQ(home.Get(kHost), old) << at;
    EXPECT_EQ(Shown(), "BHPWMA.BHP.") << at;
    EXPECT_FALSE(download.NoWarrants) << at;
  }
  EXPECT_EQ(Codes(), "BHP.");
}

TEST_F(NameEditorTest, DuplicatesAreLookedForInOrderOfCodesAlone) {
  Put({Security("BBB"), Security("AAA"), Security("BBB")});
  dialogs.answers = {Answer::kCancel};
  editor.Dupnames();
  EXPECT_EQ(
      Said(),
      "[Duplicate codes] Name file needs to be sorted by code to proceed. OK to sort list ?|");
  EXPECT_EQ(Shown(), "BBB.AAA.BBB.");
  editor.Dupnames();
  EXPECT_EQ(Shown(), "AAA.BBB.");
  EXPECT_EQ(dialogs.said.back().text, "1 duplicate entries removed");
  Said();
  editor.Dupnames();
  EXPECT_EQ(Said(), "[Duplicate codes] 0 duplicate entries removed|");
}

TEST_F(NameEditorTest, CleaningAsks) {
  NameRec rec = Security("AAA");
  rec.Top = 5;
  Put({rec});
  dialogs.answers = {Answer::kCancel};
  editor.CleanOptional();
  EXPECT_FALSE(editor.changed());
  editor.CleanOptional();
  EXPECT_TRUE(editor.changed());
  EXPECT_EQ(dialogs.said.back().text,
            "Select OK to remove all settings from optional Base, Top and PFIncrement columns");
}

TEST_F(NameEditorTest, ExpiredOptionsGoAtTheNextSave) {
  NameRec rec = Security("OPTO");
  rec.Name.set("**EXPIRED**");
  Put({rec, Security("AAA")});
  editor.RemoveExpired();
  EXPECT_EQ(editor.rows().size(), 2u);
  EXPECT_TRUE(editor.changed());
  EXPECT_TRUE(editor.SaveNames().saved);
  EXPECT_EQ(Codes(), "AAA.");
}

TEST_F(NameEditorTest, TheMasterListFillsWhatIsEmptyAndWhatIsNotKept) {
  home.Put("drive_c/korawin/KoraName.Mas", "AAA   " + PadRight("421011MASTER NAME", 41) +
                                               PadRight("DETAILS", 15) + "BBB   " +
                                               PadRight("412   OTHER", 56));
  home.Put("drive_c/korawin/KoraName.idx",
           "1,2,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0,0\r\n");
  NameRec mine = Security("AAA", 5);
  mine.Name.set("My name");
  mine.BollPeriods = 21;
  Put({mine, Security("ZZZ")});
  EXPECT_TRUE(editor.UpdateNames({true, false, false, false, false}));
  const NameRec& row = editor.rows()[0];
  EXPECT_EQ(NameCell(row, C::kName), "My name");  // kept
  EXPECT_EQ(NameCell(row, C::kCategory), "21");
  EXPECT_EQ(NameCell(row, C::kClass), "011");
  EXPECT_EQ(row.BollPeriods, 21);
  EXPECT_TRUE(editor.changed());
}

TEST_F(NameEditorTest, OddBytesOfAForeignFileComeBackAsTheyWere) {
  NameRec rec = Security("AAA");
  rec.Name.set("Odd");
  rec.Name.bytes[20] = '\0';
  rec.NameSpare.set("\x01\xFFspr");
  rec.BandUp = 300;
  rec.MinMove = 0.05f;
  Put({rec});
  ASSERT_FALSE(editor.Put(0, C::kType, "5"));
  ASSERT_TRUE(editor.SaveNames().saved);
  rec.RecType = 5;
  EXPECT_EQ(home.Get(kHost), Bytes<NameRec>({rec}));
}

TEST_F(NameEditorTest, AFileThatIsNotThereHasNoRowsAndIsMadeBySaving) {
  home.files().Remove(data + "Names.dat");
  editor.Load();
  EXPECT_TRUE(editor.rows().empty());
  editor.Insert(0);
  ASSERT_FALSE(editor.Put(0, C::kCode, "AAA"));
  ASSERT_FALSE(editor.Put(0, C::kType, "4"));
  EXPECT_TRUE(editor.SaveNames().saved);
  EXPECT_EQ(Codes(), "AAA.");
}

}  // namespace
}  // namespace kora::test
