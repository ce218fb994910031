#include <QAbstractItemView>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenu>
#include <QPushButton>
#include <QRadioButton>
#include <filesystem>
#include <map>

#include "lists/forms/RecSav.h"
#include "settings/forms/Locate.h"
#include "tests/support/qt/form_fixture.h"
#include "tests/support/recording_printer.h"
#include "update/forms/DLWizard.h"
#include "update/forms/INUpList.h"
#include "update/forms/ModDetails.h"
#include "update/forms/WMPath.h"

namespace kora {
namespace {

const std::string kSystem = "drive_c/korawin/";

class SettingsForms : public test::FormTest {
 protected:
  void SetUp() override { ReadSettings(); }
  template <typename Form>
  Form& Open() {
    auto made = std::make_unique<Form>(UpdateFormServices{.ini = session->ini,
                                                          .files = session->files,
                                                          .dialogs = dialogs,
                                                          .settings = session->settings,
                                                          .serviceSaved = [this] { ++saved; },
                                                          .pathChosen = [this] { ++chosen; },
                                                          .print = print},
                                       nullptr);
    Form& out = *made;
    form = std::move(made);
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return out;
  }
  QLineEdit* Text(const char* name) { return Find<QLineEdit>(form.get(), name); }
  void Type(const char* name, const char* text) {
    Text(name)->setFocus();
    Text(name)->selectAll();
    QTest::keyClick(Text(name), Qt::Key_Delete);
    QTest::keyClicks(Text(name), text);
  }
  std::string Kept(const char* key) { return session->ini.GetSetting("Download", key); }
  DownloadSettings& download() { return session->settings.download; }

  std::unique_ptr<QDialog> form;
  int saved = 0, chosen = 0;
  std::function<void(const TextTable&, QWidget*)> print;
};

// ---- ModDetails

TEST_F(SettingsForms, ModDetailsShowsTheServiceInUse) {
  Open<ModDetails>();
  EXPECT_EQ(form->windowTitle(), "Data Download Service Details");
  EXPECT_EQ(Find<QComboBox>(form.get(), "Combo1")->currentIndex(), 3);
  EXPECT_EQ(Find<QComboBox>(form.get(), "Combo1")->itemText(0), "KORA/Tarvo ( Mainfiles Only) ");
  EXPECT_EQ(Find<QComboBox>(form.get(), "Combo2")->currentIndex(), 6);
  EXPECT_EQ(Text("Text1")->text(), "c:\\korawin\\download\\");
  EXPECT_EQ(Text("Text2")->text(), "1");
  EXPECT_TRUE(Find<QPushButton>(form.get(), "Command1")->isEnabled());
}

TEST_F(SettingsForms, ModDetailsHidesWhatTheServiceDoesNotHave) {
  Open<ModDetails>();
  auto* combo = Find<QComboBox>(form.get(), "Combo1");
  EXPECT_TRUE(Text("Text2")->isVisible());
  combo->setFocus();
  QTest::keyClick(combo, Qt::Key_Up);
  EXPECT_EQ(combo->currentIndex(), 2);
  EXPECT_FALSE(Text("Text2")->isVisible());
  EXPECT_FALSE(Find<QComboBox>(form.get(), "Combo2")->isVisible());
  combo->setCurrentIndex(0);
  EXPECT_FALSE(Find<QPushButton>(form.get(), "Command1")->isEnabled());
}

TEST_F(SettingsForms, ModDetailsSavesByMouse) {
  Open<ModDetails>();
  Type("Text1", "c:\\in\\");
  Type("Text2", "100");
  Find<QComboBox>(form.get(), "Combo2")->setCurrentIndex(1);
  Click(form.get(), "Command3");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(saved, 1);
  EXPECT_EQ(Kept("DLPath"), "c:\\in\\");
  EXPECT_EQ(Kept("InternetDLfmt"), "YYMMDD.D");
  EXPECT_EQ(Kept("Volume divisor"), "100");
  EXPECT_EQ(download().VolumeDivisor, 100);
}

TEST_F(SettingsForms, ModDetailsKeepsAnEmptyFormatAsTheFirst) {
  download().InternetDLfmt.clear();
  Open<ModDetails>();
  EXPECT_EQ(Find<QComboBox>(form.get(), "Combo2")->currentIndex(), 0);
  Click(form.get(), "Command3");
  EXPECT_EQ(Kept("InternetDLfmt"), "ddMMMyy.d");
}

TEST_F(SettingsForms, ModDetailsKeepsAFormThatMatchesNoneAsTheFirst) {
  download().InternetDLfmt = "rubbish";
  Open<ModDetails>();
  EXPECT_EQ(Find<QComboBox>(form.get(), "Combo2")->currentIndex(), 0);
  Click(form.get(), "Command3");
  EXPECT_EQ(Kept("InternetDLfmt"), "DDMMMYY.D");
}

TEST_F(SettingsForms, ModDetailsAllowsAnEmptyPath) {
  Open<ModDetails>();
  Type("Text1", "");
  Click(form.get(), "Command3");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(download().DLPath, "");
}

TEST_F(SettingsForms, ModDetailsRefusesAPathWithoutBackslash) {
  Open<ModDetails>();
  Type("Text1", "c:\\in");
  QTest::keyClick(Text("Text1"), Qt::Key_Return);
  EXPECT_EQ(dialogs.said.back().text, "Path must end with a backslash \\ ");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Kept("DLPath"), "c:\\korawin\\download\\");
}

TEST_F(SettingsForms, ModDetailsKeepsTheFocusOnAWrongDivisor) {
  Open<ModDetails>();
  Type("Text2", "7");
  QTest::keyClick(Text("Text2"), Qt::Key_Tab);
  ASSERT_TRUE(WaitFor([this] { return !dialogs.said.empty(); }));
  EXPECT_EQ(dialogs.said.back().title, "Volume Divisor");
  EXPECT_EQ(dialogs.said.back().text,
            "Volume divisor can only be either 1, 10,  100,  1000  or 10000");
  EXPECT_TRUE(Text("Text2")->hasFocus());
  Type("Text2", "0");
  QTest::keyClick(Text("Text2"), Qt::Key_Tab);
  ASSERT_TRUE(WaitFor([this] { return Text("Text2")->text() == "1"; }));
  EXPECT_EQ(dialogs.said.size(), 1u);
}

TEST_F(SettingsForms, ModDetailsProposesAFolderWhereThereIsNone) {
  download().DLPath.clear();
  Open<ModDetails>();
  EXPECT_EQ(Text("Text1")->text(), "");
  Find<QComboBox>(form.get(), "Combo1")->setCurrentIndex(2);
  EXPECT_EQ(Text("Text1")->text(), "c:\\bda32\\koradata\\");
}

TEST_F(SettingsForms, ModDetailsOpensTheWizardForTheWholeMarketByHandAlone) {
  Open<ModDetails>();
  auto* combo = Find<QComboBox>(form.get(), "Combo1");
  combo->setCurrentIndex(1);
  EXPECT_EQ(form->findChild<DLWizard*>(), nullptr);
  combo->setCurrentIndex(0);
  combo->setFocus();
  QTest::keyClick(combo, Qt::Key_Down);
  EXPECT_NE(form->findChild<DLWizard*>(), nullptr);
}

TEST_F(SettingsForms, ModDetailsOpensNoWizardForTheServiceThatItHasAlready) {
  download().DataService = 3;
  Open<ModDetails>();
  auto* combo = Find<QComboBox>(form.get(), "Combo1");
  combo->showPopup();
  QTest::keyClick(combo->view(), Qt::Key_Return);
  EXPECT_EQ(combo->currentIndex(), 1);
  EXPECT_EQ(form->findChild<DLWizard*>(), nullptr);
}

TEST_F(SettingsForms, ModDetailsChecksTheDivisorBeforeTheUpdateList) {
  Open<ModDetails>();
  Type("Text2", "7");
  Click(form.get(), "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said.back().title, "Volume Divisor");
  EXPECT_EQ(form->findChild<INUpList*>(), nullptr);
  QCoreApplication::processEvents();
  EXPECT_EQ(dialogs.said.size(), 1u);  // told once
}

TEST_F(SettingsForms, ModDetailsPicksItsFolder) {
  home.Put("drive_c/korawin/download/in/x", "");
  Open<ModDetails>();
  Click(form.get(), "Picture1");
  auto* locate = form->findChild<Locate*>();
  ASSERT_NE(locate, nullptr);
  auto* list = Find<QListWidget>(locate, "Dir1");
  list->setCurrentRow(1);
  QTest::keyClick(list, Qt::Key_Return);
  Click(locate, "Command1");
  EXPECT_EQ(Text("Text1")->text(), "c:\\korawin\\download\\in\\");
}

// ---- WMPath and DLWizard

TEST_F(SettingsForms, WMPathSavesSixFoldersAndTheChoice) {
  Open<WMPath>();
  for (int i = 1; i <= 6; ++i)
    Type(("Text" + std::to_string(i)).c_str(), ("c:\\m" + std::to_string(i)).c_str());
  Click(form.get(), "Option1(2)");
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\m3\\");
  EXPECT_EQ(session->ini.GetSetting("KoraPaths", "ChtData"), "c:\\m3\\");
  EXPECT_EQ(chosen, 1);
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.size(), 6u);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kSystem + "WMPaths.lst"),
            "c:\\m1\\\r\nc:\\m2\\\r\nc:\\m3\\\r\nc:\\m4\\\r\nc:\\m5\\\r\n2\r\nc:\\m6\\\r\n");
  Open<WMPath>();
  EXPECT_EQ(Text("Text6")->text(), "c:\\m6\\");
  EXPECT_TRUE(Find<QRadioButton>(form.get(), "Option1(2)")->isChecked());
}

TEST_F(SettingsForms, WMPathWantsEveryFolder) {
  Open<WMPath>();
  Type("Text1", "c:\\m1");
  Click(form.get(), "Option1(4)");  // an empty one
  EXPECT_EQ(chosen, 0);
  QTest::keyClick(Text("Text1"), Qt::Key_Return);
  EXPECT_EQ(dialogs.said.back().text, "Paths must be entered for all sections");
  EXPECT_TRUE(form->isVisible());
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(home.Exists(kSystem + "WMPaths.lst"));
}

TEST_F(SettingsForms, DLWizardSavesTicksAndFolders) {
  home.Put(kSystem + "WMPaths.lst", "a\r\nb\r\nc\r\nd\r\ne\r\n4\r\ng\r\n");
  Open<DLWizard>();
  EXPECT_EQ(Text("Text1(2)")->text(), "c");
  EXPECT_EQ(Text("Text1(5)")->text(), "g");
  for (int i = 0; i < 6; ++i)
    Type(("Text1(" + std::to_string(i) + ")").c_str(), ("c:\\w" + std::to_string(i)).c_str());
  auto* check = Find<QCheckBox>(form.get(), "Check1(4)");
  check->setFocus();
  QTest::keyClick(check, Qt::Key_Space);
  Click(form.get(), "Command1");
  EXPECT_EQ(Kept("DLWiz"), "000010");
  EXPECT_EQ(home.Get(kSystem + "WMPaths.lst"),
            "c:\\w0\\\r\nc:\\w1\\\r\nc:\\w2\\\r\nc:\\w3\\\r\nc:\\w4\\\r\n4\r\nc:\\w0\\\r\n");
  EXPECT_FALSE(form->isVisible());
}

TEST_F(SettingsForms, WMPathTakesAChosenFolderThatIsFilledInLaterAsItSaves) {
  Open<WMPath>();
  Click(form.get(), "Option1(1)");
  EXPECT_EQ(chosen, 0);
  for (int i = 1; i <= 6; ++i)
    Type(("Text" + std::to_string(i)).c_str(), ("c:\\m" + std::to_string(i)).c_str());
  Click(form.get(), "Command1");
  EXPECT_EQ(chosen, 1);
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\m2\\");
}

TEST_F(SettingsForms, WMPathPicksItsFolders) {
  home.Put(kSystem + "WMPaths.lst", "a\r\nb\r\nc:\\korawin\\\r\nd\r\ne\r\n4\r\ng\r\n");
  Open<WMPath>();
  Click(form.get(), "Picture1(2)");
  auto* locate = form->findChild<Locate*>();
  ASSERT_NE(locate, nullptr);
  EXPECT_EQ(Find<QLabel>(locate, "Label3(1)")->text(), "SFE Futures");
  Click(locate, "Command1");
  EXPECT_EQ(Text("Text3")->text(), "c:\\korawin\\");
  EXPECT_EQ(Text("Text4")->text(), "d");
}

TEST_F(SettingsForms, DLWizardPicksItsFolders) {
  home.Put(kSystem + "WMPaths.lst", "a\r\nb\r\nc\r\nc:\\korawin\\\r\ne\r\n4\r\ng\r\n");
  const std::pair<std::string, std::string> wanted[] = {
      {"ASX stocks", "c:\\korawin\\data\\"},         {"Aust Indices", "c:\\korawin\\data\\"},
      {"SFE Futures", "c:\\korawin\\data\\"},        {"Overseas Data", "c:\\korawin\\"},
      {"Put / Call Options", "c:\\korawin\\data\\"}, {"Extra stocks", "c:\\korawin\\data\\"}};
  Open<DLWizard>();
  for (int i = 0; i < 6; ++i) {
    Click(form.get(), ("Picture1(" + std::to_string(i) + ")").c_str());
    auto* locate = form->findChild<Locate*>();
    ASSERT_NE(locate, nullptr);
    EXPECT_EQ(Find<QLabel>(locate, "Label3(1)")->text().toStdString(), wanted[i].first);
    EXPECT_EQ(Find<QLabel>(locate, "Label3(0)")->text().toStdString(), wanted[i].second);
    Click(locate, "Command1");
    EXPECT_EQ(Text(("Text1(" + std::to_string(i) + ")").c_str())->text().toStdString(),
              wanted[i].second);
    delete locate;
  }
}

TEST_F(SettingsForms, AFolderThatIsNotChosenStays) {
  home.Put(kSystem + "WMPaths.lst", "a\r\nb\r\nc\r\nd\r\ne\r\n4\r\ng\r\n");
  Open<DLWizard>();
  Click(form.get(), "Picture1(0)");
  QTest::keyClick(form->findChild<Locate*>(), Qt::Key_Escape);
  EXPECT_EQ(Text("Text1(0)")->text(), "a");
}

// A mnemonic that two controls share leads to none of them at once.
TEST_F(SettingsForms, NoTwoControlsOfAFormShareAMnemonic) {
  const auto check = [this] {
    std::map<QChar, int> uses;
    const auto note = [&](const QString& text) {
      const qsizetype at = text.indexOf('&');
      if (at >= 0 && at + 1 < text.size()) ++uses[text[at + 1].toUpper()];
    };
    for (auto* button : form->findChildren<QAbstractButton*>()) note(button->text());
    for (auto* label : form->findChildren<QLabel*>()) note(label->text());
    for (auto* menu : form->findChildren<QMenu*>()) note(menu->title());
    EXPECT_FALSE(uses.empty());
    for (const auto& [letter, count] : uses)
      EXPECT_EQ(count, 1) << form->objectName().toStdString() << " "
                          << QString(letter).toStdString();
  };
  Open<ModDetails>();
  check();
  Open<WMPath>();
  check();
  Open<DLWizard>();
  check();
  Open<INUpList>();
  check();
}

// ---- INUpList

class UpdateListForm : public SettingsForms {
 protected:
  void Master() {
    home.Put("list.csv", "ORE,4,7,121,Ore Ltd,\nZAP,4,1,,Zap Ltd,\nBHP,4,22,,Big,\n");
    ASSERT_TRUE(
        MakeMasterList(session->files, "c:\\korawin\\", home.path() + "/list.csv", dialogs));
  }
  kora::Grid* Grid() { return Find<kora::Grid>(form.get(), "SS1"); }
  std::string Cell(int row, int column) {
    return Grid()->model()->index(row, column).data().toString().toStdString();
  }
  // By the keyboard, as a user does.
  void TypeInto(int row, int column, const char* text) {
    Grid()->setFocus();
    Grid()->GoTo(row, column);
    QTest::keyClicks(Grid(), QString(text[0]));
    QTest::keyClicks(QApplication::focusWidget(), text + 1);
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  }
  QListWidget* List() { return Find<QListWidget>(form.get(), "List1"); }
  void Trigger(const char* name) { Find<QAction>(form.get(), name)->trigger(); }
};

TEST_F(UpdateListForm, TellsThatThereIsNoMasterList) {
  Open<INUpList>();
  ASSERT_EQ(List()->count(), 3);
  EXPECT_EQ(List()->item(0)->text(), "KORA Master list is missing");
  EXPECT_EQ(List()->item(2)->text(), "or ring KORA ");
}

TEST_F(UpdateListForm, AddsCheckedItemsInOrderAndSavesThem) {
  Master();
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine\r\n");
  Open<INUpList>();
  EXPECT_EQ(Grid()->editTriggers(), QAbstractItemView::NoEditTriggers);
  Click(form.get(), "Option1(1)");
  EXPECT_NE(Grid()->editTriggers(), QAbstractItemView::NoEditTriggers);
  for (int i = 0; i < List()->count(); ++i) List()->item(i)->setCheckState(Qt::Checked);
  Click(form.get(), "Command1");
  ASSERT_EQ(Grid()->model()->rowCount(), 3);
  EXPECT_EQ(Cell(0, 0), "BHP");
  EXPECT_EQ(Cell(0, 1), "22");
  EXPECT_EQ(Cell(1, 2), "Mine");
  Trigger("ulSave");
  EXPECT_EQ(home.Get(kSystem + "Update.Lst"), "BHP,22,Big\r\nORE,3,Mine\r\nZAP,1,Zap Ltd\r\n");
  EXPECT_EQ(Kept("UpdateAll"), "False");
  auto* box = form->findChild<RecSav*>();
  ASSERT_NE(box, nullptr);
  EXPECT_TRUE(box->isVisible());
  EXPECT_EQ(QApplication::activeWindow(), form.get());  // keys still go to the list
  EXPECT_TRUE(WaitFor([this] { return form->findChild<RecSav*>() == nullptr; }));
  EXPECT_EQ(QApplication::activeWindow(), form.get());
}

TEST_F(UpdateListForm, SavesAChangedListOnClosing) {
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine\r\nZAP,1,\r\n");
  download().UpdateAll = false;
  Open<INUpList>();
  Grid()->SelectRows({0, 0});
  Trigger("ulDel");
  Trigger("ulAdd");
  TypeInto(1, 0, "new");
  TypeInto(1, 1, "500");
  EXPECT_EQ(Cell(1, 1), "0") << "as it is kept";
  TypeInto(1, 1, "x");
  EXPECT_EQ(Cell(1, 1), "0");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kSystem + "Update.Lst"), "ZAP,1,\r\nNEW,0,\r\n");
  EXPECT_EQ(home.Get(kSystem + "Update.Bak"), "ORE,3,Mine\r\nZAP,1,\r\n");
}

TEST_F(UpdateListForm, TheGridIsLockedAndGreyUnlessTheListIsInUse) {
  Master();
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine\r\n");
  Open<INUpList>();
  const auto live = [this] {
    EXPECT_EQ(Find<QPushButton>(form.get(), "Command1")->isEnabled(),
              Find<QAction>(form.get(), "ulAdd")->isEnabled());
    EXPECT_EQ(Find<QAction>(form.get(), "ulDel")->isEnabled(),
              Find<QAction>(form.get(), "ulAdd")->isEnabled());
    return Find<QAction>(form.get(), "ulAdd")->isEnabled();
  };
  EXPECT_FALSE(live());
  const auto ground = [this] {
    const QWidget* cells = Grid()->viewport();
    return cells->palette().color(cells->backgroundRole());
  };
  EXPECT_EQ(ground(), form->palette().color(QPalette::Window));
  Click(form.get(), "Option1(1)");
  EXPECT_TRUE(live());
  EXPECT_EQ(ground(), form->palette().color(QPalette::Base));
  Click(form.get(), "Option1(2)");
  EXPECT_FALSE(live());
  Trigger("ulSave");
  EXPECT_EQ(home.Get(kSystem + "Update.Lst"), "ORE,3,Mine\r\n");
  EXPECT_EQ(Kept("UpdateAll"), "True");
  EXPECT_EQ(Kept("NoWarrants"), "True");
}

TEST_F(UpdateListForm, WhatIsBeingTypedIsSaved) {
  download().UpdateAll = false;
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine\r\n");
  Open<INUpList>();
  Trigger("ulAdd");
  QTest::keyClicks(Grid(), "z");
  auto* editor = Grid()->findChild<QLineEdit*>();
  ASSERT_NE(editor, nullptr);
  QTest::keyClicks(editor, "a,p toolong");
  EXPECT_EQ(editor->text(), "zaptoo");
  Trigger("ulSave");
  EXPECT_EQ(Cell(1, 0), "ZAPTOO");
  EXPECT_EQ(home.Get(kSystem + "Update.Lst"), "ORE,3,Mine\r\nZAPTOO,0,\r\n");
}

TEST_F(UpdateListForm, ALostSaveDoesNotHoldTheForm) {
  download().UpdateAll = false;
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine\r\n");
  Open<INUpList>();
  TypeInto(0, 2, "Other");
  std::filesystem::permissions(home.path() + "/" + kSystem + "Update.Lst",
                               std::filesystem::perms(0444));
  dialogs.answers = {Answer::kNo, Answer::kYes};
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(dialogs.said.back().text, "The list could not be saved. Close without saving ?");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kSystem + "Update.Lst"), "ORE,3,Mine\r\n");
}

TEST_F(UpdateListForm, PrintsTheRowsUnderTheirHeadings) {
  Open<INUpList>();
  EXPECT_FALSE(Find<QAction>(form.get(), "UlPrint")->isEnabled());  // no printing, no entry
  test::RecordingPrinter printer;
  print = [&](const TextTable& table, QWidget* over) {
    EXPECT_EQ(over, form.get());
    PrintTable(printer, session->settings.fonts, session->settings.page, table);
  };
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine, Old\r\nZAP,12,Zap\r\n");
  Open<INUpList>();
  Trigger("UlPrint");
  ASSERT_EQ(printer.sent.size(), 1u);
  std::string texts;
  for (const std::string& op : printer.sent[0]) texts += op + "\n";
  size_t at = 0;
  for (const char* text : {" DOWNLOAD UPDATE LIST ", " Page  1 ", " ASX Code ", " CAT. ", " Name ",
                           " ORE ", " 3 ", " Mine, Old ", " ZAP ", " 12 ", " Zap "}) {
    at = texts.find(text, at);
    ASSERT_NE(at, std::string::npos) << text << "\n" << texts;
  }
}

TEST_F(UpdateListForm, TellsThatThereIsNothingToPrint) {
  bool printed = false;
  print = [&](const TextTable&, QWidget*) { printed = true; };
  Open<INUpList>();
  Trigger("UlPrint");
  EXPECT_EQ(dialogs.said.back().text, "No records to print");
  EXPECT_FALSE(printed);
}

TEST_F(UpdateListForm, AnEmptyListIsResetToAll) {
  Open<INUpList>();
  Click(form.get(), "Option1(1)");
  Trigger("ulSave");
  EXPECT_EQ(dialogs.said.back().title, "Update List");
  EXPECT_TRUE(Find<QRadioButton>(form.get(), "Option1(0)")->isChecked());
  EXPECT_EQ(Kept("UpdateAll"), "True");
}

TEST_F(UpdateListForm, ClosesAnUnchangedListWithoutAWord) {
  home.Put(kSystem + "Update.Lst", "ORE,3,Mine\r\n");
  Open<INUpList>();
  Trigger("ulClose");
  EXPECT_FALSE(form->isVisible());
  EXPECT_FALSE(home.Exists(kSystem + "Update.Bak"));
}

}  // namespace
}  // namespace kora
