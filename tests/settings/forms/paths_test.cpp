#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QToolButton>

#include "settings/forms/CPath.h"
#include "settings/forms/Locate.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

class CPathTest : public test::FormTest {
 protected:
  void SetUp() override { ReadSettings(); }

  CPath& Open() {
    form = std::make_unique<CPath>(CPathServices{.ini = session->ini,
                                                 .files = session->files,
                                                 .dialogs = dialogs,
                                                 .settings = session->settings,
                                                 .readAllSettings =
                                                     [this] {
                                                       ++readAgain;
                                                       return true;
                                                     },
                                                 .pathsSaved = [this] { ++saved; },
                                                 .endProgram = [this] { ++ended; },
                                                 .openWMPath = {}},
                                   nullptr);
    filled = form->Fill();
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return *form;
  }
  QLineEdit* Text(const char* name) { return Find<QLineEdit>(form.get(), name); }
  void Type(const char* name, const char* text) {
    Text(name)->setFocus();
    Text(name)->selectAll();
    QTest::keyClick(Text(name), Qt::Key_Delete);
    QTest::keyClicks(Text(name), text);
  }
  std::string Kept(const char* key) { return session->ini.GetSetting("KoraPaths", key); }

  std::unique_ptr<CPath> form;
  bool filled = false;
  int readAgain = 0, saved = 0, ended = 0;
};

TEST_F(CPathTest, ShowsTheFoldersInUse) {
  Open();
  EXPECT_EQ(form->windowTitle(), "Path Details");
  EXPECT_EQ(Text("Text1")->text(), "c:\\korawin\\");
  EXPECT_EQ(Text("Text2")->text(), "c:\\korawin\\data\\");
  EXPECT_EQ(Text("Text4")->text(), "c:\\korawin\\backup\\");
  EXPECT_EQ(Find<QLabel>(form.get(), "Label10(0)")->text(), "c:\\korawin\\pfmdata\\");
  EXPECT_EQ(Find<QLabel>(form.get(), "Label10(1)")->text(), "c:\\korawin\\pfmback\\");
  EXPECT_FALSE(Find<QPushButton>(form.get(), "Command3")->isEnabled());
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(CPathTest, AFieldIsWhiteOnBlueWhileItHasTheFocusAndGetsItsBackslashOnLeaving) {
  Open();
  Type("Text2", "c:\\other");
  EXPECT_EQ(Text("Text2")->palette().color(QPalette::Base), QColor(Qt::blue));
  EXPECT_EQ(Text("Text2")->palette().color(QPalette::Text), QColor(Qt::white));
  EXPECT_EQ(Text("Text2")->text(), "c:\\other");
  QTest::keyClick(Text("Text2"), Qt::Key_Tab);
  EXPECT_EQ(Text("Text2")->text(), "c:\\other\\");
  EXPECT_NE(Text("Text2")->palette().color(QPalette::Base), QColor(Qt::blue));
  Type("Text2", "c:\\other\\");
  QTest::keyClick(Text("Text2"), Qt::Key_Tab);
  EXPECT_EQ(Text("Text2")->text(), "c:\\other\\") << "one is enough";
}

TEST_F(CPathTest, TabGoesThroughTheFieldsAndButtonsInOrder) {
  Open();
  Text("Text1")->setFocus();
  for (const char* name :
       {"Text2", "Picture1(0)", "Text4", "Picture1(1)", "Command1", "Command2"}) {
    QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
    EXPECT_EQ(QApplication::focusWidget()->objectName(), name);
  }
}

TEST_F(CPathTest, SaveKeepsTheFoldersAndCloses) {
  home.files().MakeFolder("d:\\prices\\");
  Open();
  Type("Text2", " d:\\prices ");
  Click(form.get(), "Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "d:\\prices\\");
  EXPECT_EQ(Kept("ChtData"), "d:\\prices\\");
  EXPECT_EQ(Kept("System"), "c:\\korawin\\");
  EXPECT_EQ(saved, 1);
  EXPECT_EQ(readAgain, 0);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(CPathTest, EnterInAFieldSaves) {
  Open();
  Type("Text4", "c:\\safe");
  QTest::keyClick(Text("Text4"), Qt::Key_Return);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Kept("ChtBackUp"), "c:\\safe\\");
}

TEST_F(CPathTest, AFolderThatTheSettingsWouldCutIsToldAndTheFormStays) {
  Open();
  const std::string longer = "c:\\" + std::string(60, 'x') + "\\";
  Type("Text2", longer.c_str());
  Click(form.get(), "Command1");
  EXPECT_TRUE(form->isVisible());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, longer + " is longer than 60 characters");
  EXPECT_EQ(dialogs.said[0].title, "Path Details");
  EXPECT_TRUE(Text("Text2")->hasFocus());
  EXPECT_EQ(Kept("ChtData"), "c:\\korawin\\data\\");
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  Text("Text2")->setText("c:\\\u4E2D\\");
  Click(form.get(), "Command1");
  EXPECT_TRUE(form->isVisible());
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_NE(dialogs.said[1].text.find("has characters that the settings can't hold"),
            std::string::npos);
  EXPECT_EQ(Kept("ChtData"), "c:\\korawin\\data\\");
}

TEST_F(CPathTest, AnEmptyFieldIsToldAndTheFormStays) {
  Open();
  for (const char* name : {"Text1", "Text2", "Text4"}) {
    const QString before = Text(name)->text();
    dialogs.said.clear();
    Type(name, "  ");
    Click(form.get(), "Command1");
    ASSERT_EQ(dialogs.said.size(), 1u) << name;
    EXPECT_EQ(dialogs.said[0].text, "Directory paths must be entered");
    EXPECT_TRUE(form->isVisible());
    Text(name)->setText(before);
  }
  Find<QLabel>(form.get(), "Label10(1)")->setText("");
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(Kept("ChtData"), "c:\\korawin\\data\\");
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  EXPECT_EQ(saved, 0);
}

TEST_F(CPathTest, ClosingUnchangedAsksNothing) {
  Open();
  Click(form.get(), "Command2");
  EXPECT_FALSE(form->isVisible());
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(saved, 0);
}

TEST_F(CPathTest, ADataFolderThatIsNotThereIsToldAndMade) {
  Open();
  Type("Text2", "d:\\prices");
  Click(form.get(), "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Directory d:\\prices\\ does not exist. Create this directory ?");
  EXPECT_TRUE(home.files().IsFolder("d:\\prices\\"));
  EXPECT_EQ(Kept("ChtData"), "d:\\prices\\");
}

TEST_F(CPathTest, ADataFolderThatCantBeWrittenToIsToldByName) {
  home.Put("drive_d/prices", "a file");
  Open();
  Type("Text2", "d:\\prices");
  Click(form.get(), "Command1");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(dialogs.said.back().title, "Path Details");
  EXPECT_EQ(dialogs.said.back().text.find("d:\\prices\\ can't be written to: "), 0u);
  EXPECT_TRUE(Text("Text2")->hasFocus());
  EXPECT_EQ(Kept("ChtData"), "c:\\korawin\\data\\");
}

TEST_F(CPathTest, ClosingAfterAChangeAsksWhetherToSave) {
  home.files().MakeFolder("d:\\one\\");
  Open();
  Type("Text2", "d:\\one");
  dialogs.answers = {Answer::kYes};
  Click(form.get(), "Command2");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Paths have changed. SAVE Changes ?");
  EXPECT_EQ(dialogs.said[0].title, "Save Changes");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Kept("ChtData"), "d:\\one\\");
}

TEST_F(CPathTest, EscapeAfterAChangeAndNoLeavesEverything) {
  Open();
  Type("Text2", "d:\\one");
  dialogs.answers = {Answer::kNo};
  QTest::keyClick(Text("Text2"), Qt::Key_Escape);
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(Kept("ChtData"), "c:\\korawin\\data\\");
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
}

TEST_F(CPathTest, YesWithAnEmptyFieldStays) {
  Open();
  Type("Text2", "");
  QTest::keyClick(Text("Text2"), Qt::Key_A);
  QTest::keyClick(Text("Text2"), Qt::Key_Backspace);
  dialogs.answers = {Answer::kYes};
  Click(form.get(), "Command2");
  EXPECT_EQ(dialogs.said.size(), 2u);
  EXPECT_TRUE(form->isVisible());
}

class MissingPaths : public CPathTest {
 protected:
  void SetUp() override {
    CPathTest::SetUp();
    session->settings.PathsMissing = true;
    session->settings.paths.SystemPath = session->settings.paths.CurrentDataPath = "";
    session->settings.paths.PfmDataPath = "";
  }
};

TEST_F(MissingPaths, AreAskedFor) {
  dialogs.answers = {Answer::kYes};
  Open();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "No Paths selected");
  EXPECT_EQ(dialogs.said[0].text.find("Directory Paths are missing and must be re-entered. "), 0u);
  EXPECT_TRUE(filled);
  EXPECT_EQ(Text("Text1")->text(), "");
}

TEST_F(MissingPaths, CancelEndsTheProgram) {
  dialogs.answers = {Answer::kCancel};
  Open();
  EXPECT_FALSE(filled);
  EXPECT_EQ(ended, 1);
}

TEST_F(MissingPaths, NoTakesTheStandingPathsAndSaveReadsAllSettingsAgain) {
  dialogs.answers = {Answer::kNo};
  dialogs.replies = {"d"};
  Open();
  EXPECT_TRUE(filled);
  EXPECT_EQ(Text("Text1")->text(), "d:\\korawin\\");
  Click(form.get(), "Command1");
  EXPECT_FALSE(session->settings.PathsMissing);
  EXPECT_EQ(readAgain, 1);
  EXPECT_EQ(saved, 1);
  EXPECT_EQ(Kept("System"), "d:\\korawin\\");
}

TEST_F(MissingPaths, NoDriveEndsTheProgram) {
  dialogs.answers = {Answer::kNo};
  dialogs.replies = {std::nullopt};
  Open();
  EXPECT_FALSE(filled);
  EXPECT_EQ(ended, 1);
}

TEST_F(CPathTest, BrowsingPutsTheFolderIntoItsField) {
  home.Put("drive_c/korawin/old/Names.dat", "");
  Open();
  Click(form.get(), "Picture1(0)");
  auto* locate = form->findChild<Locate*>();
  ASSERT_NE(locate, nullptr);
  EXPECT_EQ(locate->windowTitle(), "Modify File Locations");
  EXPECT_EQ(Find<QLabel>(locate, "Label3(0)")->text(), "c:\\korawin\\data\\");
  EXPECT_EQ(Find<QLabel>(locate, "Label3(1)")->text(), "Charting Data File Folder");
  EXPECT_EQ(Find<QComboBox>(locate, "Drive1")->currentText(), "C:");
  auto* list = Find<QListWidget>(locate, "Dir1");
  // Up, then down into the other folder.
  QTest::keyClick(list, Qt::Key_Home);
  QTest::keyClick(list, Qt::Key_Return);
  ASSERT_EQ(Find<QLabel>(locate, "Label3(0)")->text(), "c:\\korawin\\");
  const auto old = list->findItems("old", Qt::MatchExactly);
  ASSERT_EQ(old.size(), 1);
  list->setCurrentItem(old[0]);
  const QPoint middle = list->visualItemRect(old[0]).center();
  QTest::mouseClick(list->viewport(), Qt::LeftButton, {}, middle);
  QTest::mouseDClick(list->viewport(), Qt::LeftButton, {}, middle);
  EXPECT_EQ(Find<QLabel>(locate, "Label3(0)")->text(), "c:\\korawin\\old\\");
  Click(locate, "Command1");
  EXPECT_EQ(Text("Text2")->text(), "c:\\korawin\\old\\");
  dialogs.answers = {Answer::kNo};
  Click(form.get(), "Command2");
  EXPECT_EQ(dialogs.said.size(), 1u) << "a folder chosen is a change";
}

class LocateTest : public test::FormTest {
 protected:
  Locate& Open(const std::string& start) {
    form = std::make_unique<Locate>(
        session->files, dialogs, LocateCase{"Somewhere", start},
        [this](const std::string& folder) { result = folder; }, nullptr);
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return *form;
  }
  std::unique_ptr<Locate> form;
  std::string result = "-";
};

TEST_F(LocateTest, EnterGoesIntoTheFolderAndSaveTakesIt) {
  Open("c:\\korawin\\");
  auto* list = Find<QListWidget>(form.get(), "Dir1");
  EXPECT_EQ(QApplication::focusWidget(), list);
  QTest::keyClick(list, Qt::Key_End);
  EXPECT_EQ(list->currentItem()->text(), "data");
  QTest::keyClick(list, Qt::Key_Return);
  EXPECT_EQ(Find<QLabel>(form.get(), "Label3(0)")->text(), "c:\\korawin\\data\\");
  EXPECT_TRUE(form->isVisible()) << "Enter in the list does not save";
  QTest::keyClick(form.get(), Qt::Key_S, Qt::AltModifier);
  EXPECT_TRUE(WaitFor([&] { return !form->isVisible(); }));  // the button shows its press first
  EXPECT_EQ(result, "c:\\korawin\\data\\");
}

TEST_F(LocateTest, EscapeTakesNothing) {
  Open("c:\\korawin\\");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(result, "-");
}

TEST_F(LocateTest, WithoutAPathSaveSaysSo) {
  Open("");
  Click(form.get(), "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Path not set correctly");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(result, "-");
}

TEST_F(LocateTest, AnotherDriveShowsItsRoot) {
  home.Put("drive_e/stuff/x", "");
  Open("c:\\korawin\\");
  auto* drives = Find<QComboBox>(form.get(), "Drive1");
  drives->setFocus();
  QTest::keyClick(drives, Qt::Key_E);
  EXPECT_EQ(Find<QLabel>(form.get(), "Label3(0)")->text(), "E:\\");
  auto* list = Find<QListWidget>(form.get(), "Dir1");
  ASSERT_EQ(list->count(), 1);
  EXPECT_EQ(list->item(0)->text(), "stuff");
}

TEST_F(LocateTest, AFolderThatIsGoneOpensOnTheOneAbove) {
  Open("c:\\korawin\\gone\\away\\");
  EXPECT_EQ(Find<QLabel>(form.get(), "Label3(0)")->text(), "c:\\korawin\\");
}

}  // namespace
}  // namespace kora
