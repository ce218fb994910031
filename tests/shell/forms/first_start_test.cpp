#include <QAccessible>
#include <QDir>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QToolButton>
#include <filesystem>

#include "base/runtime_error.h"
#include "platform/qt/accessible_names.h"
#include "shell/forms/FirstStart.h"
#include "shell/forms/Logo.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

std::map<std::string, std::string> FilesBelow(const test::TempHome& home,
                                              const std::string& folder) {
  std::map<std::string, std::string> out;
  const std::string root = home.path() + "/" + folder;
  for (const auto& entry : std::filesystem::recursive_directory_iterator(root)) {
    const std::string name = std::filesystem::relative(entry.path(), home.path()).string();
    out[name] = entry.is_regular_file() ? home.Get(name) : "folder";
  }
  return out;
}

// The installation of the fixture's is the data that is there; the new one lies beside it.
class FirstStartTest : public test::FormTest {
 protected:
  FirstStartTest() : own(home.path() + "/new", dialogs) {
    InstallAccessibleNames();
    std::filesystem::create_directories(home.path() + "/new");
  }
  FirstStart& Open() {
    form = std::make_unique<FirstStart>(
        FirstStartServices{own,
                           [this] {
                             ++demos;
                             if (fault) throw RunTimeError(*fault);
                             return !stopped;
                           },
                           [this]() -> std::optional<QString> { return picked; }});
    form->show();
    return *form;
  }
  void Choose(int option) {
    Find<QRadioButton>(form.get(), QString("Option1(%1)").arg(option).toLatin1())->setChecked(true);
  }
  QLineEdit* Folder() { return Find<QLineEdit>(form.get(), "Text1"); }
  bool Accepted() { return form->result() == QDialog::Accepted && !form->isVisible(); }
  // Presses OK, and expects that the question stands and nothing was made.
  void ExpectRefused(const std::string& message) {
    const size_t before = dialogs.said.size();
    Click(form.get(), "Command1");
    EXPECT_FALSE(Accepted());
    EXPECT_TRUE(form->isVisible());
    ASSERT_EQ(dialogs.said.size(), before + 1);
    EXPECT_EQ(dialogs.said.back().title, "First Start");
    EXPECT_EQ(dialogs.said.back().text, message);
    EXPECT_FALSE(home.Exists("new/Kora.ini"));
    EXPECT_FALSE(dialogs.busy);
  }

  Session own;
  std::unique_ptr<FirstStart> form;
  std::optional<QString> picked;
  std::optional<int> fault;
  int demos = 0;
  bool stopped = false;
};

TEST_F(FirstStartTest, IsNeededWhereThereIsNoSettingsFile) {
  EXPECT_TRUE(NeedsFirstStart(own));
  EXPECT_FALSE(NeedsFirstStart(*session));
  home.Put("new/Kora.ini", "rubbish");
  EXPECT_FALSE(NeedsFirstStart(own)) << "what is there is read, and asked about as ever";
}

TEST_F(FirstStartTest, EnterTakesTheInventedMarket) {
  Open();
  QTest::keyClick(form.get(), Qt::Key_Return);
  EXPECT_EQ(demos, 1);
  EXPECT_TRUE(Accepted());
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_FALSE(dialogs.busy);
}

TEST_F(FirstStartTest, AMarketThatWasStoppedOrFailedLeavesTheQuestion) {
  Open();
  stopped = true;
  Click(form.get(), "Command1");
  EXPECT_EQ(demos, 1);
  EXPECT_FALSE(Accepted());
  EXPECT_TRUE(dialogs.said.empty());
  fault = kDiskFull;
  ExpectRefused(ErrorText(kDiskFull));
}

TEST_F(FirstStartTest, EscEndsItAndMakesNothing) {
  Open();
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_EQ(form->result(), QDialog::Rejected);
  EXPECT_TRUE(FilesBelow(home, "new").empty());
}

TEST_F(FirstStartTest, AnEmptyInstallationTellsTheNextSteps) {
  Open();
  Choose(1);
  Click(form.get(), "Command1");
  EXPECT_TRUE(Accepted());
  ASSERT_EQ(dialogs.said.size(), 1u);
  for (const char* part : {"Modify Download Details", "koractl import", "Folder Locations", "F1"})
    EXPECT_NE(dialogs.said[0].text.find(part), std::string::npos) << part;
  EXPECT_TRUE(home.Exists("new/Kora.ini"));
  EXPECT_TRUE(home.Exists("new/drive_c/korawin/data/Names.dat"));
  EXPECT_FALSE(NeedsFirstStart(own));
  ASSERT_TRUE(ReadAllSettings(own, "", false));
  EXPECT_EQ(own.settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  EXPECT_EQ(dialogs.said.size(), 1u) << "nothing is left to ask";
}

TEST_F(FirstStartTest, AFolderOfDataIsOpenedAsItIs) {
  const auto before = FilesBelow(home, "drive_c");
  Open();
  EXPECT_FALSE(Folder()->isEnabled());
  Choose(2);
  EXPECT_TRUE(Folder()->isEnabled());
  picked = QString::fromStdString(home.path() + "/drive_c/korawin/data");
  Click(form.get(), "Picture1(0)");
  EXPECT_EQ(Folder()->text(), *picked);
  Click(form.get(), "Command1");
  EXPECT_TRUE(Accepted());
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(FilesBelow(home, "drive_c"), before);
  EXPECT_FALSE(home.Exists("new/drive_c/korawin/data"));
  ASSERT_TRUE(ReadAllSettings(own, "", false));
  const auto names = ReadNames(own.files, own.settings.paths.CurrentDataPath);
  ASSERT_EQ(names.size(), 3u);
  EXPECT_EQ(names[0].Code.trimmed(), "AAA");
  EXPECT_EQ(own.settings.paths.SystemPath, "c:\\korawin\\");
  EXPECT_EQ(own.settings.charts.VolHeight, 2) << "the settings of a new installation";
}

TEST_F(FirstStartTest, AFolderThatCantBeTheDataFolderIsTold) {
  Open();
  Choose(2);
  ExpectRefused("A folder must be entered.");
  const std::string dos = own.files.DosPath(home.path());
  Folder()->setText(QString::fromStdString(home.path() + "/missing"));
  ExpectRefused("There is no folder " + dos + "\\missing\\.");
  home.Put("bare/x.txt", "");
  Folder()->setText(QString::fromStdString(home.path() + "/bare/"));
  ExpectRefused("There is no name file (Names.dat) in " + dos + "\\bare\\.");
  Folder()->setText(QString::fromStdString(home.path()));
  ExpectRefused("There is no name file (Names.dat) in " + dos +
                "\\.\n\nIt is an installation of its own. Start the program on it with\n"
                "kora --home " +
                home.path());
  const std::string deep(60, 'd');
  home.Put(deep + "/Names.dat", "");
  Folder()->setText(QString::fromStdString(home.path() + "/" + deep));
  ExpectRefused("The path " + dos + "\\" + deep + "\\ is longer than 60 characters.");
}

TEST_F(FirstStartTest, ADialogOfFoldersThatIsCancelledChangesNothing) {
  Open();
  Choose(2);
  Folder()->setText("/data");
  Click(form.get(), "Picture1(0)");
  EXPECT_EQ(Folder()->text(), "/data");
}

TEST_F(FirstStartTest, AHomeThatCantBeWrittenIsTold) {
  home.Put("new/drive_c", "a file where the drive goes");
  Open();
  Choose(1);
  Click(form.get(), "Command1");
  EXPECT_FALSE(Accepted());
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_FALSE(home.Exists("new/Kora.ini"));
}

TEST_F(FirstStartTest, EachControlHasANameAndTheTabGoesThroughThem) {
  Open();
  Choose(2);
  std::vector<std::string> order;
  for (QWidget* w = Find<QRadioButton>(form.get(), "Option1(2)");;) {
    QAccessibleInterface* node = QAccessible::queryAccessibleInterface(w);
    ASSERT_NE(node, nullptr);
    EXPECT_FALSE(node->text(QAccessible::Name).trimmed().isEmpty())
        << w->objectName().toStdString();
    order.push_back(w->objectName().toStdString());
    w->setFocus();
    QTest::keyClick(w, Qt::Key_Tab);
    w = form->focusWidget();
    if (!w || w->objectName().startsWith("Option1") || order.size() > 9) break;
  }
  EXPECT_EQ(order, (std::vector<std::string>{"Option1(2)", "Text1", "Picture1(0)", "Command1",
                                             "Command2"}));
}

}  // namespace
}  // namespace kora
