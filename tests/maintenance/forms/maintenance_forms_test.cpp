#include <QListWidget>

#include "maintenance/forms/ADTotals.h"
#include "maintenance/forms/ASXChg.h"
#include "maintenance/forms/ChartBak.h"
#include "maintenance/forms/MoveFiles.h"
#include "maintenance/forms/NameData.h"
#include "maintenance/forms/RemDate.h"
#include "maintenance/forms/TextData.h"
#include "maintenance/forms/TextFull.h"
#include "maintenance/forms/TxtData.h"
#include "tests/maintenance/forms/maintenance_form_fixture.h"

namespace kora::test {
namespace {

using CodeChangeForm = MaintenanceFormTest;
using MoveFilesForm = MaintenanceFormTest;
using NameDataForm = MaintenanceFormTest;
using ADTotalsForm = MaintenanceFormTest;
using RemoveDateForm = MaintenanceFormTest;

// ---- A code that has changed

TEST_F(CodeChangeForm, ACodeIsRenamedByTheKeyboard) {
  Open<ASXChg>();
  EXPECT_EQ(form->windowTitle(), "Code Changed - Combine Files");
  EXPECT_EQ(Focused(), "Text1");
  const std::string prices = PricesOf("AAA");
  Keys("aaa");
  Key(Qt::Key_Tab);
  Keys("new");
  Key(Qt::Key_Return);
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text,
            "Cannot find c:\\korawin\\data\\NEW.WDT\nDo you want data for "
            "c:\\korawin\\data\\AAA.WDT renamed to c:\\korawin\\data\\NEW.WDT?");
  EXPECT_EQ(dialogs.said[1].text, "Data file renamed and AAA changed to NEW in the NAME File");
  EXPECT_EQ(PricesOf("NEW"), prices);
  EXPECT_FALSE(home.Exists(kData + "AAA.WDT"));
  EXPECT_EQ(CodesOfNames(), "NEW CLO XAD ZZZ");
  EXPECT_EQ(Label("Label4"), "");
  form->reject();
  EXPECT_EQ(changed, 1);
}

TEST_F(CodeChangeForm, RefusalsLeadBackToTheirBox) {
  Open<ASXChg>();
  Press("Command2");
  ExpectSaid("Invalid Code", "Old ASX Code");
  EXPECT_EQ(Focused(), "Text1");
  Type("Text1", "AAA");
  Press("Command2");
  ExpectSaid("Invalid Code", "New ASX Code");
  EXPECT_EQ(Focused(), "Text2");
  Type("Text1", "QQQ");
  Type("Text2", "RRR");
  Press("Command2");
  ExpectSaid("Cannot find c:\\korawin\\data\\QQQ.WDT", "File details");
  EXPECT_EQ(Focused(), "Text1");
  form->reject();
  EXPECT_EQ(changed, 0);
}

TEST_F(CodeChangeForm, TwoFilesAreCombined) {
  Open<ASXChg>();
  const std::string both = PricesOf("AAA") + PricesOf("ZZZ");
  Type("Text1", "AAA");
  Type("Text2", "ZZZ");
  Press("Command2");
  EXPECT_EQ(PricesOf("ZZZ"), both);
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "File converted and AAA changed to ZZZ in the NAME File");
  // The name that the new code had stays.
  EXPECT_EQ(CodesOfNames(), "ZZZ CLO XAD ZZZ");
}

// ---- A file to another folder

TEST_F(MoveFilesForm, AFileIsMovedWithItsName) {
  home.Put("drive_c/m/note.txt", "");
  Open<MoveFiles>();
  EXPECT_EQ(Items("File1(0)"),
            (std::vector<std::string>{"AAA.WDT", "CLO.WDT", "XAD.WDT", "ZZZ.WDT"}));
  Press("Command1");
  ExpectSaid(
      "Find the required file on the source side. Click file to highlight. Click >>> button to "
      "move it.",
      "Move KORA Data Files");
  ClickItem(List("File1(0)"), 3);
  Press("Command1");
  ExpectSaid("You have the same folder selected for both Source and Destination",
             "Move KORA Data Files");
  auto* dirs = List("Dir1(1)");
  DoubleClickItem(dirs, 0);
  DoubleClickItem(dirs, 0);
  const auto found = dirs->findItems("m", Qt::MatchFixedString);
  ASSERT_EQ(found.size(), 1);
  dirs->setCurrentItem(found.first());
  QTest::keyClick(dirs, Qt::Key_Return);
  EXPECT_TRUE(Items("File1(1)").empty());
  EXPECT_EQ(Label("Label3(0)") + " " + Label("Label3(1)"), "c:\\korawin\\data\\ c:\\m\\");
  List("File1(0)")->setFocus();
  Key(Qt::Key_Return);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Label("Label2"), "COMPLETED");
  EXPECT_EQ(Items("File1(1)"), (std::vector<std::string>{"ZZZ.WDT"}));
  EXPECT_EQ(PricesOf("ZZZ", "drive_c/m/"), PricesOf("ZZZ"));
  EXPECT_EQ(CodesOfNames("c:\\m\\"), "ZZZ");
  EXPECT_EQ(List("File1(0)")->currentItem()->text(), "ZZZ.WDT");
}

TEST_F(MoveFilesForm, AFolderThatIsGoneMeanwhileIsTold) {
  home.Put("drive_c/m/note.txt", "");
  Open<MoveFiles>();
  auto* dirs = List("Dir1(1)");
  DoubleClickItem(dirs, 0);
  DoubleClickItem(dirs, 0);
  dirs->setCurrentItem(dirs->findItems("m", Qt::MatchFixedString).first());
  QTest::keyClick(dirs, Qt::Key_Return);
  std::filesystem::remove_all(home.path() + "/drive_c/m");
  ClickItem(List("File1(0)"), 0);
  Press("Command1");
  ExpectSaid("Cannot copy - there is a path or file access error. Reselect file and try again",
             "Copy Error");
  EXPECT_EQ(Label("Label2"), "");
}

// ---- Names and files

TEST_F(NameDataForm, EachEntryIsAskedAboutAndTheCountShown) {
  PutNames({Named("ZZZ", "Zinc"), Named("AAA", "Alpha"), Named("GON", "Gone"),
            Named("CLO", "Close", kCloseOnly)});
  Open<NameData>();
  Press("Command4");
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text,
            "Name File Entry exists for GON but NO Data file.\nRemove entry ?");
  EXPECT_EQ(dialogs.said[0].title, "No Data File");
  EXPECT_EQ(dialogs.said[1].text, "Data file exists for XAD but NO Name file entry.\nAdd entry ?");
  EXPECT_EQ(Label("Label1"), " Checking complete ");
  EXPECT_EQ(Label("Label2"), "Names.DAT  has 4 Records");
  EXPECT_EQ(CodesOfNames(), "AAA CLO XAD ZZZ");
  form->reject();
  EXPECT_EQ(changed, 1);
}

TEST_F(NameDataForm, StoppingChangesNothing) {
  PutNames({Named("GON", "Gone"), Named("AAA", "Alpha")});
  const std::string before = home.Get(kData + "Names.dat");
  Open<NameData>();
  StopAtOnce();
  Press("Command4");
  EXPECT_EQ(home.Get(kData + "Names.dat"), before);
  EXPECT_EQ(Label("Label1") + Label("Label2"), "");
  EXPECT_TRUE(form->isVisible());
}

// ---- Totals

TEST_F(ADTotalsForm, TotalsAreWorkedOutFromTheBase) {
  Prices("XAD", {Day("20260226", 9, 30, 20, 1), Day("20260227", 0, 5, 25, 2)});
  Open<ADTotals>();
  EXPECT_EQ(Items("List1"), (std::vector<std::string>{"XAD"}));
  EXPECT_EQ(TextOf("Text1"), "0");
  Press("Command2");
  EXPECT_EQ(Label("Label4"), " Checked XAD\nCumulative Total at end is -10");
  EXPECT_EQ(PricesOf("XAD"),
            Bytes(std::vector{Day("20260226", 0, 30, 20, 10), Day("20260227", 0, 5, 25, -10)}));
  Type("Text1", "100");
  Key(Qt::Key_Return);
  EXPECT_EQ(Label("Label4"), " Checked XAD\nCumulative Total at end is 90");
  Type("Text1", "12x");
  Key(Qt::Key_Return);
  ExpectSaid("Base Value must be numeric", "Base Value");
  EXPECT_EQ(Focused(), "Text1");
  EXPECT_EQ(Label("Label4"), "");
}

TEST_F(ADTotalsForm, WithoutASeriesTheFormStaysAway) {
  PutNames({Named("AAA", "Alpha")});
  EXPECT_TRUE(StaysAway<ADTotals>());
  ExpectSaid("There are no Advance/Declines", "Advance/Decline");
}

// ---- Backup

class BackupForm : public MaintenanceFormTest {
 protected:
  const std::string kBack = "drive_c/korawin/backup/";
  void SetUp() override {
    MaintenanceFormTest::SetUp();
    session->settings.paths.ChartBackupPath = "c:\\korawin\\backup\\";
  }
};

TEST_F(BackupForm, AllFilesAreCopiedAndComeBack) {
  Open<ChartBak>(ChartBak::Way::kBackup);
  EXPECT_EQ(form->windowTitle(), " BACKUP  Charting Data Files");
  EXPECT_EQ(Label("Label4") + " " + Label("Label6"), "Source c:\\korawin\\data\\");
  EXPECT_EQ(Label("Label5") + " " + Label("Label7"), "Destination c:\\korawin\\backup\\");
  const std::vector<std::string> all{"AAA.WDT", "CLO.WDT", "Names.dat", "XAD.WDT", "ZZZ.WDT"};
  EXPECT_EQ(Items("File1"), all);
  QStringList titles;
  QObject::connect(form.get(), &QWidget::windowTitleChanged,
                   [&](const QString& title) { titles << title; });
  Press("Command3");
  ExpectSaid("Directory not found - creating c:\\korawin\\backup", "Copy Files");
  EXPECT_EQ(titles,
            (QStringList{" Now COPYING Charting Data Files", " BACKUP  Charting Data Files"}));
  EXPECT_EQ(Label("Label3"), "5 files copied");
  for (const std::string& name : all) EXPECT_EQ(home.Get(kBack + name), home.Get(kData + name));
  form->reject();
  EXPECT_EQ(changed, 0);

  const std::string before = PricesOf("AAA");
  Prices("AAA", {});
  Open<ChartBak>(ChartBak::Way::kRestore);
  EXPECT_EQ(Label("Label6"), "c:\\korawin\\backup\\");
  titles.clear();
  QObject::connect(form.get(), &QWidget::windowTitleChanged,
                   [&](const QString& title) { titles << title; });
  Key(Qt::Key_B, Qt::AltModifier);
  EXPECT_TRUE(WaitFor([&] { return titles.size() == 2; }));
  EXPECT_EQ(titles.value(0), " Now RESTORING Charting Data Files");
  EXPECT_EQ(PricesOf("AAA"), before);
  form->reject();
  EXPECT_EQ(changed, 1);
}

TEST_F(BackupForm, OneFileIsCopied) {
  home.Put(kBack + "old.txt", "");
  Open<ChartBak>(ChartBak::Way::kBackup);
  Press("Command2");
  EXPECT_EQ(Focused(), "File1");
  EXPECT_FALSE(home.Exists(kBack + "AAA.WDT"));
  ClickItem(List("File1"), 1);
  Press("Command2");
  ExpectSaid("File CLO.WDT copied", "Backup Charting Data");
  EXPECT_EQ(home.Get(kBack + "CLO.WDT"), PricesOf("CLO"));
  EXPECT_FALSE(home.Exists(kBack + "AAA.WDT"));
  std::filesystem::remove(home.path() + "/" + kData + "CLO.WDT");
  Press("Command2");
  ExpectSaid("File not found", "Copy Files");
}

TEST_F(BackupForm, TheButtonsAreOffWhileFilesAreCopied) {
  home.Put(kBack + "old.txt", "");
  Open<ChartBak>(ChartBak::Way::kBackup);
  bool seen = false;
  QTimer::singleShot(0, form.get(), [&] {
    seen = true;
    for (const char* name : {"Command1", "Command2", "Command3"})
      EXPECT_FALSE(On<QPushButton>(name)->isEnabled()) << name;
    EXPECT_TRUE(On<QPushButton>("StopWork")->isVisible());
    form->reject();
    EXPECT_TRUE(form->isVisible()) << "stopped first";
  });
  Press("Command3");
  EXPECT_TRUE(seen);
  EXPECT_TRUE(On<QPushButton>("Command1")->isEnabled());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_TRUE(dialogs.said[0].text.starts_with("Stopped behind ")) << dialogs.said[0].text;
}

TEST_F(BackupForm, WithoutASourceTheFormStaysAway) {
  EXPECT_TRUE(StaysAway<ChartBak>(ChartBak::Way::kRestore));
  ExpectSaid("Path not found", "Copy Files");
}

TEST_F(BackupForm, AFolderThatHoldsNoBackupIsNotRestored) {
  home.Put(kBack + "letter.doc", "x");
  Open<ChartBak>(ChartBak::Way::kRestore);
  Press("Command3");
  ExpectSaid("There is no backup in c:\\korawin\\backup\\", "Copy Files");
  EXPECT_FALSE(home.Exists(kData + "letter.doc"));
}

// ---- Texts

using TextDataForm = MaintenanceFormTest;
using TextFullForm = MaintenanceFormTest;
using TxtDataForm = MaintenanceFormTest;

TEST_F(TextDataForm, TheLatestDateInBothForms) {
  Open<TextData>();
  EXPECT_EQ(form->windowTitle(), "Create Text File of Closing Prices");
  EXPECT_FALSE(Text("Text1")->isEnabled());
  Press("Command1");
  ExpectSaid("Text File 27FEB26.TXT created", "Text File");
  EXPECT_EQ(home.Get(kMisc + "27FEB26.TXT"),
            "AAA,20260227,2.5\r\nCLO,20260227,4\r\nXAD,20260227,1010\r\nZZZ,20260227,7\r\n");
  Tick("Check2");
  EXPECT_FALSE(On<QCheckBox>("Check1")->isChecked());
  Press("Command1");
  EXPECT_EQ(home.Get(kMisc + "27FEB26.TXT").substr(0, 29), "AAA         20260227    2.5\r\n");
}

TEST_F(TextDataForm, AParticularDate) {
  Open<TextData>();
  Tick("Option2");
  EXPECT_EQ(Focused(), "Text1");
  Key(Qt::Key_Return);
  ExpectSaid("A particular date has not been entered", "Text Data");
  EXPECT_EQ(Focused(), "Text1");
  Keys("31/2/26");
  Key(Qt::Key_Return);
  ExpectSaid("The date is not a date d/m/yy", "Text Data");
  Type("Text1", "26/2/26");
  Key(Qt::Key_Return);
  ExpectSaid("Text File 26FEB26.TXT created", "Text File");
  EXPECT_EQ(home.Get(kMisc + "26FEB26.TXT"), "AAA,20260226,1.5\r\n");
}

TEST_F(TextDataForm, StoppingMakesNoFile) {
  Open<TextData>();
  StopAtOnce();
  Press("Command1");
  ExpectSaid("Stopped; no text file was made", "Text File");
  EXPECT_FALSE(home.Exists(kMisc + "27FEB26.TXT"));
}

TEST_F(TextFullForm, AllDaysOfTheSecurityOnShow) {
  Open<TextFull>();
  EXPECT_EQ(TextOf("Text7") + " " + TextOf("Text8"), "AAA Alpha Mining");
  Press("VScroll1(1)");
  EXPECT_EQ(TextOf("Text7"), "CLO");
  Press("VScroll1(0)");
  Press("VScroll1(0)");
  EXPECT_EQ(TextOf("Text7"), "AAA");
  Press("Command1");
  EXPECT_EQ(Label("Label3"), "Text File AAA.txt created");
  EXPECT_EQ(home.Get(kMisc + "AAA.txt"),
            "AAA,26/2/26,1,2,0.5,1.5,100\r\nAAA,27/2/26,2,3,1,2.5,200\r\n");
  EXPECT_TRUE(dialogs.said.empty());
  Enter("Text7", "clo");
  EXPECT_EQ(TextOf("Text7") + Label("Label3"), "CLO");
  Tick("Check2");
  Press("Command1");
  EXPECT_EQ(home.Get(kMisc + "CLO.txt"),
            "CLO     27/2/26   4         4         4         4         0\r\n");
}

TEST_F(TextFullForm, AnUnknownCodeIsToldAndASecurityWithoutDataMakesNoFile) {
  Prices("ZZZ", {});
  Open<TextFull>();
  Enter("Text7", "QQQ");
  ExpectSaid(" File not found", "Data Entry");
  EXPECT_EQ(TextOf("Text7"), "AAA");
  Enter("Text7", "ZZZ");
  Press("Command1");
  ExpectSaid("No data for ZZZ", "Create Text File");
  EXPECT_FALSE(home.Exists(kMisc + "ZZZ.txt"));
  EXPECT_EQ(Label("Label3"), "");
}

TEST_F(TextFullForm, TheTextsOfTheChartsStayUnlessTheUserSaysYes) {
  const std::string notes = "T,8.25,20260226,1.50,A note,255\r\n";
  home.Put(kMisc + "AAA.Txt", notes);
  Open<TextFull>();
  Press("Command1");
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(home.Get(kMisc + "AAA.Txt"), notes);
  EXPECT_EQ(Label("Label3"), "");
  dialogs.answers = {Answer::kYes};
  Press("Command1");
  EXPECT_EQ(Label("Label3"), "Text File AAA.txt created");
  EXPECT_NE(home.Get(kMisc + "AAA.Txt"), notes);
}

class TextsOfAChart : public MaintenanceFormTest {
 protected:
  const std::string kNotes = "drive_c/korawin/chtmisc/AAA.Txt";
  const std::string kTwo = "T,8.25,20260226,1.50,first,255\r\nT,8.25,20260227,2.50,second,255\r\n";
  TxtDataServices Notes() {
    return {.files = session->files,
            .dialogs = dialogs,
            .ChartMiscPath = session->settings.paths.ChartMiscPath,
            .code = "AAA",
            .refresh = [this] { ++refreshed; }};
  }
  TxtData& OpenNotes() {
    auto made = std::make_unique<TxtData>(Notes(), nullptr);
    EXPECT_TRUE(made->Fill());
    return Stand(std::move(made));
  }
  int refreshed = 0;
};

TEST_F(TextsOfAChart, ADoubleClickDropsALineAndSaveRewritesTheFile) {
  home.Put(kNotes, kTwo);
  OpenNotes();
  EXPECT_EQ(Items("List1"),
            (std::vector<std::string>{"26/2/26   1.50   first", "27/2/26   2.50   second"}));
  DoubleClickItem(List("List1"), 0);
  EXPECT_EQ(Items("List1").size(), 1u);
  EXPECT_EQ(home.Get(kNotes), kTwo) << "not saved yet";
  Press("Command1");
  EXPECT_EQ(home.Get(kNotes), "T,8.25,20260227,2.50,second,255\r\n");
  EXPECT_EQ(refreshed, 1);
  List("List1")->setFocus();
  Key(Qt::Key_Delete);
  EXPECT_TRUE(Items("List1").empty());
  Key(Qt::Key_Delete);
  Press("Command2");
  EXPECT_EQ(home.Get(kNotes), "T,8.25,20260227,2.50,second,255\r\n") << "closed without a save";
  EXPECT_EQ(refreshed, 2);
}

TEST_F(TextsOfAChart, RemoveAllDeletesTheFile) {
  home.Put(kNotes, kTwo);
  OpenNotes();
  Press("Command3");
  EXPECT_FALSE(home.Exists(kNotes));
  EXPECT_EQ(refreshed, 1);
  EXPECT_FALSE(form->isVisible());
}

TEST_F(TextsOfAChart, WithoutAFileTheFormStaysAway) {
  TxtData made(Notes(), nullptr);
  EXPECT_FALSE(made.Fill());
  ExpectSaid("THERE IS NO TEXT FOR AAA", "Chart Text");
}

// ---- A date taken out

TEST_F(RemoveDateForm, ADateIsTakenOutOfEveryFile) {
  Open<RemDate>();
  EXPECT_EQ(form->windowTitle(), "Remove Specific Date");
  EXPECT_EQ(TextOf("Text1"), "c:\\korawin\\data\\");
  EXPECT_EQ(Focused(), "Text2");
  Keys("27/2/26");
  Key(Qt::Key_Return);
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Label("Label4"), " COMPLETED c:\\korawin\\data\\");
  EXPECT_EQ(Focused(), "Command2");
  EXPECT_EQ(PricesOf("AAA"), Bytes(std::vector{Day("20260226", 1, 2, 0.5f, 1.5f, 100)}));
  EXPECT_EQ(PricesOf("ZZZ"), "");
  EXPECT_EQ(folderChanged, 0);
  Key(Qt::Key_Space);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(changed, 1);
}

TEST_F(RemoveDateForm, OnlyTheLatestInstance) {
  const PriceRec first = Day("20260227", 1, 1, 1, 1), second = Day("20260227", 2, 2, 2, 2);
  Prices("AAA", {first, second});
  Open<RemDate>();
  Tick("Option1(1)");
  Type("Text2", "27/2/26");
  Press("Command1");
  EXPECT_EQ(PricesOf("AAA"), Bytes(std::vector{first}));
}

TEST_F(RemoveDateForm, RefusalsLeadBackToTheirBoxAndAFolderThatIsThereBecomesTheProgramsOwn) {
  Open<RemDate>();
  Press("Command1");
  ExpectSaid("Date to remove must be entered.", "Remove Selected Data");
  EXPECT_EQ(Focused(), "Text2");
  Type("Text1", " ");
  Press("Command1");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Focused(), "Text1");
  Type("Text1", "c:\\nowhere");
  Press("Command1");
  ExpectSaid("Cannot find c:\\nowhere\\", "Remove Selected Data");
  EXPECT_EQ(folderChanged, 0);
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  home.Put("drive_c/m/Names.dat", "");
  Type("Text1", "c:\\m");
  Type("Text2", "1/3/26");
  Press("Command1");
  EXPECT_EQ(folderChanged, 1);
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\m\\");
  EXPECT_EQ(Label("Label4"), " COMPLETED c:\\m\\");
}

TEST_F(RemoveDateForm, StoppingIsTold) {
  Open<RemDate>();
  Type("Text2", "27/2/26");
  StopAtOnce();
  Press("Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_TRUE(dialogs.said[0].text.starts_with("Stopped behind ")) << dialogs.said[0].text;
  EXPECT_TRUE(form->isVisible());
}

}  // namespace
}  // namespace kora::test
