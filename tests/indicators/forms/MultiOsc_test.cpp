#include "indicators/forms/MultiOsc.h"

#include <QLineEdit>
#include <QListWidget>
#include <filesystem>

#include "tests/support/qt/look_fixture.h"

namespace kora {
namespace {

class MultiOscForm : public test::LookFormTest {
 protected:
  MultiOscForm() { SaveMOSets(ini, 2, {"RSI", "None", "None", "OBV"}); }
  void Open() {
    form = std::make_unique<MultiOsc>(MultiOscServices{ini, dialogs}, nullptr);
    Show();
  }
  QListWidget* List() { return Find<QListWidget>("List1"); }
  void ClickName(const char* name) {
    QListWidgetItem* item = List()->findItems(name, Qt::MatchExactly).value(0);
    ASSERT_NE(item, nullptr) << name;
    QTest::mouseClick(List()->viewport(), Qt::LeftButton, {},
                      List()->visualItemRect(item).center());
  }
  void ClickBox(const char* name) { QTest::mouseClick(Text(name), Qt::LeftButton); }
};

TEST_F(MultiOscForm, ShowsTheNamesAndWhatIsKept) {
  Open();
  EXPECT_EQ(List()->count(), 17);
  EXPECT_EQ(List()->item(0)->text(), "None");
  EXPECT_EQ(List()->item(16)->text(), "Williams %R");
  for (const char* empty : {"Text1(0)", "Text1(3)", "Text2(1)"})
    EXPECT_EQ(Text(empty)->text(), "None") << empty;
  EXPECT_EQ(Text("Text2(0)")->text(), "RSI");
  EXPECT_EQ(Text("Text2(3)")->text(), "OBV");
}

TEST_F(MultiOscForm, AClickOnANamePutsItIntoTheSelectedBox) {
  Open();
  ClickName("MACD");
  EXPECT_EQ(Text("Text1(0)")->text(), "MACD") << "the first box is selected at the start";
  EXPECT_EQ(Text("Text1(0)")->selectedText(), "MACD");
  ClickBox("Text2(1)");
  ClickName("Stochastic (Slow)");
  EXPECT_EQ(Text("Text2(1)")->text(), "Stochastic (Slow)");
  EXPECT_EQ(Text("Text1(0)")->text(), "MACD");
  Click("Command1");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ReadMOSet(ini, 1), (MultiOscSet{"MACD", "None", "None", "None"}));
  EXPECT_EQ(ReadMOSet(ini, 2), (MultiOscSet{"RSI", "Stochastic (Slow)", "None", "OBV"}));
}

TEST_F(MultiOscForm, TheKeyboardDoesTheSame) {
  Open();
  QTest::keyClick(Text("Text1(0)"), Qt::Key_Return);
  EXPECT_TRUE(List()->hasFocus());
  QTest::keyClick(List(), Qt::Key_Down);
  QTest::keyClick(List(), Qt::Key_Return);
  EXPECT_EQ(Text("Text1(0)")->text(), "Directional Movement");
  EXPECT_TRUE(Text("Text1(0)")->hasFocus());
  Text("Text2(3)")->setFocus();
  QTest::keyClick(Text("Text2(3)"), Qt::Key_Delete);
  EXPECT_EQ(Text("Text2(3)")->text(), "None");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(ReadMOSet(ini, 1), (MultiOscSet{"Directional Movement", "None", "None", "None"}));
  EXPECT_EQ(ReadMOSet(ini, 2), (MultiOscSet{"RSI", "None", "None", "None"}));
}

TEST_F(MultiOscForm, WhatWasNotChangedIsNotWritten) {
  Open();
  Click("Command1");
  EXPECT_EQ(ini.GetSetting(kUserSection, "Multi-Osc 1"), kUnknown);
}

TEST_F(MultiOscForm, AStoreThatCannotBeWrittenIsTold) {
  Open();
  ClickName("MACD");
  // A folder stands where the store was.
  std::filesystem::remove(home.path() + "/Kora.ini");
  std::filesystem::create_directory(home.path() + "/Kora.ini");
  Click("Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "C:\\WINDOWS\\Kora.ini can't be written");
}

}  // namespace
}  // namespace kora
