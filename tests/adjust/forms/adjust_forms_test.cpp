#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>

#include "adjust/forms/Adjust.h"
#include "adjust/forms/figure_form.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

using test::Bytes;
using test::Security;

constexpr const char* kData = "drive_c/korawin/data/";

class AdjustForms : public test::FormTest {
 protected:
  AdjustForms() {
    ReadSettings();
    NameRec ore = Security("ORE");
    ore.Name.set("Ore Ltd");
    home.Put(std::string(kData) + "Names.dat",
             Bytes<NameRec>({Security("XAD", 1, kAdvanceDecline), ore, Security("TYP", 1, 2),
                             Security("XAO", 1, kIndex)}));
    std::vector<PriceRec> days;
    for (int i = 1; i <= 28; ++i)
      days.push_back(
          test::Day("199809" + std::string(i < 10 ? "0" : "") + std::to_string(i), 5, 5, 5, 5, i));
    for (const char* code : {"ORE", "XAO"})
      home.Put(std::string(kData) + code + ".WDT", Bytes(days));
  }

  void Open() {
    form = std::make_unique<Adjust>(
        AdjustFormServices{
            .adjust = {session->files, dialogs, session->settings.paths.CurrentDataPath,
                       session->settings.paths.ChartMiscPath, 255},
            .current = session->current,
            .disableMenus = [this] { ++menusOff; },
            .enableMenus = [this] { --menusOff; },
            .adjusted = [this] { ++adjusted; }},
        nullptr);
    form->Fill();
    form->show();
    form->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(form.get()));
  }
  QDialog* OpenKind(int option, const char* name) {
    Find<QRadioButton>(form.get(), ("Option" + std::to_string(option)).c_str())->click();
    QDialog* open = nullptr;
    for (QDialog* child : form->findChildren<QDialog*>())
      if (child->isVisible() && child->objectName() == name) open = child;
    EXPECT_NE(open, nullptr) << name;
    if (!open) return open;
    EXPECT_TRUE(WaitFor([&] {
      open->activateWindow();
      return open->isActiveWindow();
    }));
    return open;
  }
  static void Type(QDialog* in, const char* box, const char* text) {
    auto* edit = Find<QLineEdit>(in, box);
    edit->setFocus();
    edit->selectAll();
    QTest::keyClicks(edit, text);
  }
  QString Shown(const char* box) { return Find<QLineEdit>(form.get(), box)->text(); }
  PriceRec Record(const std::string& code, int n) {
    return PriceFile(session->files, "c:\\korawin\\data\\" + code + ".WDT").Read(n);
  }
  void ExpectSaid(const std::string& text, const std::string& title) {
    ASSERT_FALSE(dialogs.said.empty());
    EXPECT_EQ(dialogs.said.back().text, text);
    EXPECT_EQ(dialogs.said.back().title, title);
  }

  std::unique_ptr<Adjust> form;
  int menusOff = 0, adjusted = 0;
};

TEST_F(AdjustForms, ShowsTheFirstShareOrIndexAndStepsThroughThemRoundTheEnds) {
  Open();
  EXPECT_EQ(form->windowTitle(), "Adjustments for Issues");
  EXPECT_EQ(menusOff, 1);
  EXPECT_EQ(Shown("Text7"), "ORE");
  EXPECT_EQ(Shown("Text8"), "Ore Ltd");
  EXPECT_EQ(session->current.CurrentCode, "ORE");
  Click(form.get(), "UpDown1(1)");
  EXPECT_EQ(Shown("Text7"), "XAO");
  EXPECT_EQ(session->current.PriceFileName, "c:\\korawin\\data\\XAO.WDT");
  Click(form.get(), "UpDown1(1)");
  EXPECT_EQ(Shown("Text7"), "ORE");
  Click(form.get(), "UpDown1(0)");
  EXPECT_EQ(Shown("Text7"), "XAO");
  Click(form.get(), "Command2");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(menusOff, 0);
}

TEST_F(AdjustForms, EachKindOpensItsFormInPlaceOfTheOneBefore) {
  Open();
  const std::pair<const char*, const char*> kinds[] = {
      {"AdjustB", "Bonus Issue"},   {"AdjustC", "Cash Issues"},
      {"AdjustSS", "Share Splits"}, {"AdjustCC", "Calls on Contributing Shares"},
      {"AdjustD", "Dividends"},     {"AdjustR", "Remove Adjustment"}};
  for (int i = 0; i < 6; ++i) {
    const QDialog* open = OpenKind(i + 1, kinds[i].first);
    ASSERT_NE(open, nullptr);
    EXPECT_EQ(open->windowTitle(), kinds[i].second);
    EXPECT_EQ(form->findChildren<QDialog*>(QString(), Qt::FindDirectChildrenOnly).size(), 1);
  }
}

TEST_F(AdjustForms, ABonusIssueIsCheckedChosenAndCarriedOut) {
  Open();
  QDialog* bonus = OpenKind(1, "AdjustB");
  EXPECT_FALSE(Find<QPushButton>(bonus, "Command1")->isEnabled());
  Type(bonus, "Text1", "1");
  Type(bonus, "Text2", "4");
  Type(bonus, "Text3", "22-9-98");
  EXPECT_EQ(Find<QLabel>(bonus, "Label1")->text(), "Ratio of Bonus Issue is 1:4");
  Click(bonus, "Command3");
  auto* list = Find<QDialog>(bonus, "AdjDate");
  ASSERT_NE(list, nullptr);
  EXPECT_EQ(list->windowTitle(), "Exercise Date");
  auto* combo = Find<QComboBox>(list, "Combo1");
  EXPECT_EQ(combo->count(), 27);  // records 2 to 28
  EXPECT_EQ(combo->currentIndex(), 20);
  EXPECT_EQ(combo->currentText(), "22/09/1998             5.00");
  EXPECT_EQ(Find<QLineEdit>(bonus, "Text3")->text(), "22/9/98");
  EXPECT_TRUE(Find<QPushButton>(bonus, "Command1")->isEnabled());
  EXPECT_FALSE(Find<QPushButton>(bonus, "Command3")->isEnabled());
  QTest::keyClick(combo, Qt::Key_Up);
  EXPECT_EQ(Find<QLineEdit>(bonus, "Text3")->text(), "21/9/98");
  Click(bonus, "Command1");
  ExpectSaid("Adjustments made to\nORE", "Data Adjustments");
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(Record("ORE", 1).Close, 4);
  EXPECT_EQ(Record("ORE", 21).AdjFactor, 0.8f);
  EXPECT_EQ(Record("ORE", 22).Close, 5);
  EXPECT_EQ(adjusted, 1);
  EXPECT_FALSE(bonus->isVisible());
  EXPECT_TRUE(form->isVisible());
}

TEST_F(AdjustForms, EnterChecksTheDateTakesItAndAdjusts) {
  Open();
  QDialog* bonus = OpenKind(1, "AdjustB");
  Type(bonus, "Text1", "1");
  Type(bonus, "Text2", "4");
  Type(bonus, "Text3", "22-9-98");
  QTest::keyClick(Find<QLineEdit>(bonus, "Text3"), Qt::Key_Return);
  QPointer<QDialog> list = Find<QDialog>(bonus, "AdjDate");
  ASSERT_NE(list, nullptr);
  QTest::keyClick(Find<QComboBox>(list, "Combo1"), Qt::Key_Up);
  QTest::keyClick(Find<QComboBox>(list, "Combo1"), Qt::Key_Return);
  EXPECT_TRUE(WaitFor([&] { return !list; }));
  EXPECT_TRUE(dialogs.said.empty());
  QTest::keyClick(Find<QLineEdit>(bonus, "Text3"), Qt::Key_Return);
  ExpectSaid("Adjustments made to\nORE", "Data Adjustments");
  EXPECT_EQ(Record("ORE", 21).AdjFactor, 0.8f);
}

TEST_F(AdjustForms, ASplitsLookUpIsThatOfABonusIssueAndTellsNoDate) {
  Open();
  QDialog* split = OpenKind(3, "AdjustSS");
  Type(split, "Text1", "2");
  Type(split, "Text2", "1");
  Type(split, "Text3", "1/10/98");
  Click(split, "Command3");
  ExpectSaid("No close price on file for \n Nearest date prior is 28/09/1998\n Close price is 5",
             "Adjust Data");
  EXPECT_EQ(Find<QLineEdit>(split, "Text3")->text(), "1/10/98") << "a line sets no date here";
  Click(split, "Command1");
  EXPECT_EQ(Record("ORE", 28).Close, 2.5f);
  EXPECT_EQ(Record("ORE", 28).AdjDesc.trimmed(), "ss2:1");
}

TEST_F(AdjustForms, MoneyKindsTakeAnAmount) {
  Open();
  QDialog* dividend = OpenKind(5, "AdjustD");
  Type(dividend, "Text4", "0.25");
  Type(dividend, "Text3", "21/9/98");
  Click(dividend, "Command3");
  Click(dividend, "Command1");
  EXPECT_EQ(Record("ORE", 21).AdjFactor, 0.95f);
  EXPECT_EQ(Record("ORE", 21).AdjDesc.trimmed(), "dv0.25");
}

TEST_F(AdjustForms, AFieldThatIsNoNumberIsToldAndKeepsTheFocus) {
  Open();
  QDialog* bonus = OpenKind(1, "AdjustB");
  Type(bonus, "Text1", "one");
  QTest::keyClick(Find<QLineEdit>(bonus, "Text1"), Qt::Key_Tab);
  ASSERT_EQ(dialogs.said.size(), 1u);
  ExpectSaid(" Data must be numeric ", " Data Input ");
  EXPECT_TRUE(Find<QLineEdit>(bonus, "Text1")->hasFocus());
  Click(bonus, "Command2");
  EXPECT_FALSE(bonus->isVisible());
  EXPECT_EQ(dialogs.said.size(), 1u) << "who closes the form is not asked again";
}

TEST_F(AdjustForms, IncompleteFiguresAndBadDatesAreTold) {
  Open();
  QDialog* bonus = OpenKind(1, "AdjustB");
  Click(bonus, "Command3");
  ExpectSaid("Ratio Data incomplete", "Adjust Data");
  Type(bonus, "Text1", "1");
  Type(bonus, "Text2", "4");
  Click(bonus, "Command3");
  ExpectSaid(" Date must be entered", "Adjust Data");
  Type(bonus, "Text3", "220998");
  Click(bonus, "Command3");
  ExpectSaid(" Use  /   or  -  to separate day/month/year\n eg.  2/10/93",
             "Incorrect Date Format ");
  Type(bonus, "Text3", "1/9/98");
  Click(bonus, "Command3");
  ExpectSaid("No close price on file for 1/9/98", "Adjust Data");
  EXPECT_FALSE(Find<QPushButton>(bonus, "Command1")->isEnabled());
  EXPECT_EQ(Record("ORE", 1).Close, 5);
}

TEST_F(AdjustForms, AnotherSecurityOrDateForgetsWhatWasLookedUp) {
  Open();
  QDialog* bonus = OpenKind(1, "AdjustB");
  Type(bonus, "Text1", "1");
  Type(bonus, "Text2", "4");
  for (const bool security : {true, false}) {
    Type(bonus, "Text3", "22/9/98");
    Click(bonus, "Command3");
    ASSERT_TRUE(Find<QPushButton>(bonus, "Command1")->isEnabled());
    if (security)
      Click(form.get(), "UpDown1(1)");
    else
      Type(bonus, "Text3", "2");
    EXPECT_FALSE(Find<QPushButton>(bonus, "Command1")->isEnabled());
    EXPECT_TRUE(Find<QPushButton>(bonus, "Command3")->isEnabled());
  }
}

TEST_F(AdjustForms, RemovalGoesOnWhileThereAreMoreAndTheUserWants) {
  Open();
  for (int n : {10, 20}) {
    PriceFile file(session->files, "c:\\korawin\\data\\ORE.WDT", OpenMode::kReadWrite);
    PriceRec rec = file.Read(n);
    rec.AdjFactor = 0.5f;
    file.Write(n, rec);
  }
  Click(OpenKind(6, "AdjustR"), "Command1");
  ASSERT_EQ(dialogs.said.size(), 2u);
  EXPECT_EQ(dialogs.said[0].text, "Latest adjustment removed for ORE\nRemove next adjustment ?");
  EXPECT_EQ(dialogs.said[1].text, "Latest adjustment removed for ORE");
  EXPECT_EQ(dialogs.said[1].title, "Remove Adjustment");
  EXPECT_EQ(Record("ORE", 1).Close, 20);
  EXPECT_EQ(Record("ORE", 15).Close, 10);
  EXPECT_EQ(adjusted, 1);
  Click(OpenKind(6, "AdjustR"), "Command1");
  ExpectSaid("File has not previously been adjusted", "Remove Adjustments");
  EXPECT_EQ(adjusted, 1);
}

TEST_F(AdjustForms, ANameFileThatAnotherProgramChangedIsReadAgain) {
  Open();
  Click(form.get(), "UpDown1(1)");
  session->files.WriteAll("c:\\korawin\\data\\Names.dat",
                          Bytes<NameRec>({Security("NEW"), Security("ORE"), Security("XAO")}));
  QEvent back(QEvent::WindowActivate);
  QApplication::sendEvent(form.get(), &back);
  EXPECT_EQ(Shown("Text7"), "XAO") << "the security on show stays";
  Click(form.get(), "UpDown1(1)");
  EXPECT_EQ(Shown("Text7"), "NEW");
}

TEST_F(AdjustForms, WithoutSharesThereIsNothingToAdjust) {
  home.Put(std::string(kData) + "Names.dat", Bytes<NameRec>({Security("XAD", 1, 3)}));
  Open();
  EXPECT_EQ(Shown("Text7"), "");
  EXPECT_FALSE(Find<QRadioButton>(form.get(), "Option1")->isEnabled());
  Click(form.get(), "UpDown1(1)");
}

}  // namespace
}  // namespace kora
