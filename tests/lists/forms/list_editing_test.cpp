#include <QAction>
#include <QMenu>
#include <QSpinBox>

#include "lists/forms/CLNames.h"
#include "lists/forms/SubList.h"
#include "lists/forms/SubList2.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora {
namespace {

using Codes = std::vector<std::string>;

const std::string kHere = "c:\\korawin\\data\\";

class ListEditingTest : public test::ListFormTest {
 protected:
  ListFormServices Services() {
    return {.files = session->files,
            .dialogs = dialogs,
            .settings = session->settings,
            .user = session->user};
  }
  static std::string Bytes(const std::vector<ListRec>& records) { return test::Bytes(records); }
  QAction* Entry_(const char* list, const char* entry) { return Find<QAction>(List(list), entry); }
};

// ---- SubList

class SubListTest : public ListEditingTest {
 protected:
  void Open() { Stand(std::make_unique<SubList>(Services(), nullptr)); }
  void OpenListA() {
    PutList('A', {Entry(3, "BHP"), Entry(1, "AAA")});
    Open();
    Choose("Combo1", 0);
  }
};

TEST_F(SubListTest, ShowsTheNameFileAndNoListAtFirst) {
  session->user.PutSetting("KORA Charting System", "SubListB", "Banks");
  Open();
  EXPECT_EQ(form->windowTitle(), "Chart Lists");
  EXPECT_EQ(Items("List2"), (Codes{"AAA", "BBB", "BHP", "XAO", "ADV", "ZZZ"}));
  EXPECT_EQ(Combo("Combo1")->count(), 11);
  EXPECT_EQ(Combo("Combo1")->itemText(1), "Banks");
  EXPECT_EQ(Combo("Combo1")->itemText(10), "Chart Scan Results");
  EXPECT_EQ(Combo("Combo1")->currentIndex(), -1);
  EXPECT_FALSE(Text("Text2")->isEnabled());
  DoubleClickItem(List("List2"), 0);
  EXPECT_TRUE(Items("List1").empty());
}

TEST_F(SubListTest, CodesSelectedInTheCodeSelectionAreAddedOnce) {
  PutList('A', {Entry(3, "BHP")});
  std::function<void(const std::string&)> select;
  ListFormServices services = Services();
  services.openCodes = [&](QWidget*, std::function<void(const std::string&)> taken) {
    select = std::move(taken);
  };
  Stand(std::make_unique<SubList>(services, nullptr));
  EXPECT_FALSE(On<QPushButton>("Command5")->isEnabled());
  Choose("Combo1", 0);
  Press("Command5");
  ASSERT_TRUE(select);
  for (const char* code : {"ZZZ", "BHP", "ADV"}) select(code);
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "ZZZ", "ADV"}));
  EXPECT_TRUE(On<QPushButton>("Command2")->isEnabled());
  EXPECT_TRUE(dialogs.said.empty());
  select("GONE");
  ExpectSaid("Code not found", "Chart Lists");
}

TEST_F(SubListTest, TheCodeSelectionIsThereWhereTheProgramHasIt) {
  Open();
  EXPECT_FALSE(On<QPushButton>("Command5")->isVisible());
}

TEST_F(SubListTest, NamesStandBesideTheCodesAndAreFoundWhileOneTypes) {
  OpenListA();
  auto* codes = List("List2");
  EXPECT_EQ(codes->item(0)->text(), "AAA");
  EXPECT_NE(codes->item(0)->toolTip(), "") << "the name";
  QTest::keyClicks(Text("Text2"), "x");
  EXPECT_EQ(codes->currentItem()->text(), "XAO");
  QTest::keyClick(Text("Text2"), Qt::Key_Backspace);
  QTest::keyClicks(Text("Text2"), "bh");
  EXPECT_EQ(codes->currentItem()->text(), "BHP");
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA"})) << "finding adds nothing";
}

TEST_F(SubListTest, AddsByDoubleClickButtonAndTypedCodeOnceEach) {
  OpenListA();
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA"}));
  DoubleClickItem(List("List2"), 1);
  ClickItem(List("List2"), 3);
  ClickItem(List("List2"), 4, Qt::ControlModifier);
  Press("Command4");
  Enter("Text2", "zzz");
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA", "BBB", "XAO", "ADV", "ZZZ"}));
  Enter("Text2", "bhp");
  DoubleClickItem(List("List2"), 0);
  EXPECT_EQ(List("List1")->count(), 6);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(SubListTest, EnterInTheNameFileCodesAdds) {
  OpenListA();
  List("List2")->setFocus();
  QTest::keyClick(List("List2"), Qt::Key_End);
  QTest::keyClick(List("List2"), Qt::Key_Return);
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA", "ZZZ"}));
}

TEST_F(SubListTest, ATypedCodeThatIsNotThereIsTold) {
  OpenListA();
  Enter("Text2", "QQQ");
  ExpectSaid("Code not found", "Chart Lists");
  EXPECT_EQ(List("List1")->count(), 2);
}

TEST_F(SubListTest, DeleteAsksForEachCode) {
  OpenListA();
  List("List1")->setFocus();
  List("List1")->selectAll();
  dialogs.answers = {Answer::kNo, Answer::kYes};
  Press("Command1");
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "Delete BHP  ?");
  EXPECT_EQ(dialogs.said[1].text, "Delete AAA  ?");
  EXPECT_EQ(Items("List1"), Codes{"BHP"});
  List("List1")->setFocus();
  QTest::keyClick(List("List1"), Qt::Key_Delete);
  EXPECT_TRUE(Items("List1").empty());
}

TEST_F(SubListTest, WhatAnotherProgramChangedIsReadAgain) {
  OpenListA();
  home.files().WriteAll(kHere + "SubListA.Dat", Bytes({Entry(2, "BBB")}));
  home.files().WriteAll(kHere + "Names.dat",
                        test::Bytes(std::vector<NameRec>{test::Security("BBB")}));
  QEvent back(QEvent::WindowActivate);
  QApplication::sendEvent(form.get(), &back);
  EXPECT_EQ(Items("List1"), Codes{"BBB"});
  EXPECT_EQ(Items("List2"), Codes{"BBB"});
}

TEST_F(SubListTest, AListThatAnotherProgramChangedIsSavedOverOnlyWhenTheUserSaysSo) {
  OpenListA();
  DoubleClickItem(List("List2"), 1);
  const std::string outside = Bytes({Entry(2, "BBB")});
  home.files().WriteAll(kHere + "SubListA.Dat", outside);
  QEvent back(QEvent::WindowActivate);
  QApplication::sendEvent(form.get(), &back);
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA", "BBB"})) << "the user's changes stay";
  dialogs.answers = {Answer::kNo};
  Press("Command2");
  ExpectSaid("The list was changed by another program. Save over these changes ?", "Chart Lists");
  EXPECT_EQ(home.files().ReadAll(kHere + "SubListA.Dat"), outside);
  Press("Command2");
  EXPECT_EQ(home.files().ReadAll(kHere + "SubListA.Dat").size(), 24u);
}

TEST_F(SubListTest, AListIsNotSavedWhileAnotherProgramWrites) {
  OpenListA();
  DoubleClickItem(List("List2"), 1);
  HomeLock other(home.path(), MachineIo());
  const auto held = other.Hold();
  session->files.lock().wait = std::chrono::milliseconds(0);
  Press("Command2");
  ASSERT_FALSE(dialogs.said.empty());
  EXPECT_EQ(dialogs.said.back().text.substr(0, 28), "The data is being written by");
  EXPECT_EQ(home.files().ReadAll(kHere + "SubListA.Dat").size(), 16u);
  EXPECT_TRUE(Find<QPushButton>(form.get(), "Command2")->isEnabled());
}

TEST_F(SubListTest, TheMenuDeletesAll) {
  OpenListA();
  auto* menu = Find<QMenu>(List("List1"), "slmnuEO");
  EXPECT_EQ(menu->title(), "Edit Options");
  EXPECT_EQ(Entry_("List1", "slmnuDel")->text(), "&Delete Selected Item/s");
  EXPECT_EQ(Entry_("List1", "SlmnuDAI")->text(), "&Delete All Items");
  dialogs.answers = {Answer::kNo};
  Entry_("List1", "SlmnuDAI")->trigger();
  ExpectSaid("Delete all items ?", "Chart Lists");
  EXPECT_EQ(List("List1")->count(), 2);
  Entry_("List1", "SlmnuDAI")->trigger();
  EXPECT_EQ(List("List1")->count(), 0);
}

TEST_F(SubListTest, ClosingAChangedListAsksAndSavesWithCurrentNumbers) {
  PutList('A', {Entry(99, "BHP"), Entry(1, "GONE")});
  Open();
  Choose("Combo1", 0);
  Enter("Text2", "XAO");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  ExpectSaid("Chart List A has changed. SAVE Changes?", "Chart Lists");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ListBytes('A'), Bytes({Entry(3, "BHP"), Entry(4, "XAO")}));
}

TEST_F(SubListTest, NoLeavesTheFile) {
  OpenListA();
  Enter("Text2", "XAO");
  dialogs.answers = {Answer::kNo};
  Press("Command3");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ListBytes('A'), Bytes({Entry(3, "BHP"), Entry(1, "AAA")}));
}

TEST_F(SubListTest, ChangingTheListAsksAndAnUnchangedListDoesNot) {
  OpenListA();
  Choose("Combo1", 1);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_TRUE(Items("List1").empty());
  Enter("Text2", "BBB");
  Choose("Combo1", 0);
  ExpectSaid("Chart List B has changed. SAVE Changes?", "Chart Lists");
  EXPECT_EQ(ListBytes('B'), Bytes({Entry(2, "BBB")}));
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA"}));
}

TEST_F(SubListTest, AListThatCannotBeSavedStaysOpen) {
  OpenListA();
  Enter("Text2", "XAO");
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[1].text.substr(0, 38), "There is an unexpected error number 53");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(List("List1")->count(), 3);
  EXPECT_EQ(ListBytes('A'), Bytes({Entry(3, "BHP"), Entry(1, "AAA")}));
}

TEST_F(SubListTest, OddRecordsShowByTheirCodesAndATornOneDoesNot) {
  home.Put("drive_c/korawin/data/SubListA.Dat",
           Bytes({Entry(0, "BHP"), Entry(-5, "AAA"), Entry(32767, "ZZZ")}) + "1234567");
  Open();
  Choose("Combo1", 0);
  EXPECT_EQ(Items("List1"), (Codes{"BHP", "AAA", "ZZZ"}));
}

TEST_F(SubListTest, ColumnsCanBeChosen) {
  Open();
  auto* columns = On<QSpinBox>("Text1");
  columns->setValue(2);
  const int two = List("List2")->gridSize().width();
  columns->setValue(4);
  EXPECT_LT(List("List2")->gridSize().width(), two);
  columns->setValue(1);
  EXPECT_FALSE(List("List2")->isWrapping());
}

TEST_F(SubListTest, ANameFileThatIsNotThereLeavesNoCodes) {
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  Open();
  EXPECT_TRUE(Items("List2").empty());
}

// ---- SubList2

class SubList2Test : public ListEditingTest {
 protected:
  void SetUp() override {
    ListEditingTest::SetUp();
    PutList('A', {Entry(3, "BHP"), Entry(1, "AAA"), Entry(2, "BBB")});
    PutList('B', {Entry(1, "AAA")});
    Stand(std::make_unique<SubList2>(Services(), nullptr));
  }
  void OpenBoth() {
    Choose("Combo1(0)", 0);
    List("List1(1)")->setFocus();
    // Down to list B past list A, which stands on the other side.
    Choose("Combo1(1)", 1);
    dialogs.said.clear();
  }
};

TEST_F(SubList2Test, CopiesAndMovesWhatIsSelected) {
  OpenBoth();
  EXPECT_EQ(On<QPushButton>("Command1(1)")->toolTip(), "Copies an item to the other list");
  EXPECT_EQ(On<QPushButton>("Command1(3)")->toolTip(), "Moves selected item/s to other list");
  ClickItem(List("List1(0)"), 0);
  Press("Command1(1)");
  EXPECT_EQ(Items("List1(0)"), (Codes{"BHP", "AAA", "BBB"}));
  EXPECT_EQ(Items("List1(1)"), (Codes{"AAA", "BHP"}));
  List("List1(0)")->selectAll();
  Press("Command1(3)");
  EXPECT_TRUE(Items("List1(0)").empty());
  EXPECT_EQ(Items("List1(1)"), (Codes{"AAA", "BHP", "BBB"}));
  ClickItem(List("List1(1)"), 2);
  Press("Command1(0)");
  EXPECT_EQ(Items("List1(0)"), Codes{"BBB"});
  ClickItem(List("List1(1)"), 0);
  Press("Command1(2)");
  EXPECT_EQ(Items("List1(0)"), (Codes{"BBB", "AAA"}));
  EXPECT_EQ(Items("List1(1)"), (Codes{"BHP", "BBB"}));
  Press("Command2(2)");
  EXPECT_EQ(ListBytes('A'), Bytes({Entry(2, "BBB"), Entry(1, "AAA")}));
  EXPECT_EQ(ListBytes('B'), Bytes({Entry(3, "BHP"), Entry(2, "BBB")}));
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(SubList2Test, OneListAloneIsTold) {
  Choose("Combo1(0)", 0);
  List("List1(0)")->selectAll();
  Press("Command1(1)");
  ExpectSaid("Both lists must be displayed", "Chart List Utilities");
  Press("Command1(3)");
  ExpectSaid("Both lists must be displayed", "Chart List Utilities");
  EXPECT_EQ(List("List1(0)")->count(), 3);
}

TEST_F(SubList2Test, TheSameListOnBothSidesIsToldAndNotShownTwice) {
  Choose("Combo1(0)", 0);
  Choose("Combo1(1)", 0);
  ExpectSaid("Lists cannot be same", "Chart List Utilities");
  EXPECT_TRUE(Items("List1(1)").empty());
  Choose("Combo1(1)", 1);
  EXPECT_EQ(Items("List1(1)"), Codes{"AAA"});
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(SubList2Test, CheckAllListsRefreshesNumbersAndDropsCodesThatLeft) {
  PutList('K', {Entry(77, "ZZZ"), Entry(1, "GONE")});
  PutList('Z', {Entry(9, "GONE")});
  OpenBoth();
  EXPECT_EQ(On<QPushButton>("Command2(1)")->toolTip(), "Checks all codes with Name file list");
  Press("Command2(1)");
  EXPECT_EQ(On<QLabel>("Label4")->text(), "COMPLETED");
  EXPECT_EQ(ListBytes('K'), Bytes({Entry(6, "ZZZ")}));
  EXPECT_EQ(ListBytes('Z'), "");
  EXPECT_TRUE(home.Exists("drive_c/korawin/data/SubListZ.Dat"));
  EXPECT_EQ(Items("List1(0)"), (Codes{"BHP", "AAA", "BBB"}));
  EXPECT_FALSE(dialogs.busy);
}

TEST_F(SubList2Test, DeletesWithItsQuestions) {
  OpenBoth();
  ClickItem(List("List1(0)"), 1);
  EXPECT_EQ(Entry_("List1(0)", "slmnuDel")->text(), "&Delete");
  Entry_("List1(0)", "slmnuDel")->trigger();
  ExpectSaid("Delete AAA  ?", "Chart List Utilities");
  EXPECT_EQ(Items("List1(0)"), (Codes{"BHP", "BBB"}));
  Entry_("List1(1)", "SlmnuDAI")->trigger();
  ExpectSaid("Delete all items from Chart List B", "Chart List Utilities");
  EXPECT_TRUE(Items("List1(1)").empty());
}

TEST_F(SubList2Test, ClosingAsksForEachChangedList) {
  OpenBoth();
  List("List1(0)")->selectAll();
  Press("Command1(3)");
  dialogs.answers = {Answer::kNo, Answer::kYes};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "Chart List A has changed. SAVE Changes?");
  EXPECT_EQ(dialogs.said[1].text, "Chart List B has changed. SAVE Changes?");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ListBytes('A').size(), 24u);
  EXPECT_EQ(ListBytes('B'), Bytes({Entry(1, "AAA"), Entry(3, "BHP"), Entry(2, "BBB")}));
}

TEST_F(SubList2Test, ACheckThatFailsIsTold) {
  OpenBoth();
  home.files().Remove("c:\\korawin\\data\\Names.dat");
  Press("Command2(1)");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text.substr(0, 38), "There is an unexpected error number 53");
  EXPECT_EQ(On<QLabel>("Label4")->text(), "");
  EXPECT_EQ(ListBytes('B'), Bytes({Entry(1, "AAA")}));
}

// ---- CLNames

class CLNamesTest : public ListEditingTest {
 protected:
  void Open() { Stand(std::make_unique<CLNames>(Services(), nullptr)); }
  std::string Kept(const char* key) {
    return session->user.GetSetting("KORA Charting System", key);
  }
};

TEST_F(CLNamesTest, ShowsTheNamesAndSavesThem) {
  Open();
  EXPECT_EQ(form->windowTitle(), "Rename Chart Lists");
  EXPECT_EQ(TextOf("Text1(0)"), "Chart List A");
  EXPECT_EQ(TextOf("Text1(8)"), "Chart List J");
  EXPECT_EQ(TextOf("Text1(9)"), "Chart List K");
  Type("Text1(8)", "Miners");
  Press("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Kept("SubListJ"), "Miners");
  EXPECT_EQ(Kept("SubListA"), "Chart List A");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(CLNamesTest, ClosingWithChangesAsks) {
  Open();
  Type("Text1(0)", "Mine");
  dialogs.answers = {Answer::kNo};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  ExpectSaid("Save changes ?", "Sub-List Names");
  EXPECT_EQ(Kept("SubListA"), "unknown");
  Open();
  Type("Text1(0)", "Mine");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_EQ(Kept("SubListA"), "Mine");
  EXPECT_FALSE(form->isVisible());
}

TEST_F(CLNamesTest, ClosingUnchangedDoesNotAsk) {
  Open();
  Press("Command2");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_FALSE(form->isVisible());
}

}  // namespace
}  // namespace kora
