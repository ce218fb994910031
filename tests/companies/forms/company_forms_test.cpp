#include <QAction>
#include <QComboBox>
#include <QLabel>
#include <QTabWidget>
#include <QTableView>

#include "companies/forms/ChtSnap.h"
#include "companies/forms/Fundmnt.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora::test {
namespace {

struct MarchClock : Clock {
  CalendarDate Today() const override { return {2026, 3, 4}; }
};

struct FakeComms : Processes {
  std::function<int()> run;
  int RunAndWait(const std::string&, const std::vector<std::string>&,
                 const std::function<void()>& idle) override {
    if (idle) idle();
    return run();
  }
};

class CompanyFormsTest : public ListFormTest {
 protected:
  CompanyFormsTest() {
    home.Put("drive_c/dl/STKHeader.txt",
             "4\r\nASXCODE\r\nDescription\r\nCurrent Div\r\nDiv. Type\r\n");
    home.Put("drive_c/dl/SecurityDetails.Stx",
             PadRight("BHP", 6) + PadRight("Big miner|0.5|FINAL", 306) + PadRight("AAA", 6) +
                 PadRight("Small miner|1|INTERIM", 306));
    home.Put("drive_c/dl/Sdix1.inx", "BHP,1\r\nAAA,2\r\n");
    home.Put("drive_c/korawin/data/BHP.WDT", Bytes<PriceRec>({Day("20260106", 10, 10, 10, 10)}));
    home.Put("drive_c/korawin/data/AAA.WDT", Bytes<PriceRec>({Day("20260106", 8, 8, 8, 8)}));
  }
  void SetUp() override {
    ListFormTest::SetUp();
    session->settings.download.ServiceSystem = "c:\\dl\\";
  }
  CompanyFormServices Services() {
    return {.files = home.files(),
            .settings = session->settings,
            .dialogs = dialogs,
            .user = session->user,
            .print = [this](const TextTable& table, QWidget*) { printed = table; },
            .namesChanged = [this] { ++changed; }};
  }
  void Entry(const char* name) { Find<QAction>(form.get(), name)->trigger(); }
  std::string Cell(QTableView* grid, int row, int column) {
    return grid->model()->index(row, column).data().toString().toStdString();
  }
  std::string OtherDetails(int record) {
    const auto names = ReadNames(home.files(), session->settings.paths.CurrentDataPath);
    return std::string(names[size_t(record - 1)].OtherDetails.trimmed());
  }

  std::optional<TextTable> printed;
  int changed = 0;
};

TEST_F(CompanyFormsTest, DetailsOfACodeAreShownAndOfferedToTheNameFile) {
  StockInf& stock = Stand(std::make_unique<StockInf>(Services(), nullptr));
  ASSERT_TRUE(stock.Fill());
  stock.Show("bhp ");
  EXPECT_EQ(stock.windowTitle(), "BHP");
  auto* grid = On<QTableView>("ListView1");
  ASSERT_EQ(grid->model()->rowCount(), 3);
  EXPECT_EQ(Cell(grid, 0, 0) + "=" + Cell(grid, 0, 1), "Description=Big miner");
  QTest::mouseClick(grid->viewport(), Qt::LeftButton, {},
                    grid->visualRect(grid->model()->index(0, 1)).center());
  ExpectSaid("Transfer data in Description column to the Other Details column of the Name File",
             "Transfer to Name File");
  EXPECT_EQ(OtherDetails(3), "Big miner");
  EXPECT_EQ(changed, 1);
  Type("Text1", "aaa");
  QTest::keyClick(Text("Text1"), Qt::Key_Return);
  EXPECT_EQ(Cell(grid, 0, 1), "Small miner");
  Type("Text1", "XYZ");
  QTest::keyClick(Text("Text1"), Qt::Key_Return);
  EXPECT_EQ(Cell(grid, 0, 0), "No details for XYZ");
}

TEST_F(CompanyFormsTest, DetailsFollowTheChartWhenTheirFormIsActivated) {
  std::string onChart = "BHP";
  CompanyFormServices services = Services();
  services.currentCode = [&] { return onChart; };
  StockInf& stock = Stand(std::make_unique<StockInf>(services, nullptr));
  ASSERT_TRUE(stock.Fill());
  stock.Show(onChart);
  const auto activate = [&] {
    QEvent event(QEvent::WindowActivate);
    QApplication::sendEvent(&stock, &event);
  };
  Type("Text1", "XYZ");
  QTest::keyClick(Text("Text1"), Qt::Key_Return);
  activate();
  EXPECT_EQ(stock.windowTitle(), "XYZ") << "the chart is the same";
  onChart = "AAA";
  activate();
  EXPECT_EQ(stock.windowTitle(), "AAA");
  EXPECT_EQ(Cell(On<QTableView>("ListView1"), 0, 1), "Small miner");
}

TEST_F(CompanyFormsTest, ADeniedTransferLeavesTheNameFile) {
  StockInf& stock = Stand(std::make_unique<StockInf>(Services(), nullptr));
  ASSERT_TRUE(stock.Fill());
  stock.Show("BHP");
  dialogs.answers = {Answer::kNo};
  auto* grid = On<QTableView>("ListView1");
  QTest::mouseClick(grid->viewport(), Qt::LeftButton, {},
                    grid->visualRect(grid->model()->index(0, 1)).center());
  EXPECT_EQ(OtherDetails(3), "");
  EXPECT_EQ(changed, 0);
}

TEST_F(CompanyFormsTest, CompaniesShowYieldsClassesAndColumns) {
  Fundmnt& companies = Stand(std::make_unique<Fundmnt>(Services(), nullptr));
  ASSERT_TRUE(companies.Fill());
  auto* grid = On<QTableView>("SS1");
  ASSERT_EQ(grid->model()->rowCount(), 2);
  EXPECT_EQ(Cell(grid, 0, 0) + Cell(grid, 0, 2), "BHP012");
  EXPECT_EQ(Cell(grid, 0, 5), "");
  Entry("mnYCP");
  EXPECT_EQ(Cell(grid, 0, 4), "10.00");
  EXPECT_EQ(Cell(grid, 0, 5), "5.00 %");
  EXPECT_EQ(Cell(grid, 1, 5), "12.50 %");
  Type("Text1", "011");
  ASSERT_EQ(grid->model()->rowCount(), 1);
  EXPECT_EQ(Cell(grid, 0, 0), "AAA");
  Entry("mnScanList");
  EXPECT_EQ(ReadList(home.files(), session->settings.paths.CurrentDataPath, kResultList).size(),
            1u);
  grid->setCurrentIndex(grid->model()->index(0, 6));
  Entry("mnHdCol");
  EXPECT_TRUE(grid->isColumnHidden(6));
  Entry("mnSeeAll");
  EXPECT_FALSE(grid->isColumnHidden(6));
  EXPECT_EQ(grid->model()->rowCount(), 2);
}

TEST_F(CompanyFormsTest, AColumnIsCopiedToTheNamesThatAreShown) {
  Fundmnt& companies = Stand(std::make_unique<Fundmnt>(Services(), nullptr));
  ASSERT_TRUE(companies.Fill());
  auto* grid = On<QTableView>("SS1");
  Type("Text1", "012");
  grid->setCurrentIndex(grid->model()->index(0, 6));
  Entry("mnUpName");
  EXPECT_EQ(OtherDetails(3), "Big miner");
  EXPECT_EQ(OtherDetails(1), "");
  EXPECT_EQ(changed, 1);
}

TEST_F(CompanyFormsTest, WithoutDataTheFormStaysAway) {
  home.files().Remove("c:\\dl\\Sdix1.inx");
  Fundmnt companies(Services(), nullptr);
  EXPECT_FALSE(companies.Fill());
  ExpectSaid("There is no fundamental data", "ASX Details");
}

class ChtSnapTest : public CompanyFormsTest {
 protected:
  void Open() {
    home.Put("drive_c/korawin/Snapshot.Dat", "BHP,S,100,8,0.5\r\nXAO,I,,,\r\n");
    home.Put("drive_c/korawin/Quickcomm.exe", "");
    Stand(std::make_unique<ChtSnap>(
        ChtSnapServices{.snapshot = {home.files(), session->settings.paths,
                                     session->settings.download, dialogs, comms, clock},
                        .settings = session->settings,
                        .user = session->user,
                        .print = [this](const TextTable& table, QWidget*) { printed = table; }},
        nullptr));
    prices = On<QTableView>("SS1");
    holdings = On<QTableView>("SS2");
  }
  void TypeKeys(const char* text) {
    for (; *text; ++text) QTest::keyClick(QApplication::focusWidget(), *text);
  }

  FakeComms comms;
  MarchClock clock;
  QTableView *prices = nullptr, *holdings = nullptr;
};

TEST_F(ChtSnapTest, FetchedPricesFillBothSheets) {
  Open();
  EXPECT_EQ(Cell(prices, 0, 0) + Cell(prices, 1, 8), "BHPI");
  comms.run = [this] {
    home.Put("drive_c/dl/Snap.Lst", "BHP,9.5,9.4,9.6,9,5000,12,0.3\r\n");
    return 0;
  };
  Entry("csFetchSnap");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_EQ(Cell(prices, 0, 1), "9.5");
  EXPECT_EQ(Cell(holdings, 0, 3) + " " + Cell(holdings, 0, 4) + " " + Cell(holdings, 0, 5),
            "9.50 900.00 950.00");
  EXPECT_EQ(On<QLabel>("Label1")->text(), "Times accessed today = 1");
  Entry("csPnt");
  ASSERT_TRUE(printed);
  EXPECT_EQ(printed->layout.heading, "Current Equity Snapshot   4-Mar-26");
}

TEST_F(ChtSnapTest, RowsAreAddedSavedAndHeldToFifteen) {
  Open();
  Entry("csAdd");
  TypeKeys("cba");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  Entry("smSave");
  EXPECT_EQ(home.Get("drive_c/korawin/Snapshot.Dat"),
            "BHP,S,100,8,0.5\r\nXAO,I,,,\r\nCBA,S,,,\r\n");
  for (int i = 0; i < 12; ++i) Entry("csAdd");
  EXPECT_TRUE(dialogs.said.empty());
  Entry("csAdd");
  ExpectSaid("Maximum number of stocks for snapshot is 15", "Current Snapshot");
}

TEST_F(ChtSnapTest, UnitsMustBeNumeric) {
  Open();
  On<QTabWidget>("Sheets")->setCurrentIndex(1);
  holdings->setCurrentIndex(holdings->model()->index(0, 1));
  holdings->setFocus();
  TypeKeys("many");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  ExpectSaid("Must be numeric", "Current Snapshot");
  EXPECT_EQ(Cell(holdings, 0, 1), "100");
}

TEST_F(ChtSnapTest, ARowMovesToAnotherList) {
  Open();
  prices->selectionModel()->setCurrentIndex(prices->model()->index(1, 0),
                                            QItemSelectionModel::ClearAndSelect);
  Entry("csMove(3)");
  EXPECT_EQ(dialogs.said.back().text, "Move XAO to LIST 3 ?");
  EXPECT_EQ(home.Get("drive_c/korawin/Snap3.Dat"), "XAO,I,,,\r\n");
  EXPECT_EQ(home.Get("drive_c/korawin/Snapshot.Dat"), "BHP,S,100,8,0.5\r\n");
  On<QComboBox>("Combo1")->setCurrentIndex(2);
}

TEST_F(ChtSnapTest, AListThatAnotherProgramChangedIsSavedOverOnlyWhenTheUserSaysSo) {
  const std::string list = "drive_c/korawin/Snapshot.Dat";
  Open();
  Entry("csAdd");
  TypeKeys("cba");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  home.Put(list, "NAB,S,,,\r\n");
  dialogs.answers = {Answer::kNo, Answer::kYes};
  Entry("smSave");
  ExpectSaid("The list was changed by another program. Save over these changes ?",
             "Current Snapshot");
  EXPECT_EQ(home.Get(list), "NAB,S,,,\r\n");
  Entry("smSave");
  EXPECT_EQ(home.Get(list), "BHP,S,100,8,0.5\r\nXAO,I,,,\r\nCBA,S,,,\r\n");
  const size_t asked = dialogs.said.size();
  Entry("smSave");
  EXPECT_EQ(dialogs.said.size(), asked) << "its own save is no change of another program";
}

TEST_F(ChtSnapTest, AChangedListAsksBeforeItIsLeft) {
  Open();
  Entry("csAdd");
  dialogs.answers = {Answer::kCancel};
  Entry("csExit");
  EXPECT_TRUE(form->isVisible());
  ExpectSaid("Save changes ?", "Current Snapshot");
  dialogs.answers = {Answer::kNo};
  Entry("csExit");
  EXPECT_FALSE(form->isVisible());
}

}  // namespace
}  // namespace kora::test
