#include "maintenance/forms/DataEntry.h"

#include "tests/maintenance/forms/maintenance_form_fixture.h"

namespace kora::test {
namespace {

class DataEntryForm : public MaintenanceFormTest {};

TEST_F(DataEntryForm, ShowsTheFirstSecurityWithWhatItHadLast) {
  Open<DataEntry>();
  EXPECT_EQ(form->windowTitle(), "Data Entry - Keyboard");
  EXPECT_EQ(Label("Label18"), "c:\\korawin\\data\\");
  EXPECT_EQ(TextOf("Text7"), "AAA");
  EXPECT_EQ(TextOf("Text8"), "Alpha Mining");
  EXPECT_EQ(Label("Label17"), "Rec.Tp  4");
  EXPECT_EQ(Label("Label9"), "27/2/26");
  EXPECT_EQ(Label("Previous(0)") + " " + Label("Previous(1)") + " " + Label("Previous(2)") + " " +
                Label("Previous(3)") + " " + Label("Previous(4)"),
            "2 3 1 2.5 200");
  EXPECT_EQ(TextOf("Text1"), "");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataEntryForm, ADayIsTypedInByTheKeyboardFromTheDateToTheSaveButton) {
  Open<DataEntry>();
  EXPECT_EQ(Focused(), "Text1");
  Keys("2/3/26");
  for (const auto& [name, text] : {std::pair{"Text7", ""},
                                   {"Text2", "3"},
                                   {"Text3", "4"},
                                   {"Text4", "2"},
                                   {"Text5", "3.5"},
                                   {"Text6", "300"}}) {
    Key(Qt::Key_Tab);
    ASSERT_EQ(Focused(), name);
    Keys(text);
  }
  Key(Qt::Key_Tab);
  EXPECT_EQ(Focused(), "Command1");
  Key(Qt::Key_Space);
  EXPECT_EQ(PricesOf("AAA"), Bytes(std::vector{Day("20260226", 1, 2, 0.5f, 1.5f, 100),
                                               Day("20260227", 2, 3, 1, 2.5f, 200),
                                               Day("20260302", 3, 4, 2, 3.5f, 300)}));
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Label("Label9"), "2/3/26");
  EXPECT_EQ(Label("Previous(3)"), "3.5");
  EXPECT_EQ(TextOf("Text5"), "");
  EXPECT_EQ(Focused(), "Text7");
  EXPECT_EQ(Text("Text7")->selectedText(), "AAA");
  EXPECT_EQ(changed, 0);
  Key(Qt::Key_Escape);
  EXPECT_EQ(changed, 1);
}

TEST_F(DataEntryForm, EnterInAPriceSavesAndOnceMoreIsRefused) {
  Open<DataEntry>();
  Enter("Text7", "clo");
  EXPECT_EQ(TextOf("Text7"), "CLO");
  EXPECT_EQ(Label("Label17"), "Rec.Tp  2");
  EXPECT_TRUE(dialogs.said.empty());
  Type("Text1", "2/3/26");
  Enter("Text5", "4.5");
  const std::string saved =
      Bytes(std::vector{Day("20260227", 4, 4, 4, 4), Day("20260302", 4.5f, 4.5f, 4.5f, 4.5f)});
  EXPECT_EQ(PricesOf("CLO"), saved);
  Enter("Text5", "");
  ExpectSaid("Use previous close \n Close should not be 0", "Data Entry");
  EXPECT_EQ(Focused(), "Text5");
  EXPECT_EQ(PricesOf("CLO"), saved);
}

TEST_F(DataEntryForm, EachKindShowsItsBoxes) {
  Open<DataEntry>();
  const auto shown = [this] {
    std::string out;
    for (const char* name : {"Text2", "Text3", "Text4", "Text5", "Text6"})
      out += Text(name)->isVisible() ? '1' : '0';
    return out;
  };
  EXPECT_EQ(shown(), "11111");
  Press("UpDown1(1)");
  EXPECT_EQ(TextOf("Text7"), "CLO");
  EXPECT_EQ(shown(), "00010");
  Press("UpDown1(1)");
  EXPECT_EQ(TextOf("Text7"), "XAD");
  EXPECT_EQ(shown(), "01111");
  std::string captions;
  for (const QLabel* label : form->findChildren<QLabel*>())
    if (label->isVisible() && label->buddy()) captions += label->text().toStdString() + ";";
  EXPECT_EQ(captions, "Da&te  d/m/yy;&Code;R&ises;&Falls;C&um.Total;&Volume;");
  for (int i = 0; i < 5; ++i) Press("UpDown1(1)");
  EXPECT_EQ(TextOf("Text7"), "ZZZ");
  for (int i = 0; i < 5; ++i) Press("UpDown1(0)");
  EXPECT_EQ(TextOf("Text7"), "AAA");
}

TEST_F(DataEntryForm, ATotalThatDoesNotFollowIsRefused) {
  Open<DataEntry>();
  Enter("Text7", "XAD");
  Type("Text1", "2/3/26");
  Type("Text3", "5");
  Type("Text4", "6");
  Enter("Text5", "1008");
  ExpectSaid("Cumulative total must equal\nPrevious total + Rises - Falls", "Advance/Decline Edit");
  EXPECT_EQ(Focused(), "Text5");
  Enter("Text5", "1009");
  EXPECT_EQ(PricesOf("XAD"),
            Bytes(std::vector{Day("20260227", 0, 30, 20, 1010), Day("20260302", 0, 5, 6, 1009)}));
}

TEST_F(DataEntryForm, AdvanceGoesOnToTheNextSecurityAndTheDateMovesBehindItsLast) {
  Prices("CLO", {Day("20260226", 4, 4, 4, 4)});
  Open<DataEntry>();
  Tick("Check2");
  // The day behind a Friday is a Saturday: three days on.
  EXPECT_EQ(TextOf("Text1"), "2/3/26");
  Tick("Check1");
  for (const char* name : {"Text2", "Text3", "Text4"}) Type(name, "3");
  Enter("Text5", "3");
  EXPECT_EQ(TextOf("Text7"), "CLO");
  EXPECT_EQ(TextOf("Text1"), "27/2/26");
  EXPECT_EQ(Focused(), "Text7");
  EXPECT_EQ(TextOf("Text5"), "");
}

TEST_F(DataEntryForm, AutoDateAdvanceAloneMovesTheDateOfTheSameSecurity) {
  Open<DataEntry>();
  Enter("Text7", "CLO");
  Tick("Check2");
  EXPECT_EQ(TextOf("Text1"), "2/3/26");
  Enter("Text5", "4");
  EXPECT_EQ(TextOf("Text7"), "CLO");
  EXPECT_EQ(TextOf("Text1"), "3/3/26");
}

TEST_F(DataEntryForm, ResetClearsTheBoxes) {
  Open<DataEntry>();
  Type("Text1", "2/3/26");
  Type("Text5", "9");
  Type("Text7", "CL");
  Press("Command2");
  EXPECT_EQ(TextOf("Text1") + TextOf("Text5"), "");
  EXPECT_EQ(TextOf("Text7"), "AAA");
  EXPECT_EQ(Focused(), "Text1");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(DataEntryForm, ACodeThatIsUnknownIsToldAndTheSecurityStays) {
  Open<DataEntry>();
  Type("Text7", "QQQ");
  Key(Qt::Key_Tab);
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said.front().text, "No File For That Name");
  EXPECT_EQ(TextOf("Text7"), "AAA");
  EXPECT_EQ(Focused(), "Text7");
}

TEST_F(DataEntryForm, ACodeTypedInFrontOfTheSaveKeyIsShownAndNothingSaved) {
  Open<DataEntry>();
  const std::string before = PricesOf("AAA") + PricesOf("CLO");
  Type("Text1", "2/3/26");
  Type("Text5", "4");
  Type("Text7", "clo");
  Key(Qt::Key_S, Qt::AltModifier);
  ASSERT_TRUE(WaitFor([&] { return TextOf("Text7") == "CLO"; }));
  EXPECT_EQ(Label("Label17"), "Rec.Tp  2");
  EXPECT_EQ(PricesOf("AAA") + PricesOf("CLO"), before);
}

TEST_F(DataEntryForm, ASecurityWithoutPricesIsTold) {
  Prices("ZZZ", {});
  Open<DataEntry>();
  Enter("Text7", "ZZZ");
  ExpectSaid("No previous data for ZZZ", "Data Entry");
  EXPECT_EQ(Label("Label9") + Label("Previous(3)"), "");
}

TEST_F(DataEntryForm, AnEmptyNameFileIsToldAndTheFormStaysAway) {
  PutNames({});
  EXPECT_TRUE(StaysAway<DataEntry>());
  ExpectSaid("No Records in Name File", "Data Entry");
}

TEST_F(DataEntryForm, WhatIsNoDateNoNumberOrTooLargeLeadsBackToItsBox) {
  Open<DataEntry>();
  const std::string before = PricesOf("AAA");
  for (const char* name : {"Text2", "Text3", "Text4", "Text5"}) Type(name, "3");
  Type("Text1", "30/2/26");
  Press("Command1");
  ExpectSaid("The date is not a date d/m/yy", "Data Entry");
  EXPECT_EQ(Focused(), "Text1");
  Type("Text1", "2/3/26");
  Type("Text4", "3,5");
  Press("Command1");
  ExpectSaid("Data must be numeric", "Data Entry");
  EXPECT_EQ(Focused(), "Text4");
  Type("Text4", "1e99");
  Press("Command1");
  ExpectSaid("The number is too large", "Data Entry");
  Type("Text4", "3");
  Type("Text6", "2147483648");
  Press("Command1");
  ExpectSaid("The number is too large", "Data Entry");
  EXPECT_EQ(Focused(), "Text6");
  EXPECT_EQ(PricesOf("AAA"), before);
}

TEST_F(DataEntryForm, AnotherFolderIsTheFormsOwn) {
  home.Put("drive_c/m/Names.dat", Bytes(std::vector{Named("MMM", "Em")}));
  Prices("MMM", {Day("20260227", 1, 1, 1, 1)}, "drive_c/m/");
  Open<DataEntry>();
  const auto choose = [&](const char* folder) {
    QTimer::singleShot(0, form.get(), [this, folder] {
      auto* locate = form->findChild<QDialog*>("Locate");
      ASSERT_NE(locate, nullptr);
      auto* dirs = locate->findChild<QListWidget*>("Dir1");
      for (const char* step : {"..", "..", folder}) {
        const auto found = dirs->findItems(step, Qt::MatchFixedString);
        ASSERT_EQ(found.size(), 1) << step;
        dirs->setCurrentItem(found.first());
        QTest::keyClick(dirs, Qt::Key_Return);
      }
      QTest::mouseClick(locate->findChild<QPushButton*>("Command1"), Qt::LeftButton);
    });
    Press("Command4");
  };
  choose("m");
  EXPECT_EQ(Label("Label18"), "c:\\m\\");
  EXPECT_EQ(TextOf("Text7"), "MMM");
  EXPECT_EQ(session->settings.paths.CurrentDataPath, "c:\\korawin\\data\\");
  home.Put("drive_c/empty/x", "");
  QTimer::singleShot(0, form.get(), [this] {
    auto* locate = form->findChild<QDialog*>("Locate");
    auto* dirs = locate->findChild<QListWidget*>("Dir1");
    for (const char* step : {"..", "empty"}) {
      dirs->setCurrentItem(dirs->findItems(step, Qt::MatchFixedString).first());
      QTest::keyClick(dirs, Qt::Key_Return);
    }
    QTest::mouseClick(locate->findChild<QPushButton*>("Command1"), Qt::LeftButton);
  });
  Press("Command4");
  ExpectSaid("No Records in Name File", "Data Entry");
  EXPECT_EQ(Label("Label18"), "c:\\m\\");
}

}  // namespace
}  // namespace kora::test
