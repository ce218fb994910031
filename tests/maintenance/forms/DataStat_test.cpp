#include "maintenance/forms/DataStat.h"

#include "maintenance/forms/RTypeCk.h"
#include "tests/maintenance/forms/maintenance_form_fixture.h"

namespace kora::test {
namespace {

class DataStatForm : public MaintenanceFormTest {
 protected:
  void Ask() {
    Open<DataStat>().Begin();
    types = form->findChild<RTypeCk*>();
    ASSERT_NE(types, nullptr);
  }
  // Ticks the kinds of data and waits until they were checked.
  void Check(std::initializer_list<const char*> ticks) {
    Ask();
    for (const char* tick : ticks) Find<QCheckBox>(types, tick)->click();
    Click(types, "Command1");
    ASSERT_TRUE(WaitFor([&] { return Label("Label1") == "RECORDS CHECKED"; }));
  }
  std::vector<std::string> ResultCodes() {
    return CodesOf(ReadList(home.files(), session->settings.paths.CurrentDataPath, kResultList));
  }
  RTypeCk* types = nullptr;
};

TEST_F(DataStatForm, AsksForTheKindsOfDataAndRefusesNone) {
  Ask();
  EXPECT_EQ(form->windowTitle(), "Checking Data Files");
  EXPECT_EQ(types->windowTitle(), "Record Types to Check");
  std::string captions;
  for (const QCheckBox* check : types->findChildren<QCheckBox*>())
    captions += check->text().remove('&').toStdString() + ";";
  EXPECT_EQ(captions, "Record Type 1;Record Type 2;Record Type 4;Record Type 5;");
  Click(types, "Command1");
  ExpectSaid("No Record Types selected", "Record Types");
  EXPECT_TRUE(types->isVisible());
  Click(types, "Command2");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Label("Label1"), "");
}

TEST_F(DataStatForm, GapsAreClosedAndWhatIsAmissListed) {
  PutNames({Named("AAA", "Alpha Mining"), Named("GON", "Gone"), Named("NIL", "Nothing"),
            Named("CLO", "Close Only", kCloseOnly)});
  Prices("AAA", {Day("20260226", 1, 2, 0, 1.5f, 100), Day("20260227", 0, 0, 0, 0, 200)});
  Prices("NIL", {Day("20260227", 0, 0, 0, 0)});
  Prices("CLO", {Day("20260227", 0, 0, 0, 0)});
  Check({"Check3"});
  EXPECT_EQ(Items("List1"),
            (std::vector<std::string>{"GON has no data file", "NIL has no price data values"}));
  EXPECT_EQ(PricesOf("AAA"), Bytes(std::vector{Day("20260226", 1, 2, 1.5f, 1.5f, 100),
                                               Day("20260227", 1.5f, 1.5f, 1.5f, 1.5f, 200)}));
  EXPECT_EQ(PricesOf("CLO"), Bytes(std::vector{Day("20260227", 0, 0, 0, 0)})) << "not chosen";
  EXPECT_EQ(ResultCodes(), (std::vector<std::string>{"GON", "NIL"}));
  EXPECT_TRUE(dialogs.said.empty());
  Press("Command2");
  EXPECT_EQ(printed.layout.heading, "Data Check - Messages");
  EXPECT_EQ(printed.layout.continued, "  (cont)");
  EXPECT_EQ(printed.layout.pageLabel, "      Page  ");
  ASSERT_EQ(printed.rows.size(), 2u);
  EXPECT_EQ(printed.rows[1], (std::vector<std::string>{"NIL has no price data values"}));
  form->reject();
  EXPECT_EQ(changed, 1);
}

TEST_F(DataStatForm, AStoreInOrderListsNothingAndLeavesTheButtonsOff) {
  Check({"Check2", "Check3"});
  EXPECT_TRUE(Items("List1").empty());
  for (const char* name : {"Command2", "Command3", "Command4"})
    EXPECT_FALSE(On<QPushButton>(name)->isEnabled()) << name;
  form->reject();
  EXPECT_EQ(changed, 0);
}

TEST_F(DataStatForm, TheListShowsSixLinesAndScrollsToTheLatest) {
  std::vector<NameRec> names;
  for (int i = 1; i <= 9; ++i) names.push_back(Named("G" + std::to_string(i), "Gone"));
  PutNames(names);
  Check({"Check3"});
  auto* list = List("List1");
  ASSERT_EQ(list->count(), 9);
  const auto seen = [&](int row) {
    return list->viewport()->rect().contains(list->visualItemRect(list->item(row)));
  };
  EXPECT_TRUE(seen(8));
  EXPECT_TRUE(seen(3));
  EXPECT_FALSE(seen(2));
}

TEST_F(DataStatForm, ListedSecuritiesAreRemovedButForThoseClicked) {
  PutNames({Named("AAA", "Alpha Mining"), Named("NIL", "Nothing"), Named("NON", "None"),
            Named("KEP", "Kept")});
  for (const char* code : {"NIL", "NON", "KEP"}) Prices(code, {Day("20260227", 0, 0, 0, 0)});
  home.Put(kData + "NIL.old", "older");
  const std::string empty = PricesOf("NIL");
  Check({"Check3"});
  ASSERT_EQ(Items("List1").size(), 3u);
  ClickItem(List("List1"), 2);
  EXPECT_EQ(Items("List1").size(), 3u) << "a click drops nothing before Edit List";
  Press("Command3");
  ExpectSaid(
      "Click any stocks that you DON'T want deleted.\nThis will remove them from the list.\nThe "
      "remaining stocks can be removed by clicking the REMOVE button",
      "Edit List and Remove");
  ClickItem(List("List1"), 2);
  EXPECT_EQ(Items("List1"), (std::vector<std::string>{"NIL has no price data values",
                                                      "NON has no price data values"}));
  dialogs.answers = {Answer::kNo};
  Press("Command4");
  ExpectSaid(
      "Data files and their Name File entries will be erased for all files in list\nClick YES to "
      "proceed with clearance\nClick NO to exit",
      "Erase Data Files");
  EXPECT_EQ(CodesOfNames(), "AAA NIL NON KEP");
  EXPECT_EQ(Items("List1").size(), 2u);
  Press("Command4");
  EXPECT_EQ(CodesOfNames(), "AAA KEP");
  EXPECT_FALSE(home.Exists(kData + "NIL.WDT"));
  EXPECT_EQ(home.Get(kData + "NIL.old"), empty);
  EXPECT_TRUE(home.Exists(kData + "KEP.WDT"));
  EXPECT_TRUE(Items("List1").empty());
  EXPECT_FALSE(On<QPushButton>("Command4")->isEnabled());
}

TEST_F(DataStatForm, ALineIsDroppedByTheKeyboard) {
  PutNames({Named("NIL", "Nothing"), Named("NON", "None")});
  Check({"Check3"});
  Press("Command3");
  EXPECT_EQ(Focused(), "List1");
  Key(Qt::Key_Down);
  Key(Qt::Key_Delete);
  EXPECT_EQ(Items("List1"), (std::vector<std::string>{"NIL has no data file"}));
}

TEST_F(DataStatForm, TheCheckIsStoppedBetweenTwoFiles) {
  Ask();
  Find<QCheckBox>(types, "Check3")->click();
  auto* stop = On<QPushButton>("StopWork");
  QTimer timer;
  QObject::connect(&timer, &QTimer::timeout, form.get(), [&] {
    if (stop->isVisible()) stop->click();
  });
  timer.start(0);
  Click(types, "Command1");
  ASSERT_TRUE(WaitFor([&] { return Label("Label1").starts_with("STOPPED BEHIND"); }));
}

}  // namespace
}  // namespace kora::test
