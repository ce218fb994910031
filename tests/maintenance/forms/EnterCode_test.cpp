#include "maintenance/forms/EnterCode.h"

#include "tests/support/qt/list_form_fixture.h"

namespace kora::test {
namespace {

class EnterCodeTest : public ListFormTest {
 protected:
  EnterCode& Open(bool forList = false) {
    EnterCodeServices services{.files = home.files(),
                               .dataPath = session->settings.paths.CurrentDataPath,
                               .dialogs = dialogs,
                               .lastIndex = lastIndex};
    if (forList)
      services.select = [this](const std::string& code) { selected.push_back(code); };
    else
      services.view = [this](const CodeSelection& selection, QWidget*) {
        viewed.push_back(selection.CurrentDataFile());
      };
    EnterCode& opened = Stand(std::make_unique<EnterCode>(std::move(services), nullptr));
    opened.Fill();
    return opened;
  }
  std::string LabelOf(const char* name) { return On<QLabel>(name)->text().toStdString(); }

  int lastIndex = 0;
  std::vector<std::string> viewed, selected;
};

TEST_F(EnterCodeTest, TakesEveryCodeInFileOrderAndTheLastPlaceAgain) {
  lastIndex = 3;
  Open();
  EXPECT_EQ(form->windowTitle(), "Code Selection");
  EXPECT_EQ(Items("List1"), (std::vector<std::string>{"AAA", "BBB", "BHP", "XAO", "ADV", "ZZZ"}));
  EXPECT_EQ(List("List1")->currentRow(), 3);
  EXPECT_EQ(LabelOf("Label4") + " " + LabelOf("Label3"), "All Ords XAO.WDT");
}

TEST_F(EnterCodeTest, AClickTakesTheCodeAndIsRemembered) {
  Open();
  ClickItem(List("List1"), 2);
  EXPECT_EQ(TextOf("GetCode"), "BHP");
  EXPECT_EQ(LabelOf("Label4") + " " + LabelOf("Label3"), "Broken Hill BHP.WDT");
  EXPECT_EQ(lastIndex, 2);
}

TEST_F(EnterCodeTest, ATypedCodeMovesTheListAndItsTextIsSelected) {
  Open();
  Enter("GetCode", "adv");
  EXPECT_EQ(List("List1")->currentRow(), 4);
  EXPECT_EQ(LabelOf("Label4") + " " + LabelOf("Label3"), "Advances ADV.WDT");
  EXPECT_TRUE(Text("GetCode")->hasSelectedText());
  EXPECT_TRUE(viewed.empty());
}

TEST_F(EnterCodeTest, ACodeTypedWhenTheNameFileIsGoneIsTold) {
  Open();
  std::filesystem::remove(home.path() + "/drive_c/korawin/data/Names.dat");
  Enter("GetCode", "BBB");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Code Selection");
  EXPECT_TRUE(dialogs.said[0].text.starts_with("There is an unexpected error number 53\n"))
      << dialogs.said[0].text;
}

TEST_F(EnterCodeTest, TheFirstCodeIsTakenWhereTheListStands) {
  lastIndex = 2;
  Open();
  Enter("GetCode", "AAA");
  EXPECT_EQ(List("List1")->currentRow(), 2);
  EXPECT_EQ(LabelOf("Label3"), "AAA.WDT");
  Press("Command1");
  EXPECT_EQ(viewed, std::vector<std::string>{"c:\\korawin\\data\\AAA.WDT"});
}

TEST_F(EnterCodeTest, ACodeThatIsNotThereIsToldAndNothingIsViewed) {
  Open();
  Enter("GetCode", "NONE");
  ExpectSaid("No File For That Name", "Name File");
  EXPECT_EQ(Text("GetCode")->selectedText(), "NONE");
  Press("Command1");
  ExpectSaid("No File For That Name", "Name File");
  EXPECT_TRUE(viewed.empty());
}

TEST_F(EnterCodeTest, ADoubleClickViewsTheData) {
  Open();
  DoubleClickItem(List("List1"), 1);
  EXPECT_EQ(viewed, std::vector<std::string>{"c:\\korawin\\data\\BBB.WDT"});
}

TEST_F(EnterCodeTest, ServesTheChartListEditor) {
  Open(true);
  EXPECT_EQ(form->findChild<QPushButton*>("Command1"), nullptr);
  ClickItem(List("List1"), 2);
  Press("Command3");
  DoubleClickItem(List("List1"), 1);
  EXPECT_EQ(selected, (std::vector<std::string>{"BHP", "BBB"}));
}

TEST_F(EnterCodeTest, NamesThatAnotherProgramChangedAreReadAgain) {
  Open();
  ClickItem(List("List1"), 2);
  PutNames({Named("NEW", "New"), Named("BHP", "Broken Hill")});
  QEvent back(QEvent::WindowActivate);
  QApplication::sendEvent(form.get(), &back);
  EXPECT_EQ(Items("List1"), (std::vector<std::string>{"NEW", "BHP"}));
  EXPECT_EQ(List("List1")->currentRow(), 1);
}

TEST_F(EnterCodeTest, AnEmptyNameFileHasNothingToView) {
  PutNames({});
  Open();
  Press("Command1");
  ExpectSaid("No File For That Name", "Name File");
}

}  // namespace
}  // namespace kora::test
