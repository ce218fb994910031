#include "update/forms/DLList.h"

#include <QLabel>
#include <QListWidget>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>

#include "store/price_rec.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

const std::string kDown = "drive_c/korawin/download/";

class DLListTest : public test::FormTest {
 protected:
  void SetUp() override {
    ReadSettings();
    session->settings.download.InternetDLfmt = "DDMMMYY.D";
  }
  void Download(const std::string& name, const std::string& text) { home.Put(kDown + name, text); }
  // A line for each of the three securities.
  static std::string DayText(const std::string& date) {
    std::string text;
    for (const char* code : {"AAA", "BBB", "CCC"})
      text += std::string(code) + "," + date + ",20,21,19,20.5,777,0\r\n";
    return text;
  }
  bool Open() {
    form = std::make_unique<DLList>(DLListServices{.files = session->files,
                                                   .settings = session->settings,
                                                   .current = session->current,
                                                   .dialogs = dialogs,
                                                   .clock = session->clock,
                                                   .disableMenus = [this] { menus = false; },
                                                   .enableMenus = [this] { menus = true; }},
                                    nullptr);
    if (!form->Fill()) return false;
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return true;
  }
  QStringList Listed() {
    QStringList out;
    auto* list = Find<QListWidget>(form.get(), "List1");
    for (int i = 0; i < list->count(); ++i) out << list->item(i)->text();
    return out;
  }
  QString LabelText(const char* name) { return Find<QLabel>(form.get(), name)->text(); }
  std::int32_t Count(const std::string& code) {
    return PriceFile(session->files, "c:\\korawin\\data\\" + code + ".WDT").count();
  }

  std::unique_ptr<DLList> form;
  bool menus = true;
};

TEST_F(DLListTest, ShowsWhatWaits) {
  Download("03MAR26.d", DayText("20260303"));
  Download("02MAR26.d", DayText("20260302"));
  ASSERT_TRUE(Open());
  EXPECT_FALSE(menus);
  EXPECT_EQ(form->windowTitle(), "Update with Downloaded Data ");
  EXPECT_EQ(Listed(), (QStringList{"02MAR26.d", "03MAR26.d"}));
  EXPECT_EQ(LabelText("Label3"), "02MAR26.d");
  EXPECT_EQ(LabelText("Label4"), "c:\\korawin\\download\\");
  EXPECT_EQ(LabelText("Label5"), "c:\\korawin\\data\\");
  EXPECT_FALSE(Find<QProgressBar>(form.get(), "ProgressBar1")->isVisible());
  EXPECT_EQ(Find<QPushButton>(form.get(), "Command4")->toolTip(),
            "Deletes an unwanted date from list");
}

TEST_F(DLListTest, TheCaptionTellsASelectedUpdate) {
  Download("02MAR26.d", DayText("20260302"));
  session->settings.download.UpdateAll = false;
  ASSERT_TRUE(Open());
  EXPECT_EQ(form->windowTitle(), "Update AS SELECTED with Downloaded Data");
}

TEST_F(DLListTest, StaysAwayWhenNothingWaits) {
  session->files.MakeFolder("c:\\korawin\\download");
  EXPECT_FALSE(Open());
  EXPECT_EQ(dialogs.said.back().text, " There are no downloaded files to update. ");
  EXPECT_TRUE(menus);
}

TEST_F(DLListTest, UpdatesOneDayByTheEnterKeyAndStaysWithTheRest) {
  Download("02MAR26.d", DayText("20260302"));
  Download("03MAR26.d", DayText("20260303"));
  ASSERT_TRUE(Open());
  Find<QListWidget>(form.get(), "List1")->setFocus();
  QTest::keyClick(form.get(), Qt::Key_Return);
  EXPECT_EQ(Count("BBB"), 29);
  EXPECT_EQ(Listed(), QStringList{"03MAR26.d"});
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(LabelText("Label2"), "FINISHED");
  EXPECT_EQ(LabelText("Label8(0)"), "");
  EXPECT_TRUE(Find<QPushButton>(form.get(), "Command1")->isEnabled());
  EXPECT_FALSE(Find<QProgressBar>(form.get(), "ProgressBar1")->isVisible());
  EXPECT_FALSE(dialogs.busy);
  EXPECT_FALSE(menus);
}

TEST_F(DLListTest, ClosesBehindTheLastDay) {
  Download("02MAR26.d", DayText("20260302"));
  ASSERT_TRUE(Open());
  Click(form.get(), "Command1");
  EXPECT_EQ(Count("AAA"), 29);
  EXPECT_FALSE(form->isVisible());
  EXPECT_TRUE(menus);
}

TEST_F(DLListTest, UpdatesAllAndCloses) {
  Download("02MAR26.d", DayText("20260302"));
  Download("03MAR26.d", DayText("20260303"));
  ASSERT_TRUE(Open());
  Click(form.get(), "Command3");
  EXPECT_EQ(Count("CCC"), 30);
  EXPECT_FALSE(form->isVisible());
  EXPECT_TRUE(menus);
}

TEST_F(DLListTest, ACancelledDateStaysListed) {
  Download("27FEB26.d", DayText("20260227"));
  Download("02MAR26.d", DayText("20260302"));
  dialogs.answers = {Answer::kCancel};
  ASSERT_TRUE(Open());
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.back().title, "c:\\korawin\\data\\");
  EXPECT_EQ(Listed(), (QStringList{"27FEB26.d", "02MAR26.d"}));
  EXPECT_EQ(Count("AAA"), 28);
}

TEST_F(DLListTest, RemovesTheFirstDateWhicheverWasSelected) {
  Download("02MAR26.d", DayText("20260302"));
  Download("03MAR26.d", DayText("20260303"));
  ASSERT_TRUE(Open());
  Find<QListWidget>(form.get(), "List1")->setCurrentRow(1);
  Click(form.get(), "Command4");
  EXPECT_EQ(dialogs.said.back().text, "Remove 03MAR26.d");
  EXPECT_FALSE(home.Exists(kDown + "03MAR26.d"));
  EXPECT_EQ(Listed(), QStringList{"03MAR26.d"});
}

TEST_F(DLListTest, EscapeClosesAndBringsTheMenusBack) {
  Download("02MAR26.d", DayText("20260302"));
  ASSERT_TRUE(Open());
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_FALSE(form->isVisible());
  EXPECT_TRUE(menus);
}

// The form lives while the update runs, but it can't be used, and closing it asks.
TEST_F(DLListTest, ClosingInTheMiddleAsks) {
  std::string text;
  for (int i = 0; i < 20000; ++i) text += "AAA,20260302,20,21,19,20.5,777,0\r\n";
  Download("02MAR26.d", text);
  ASSERT_TRUE(Open());
  dialogs.answers = {Answer::kYes};
  bool usable = true, visible = false;
  QTimer::singleShot(0, form.get(), [&] {
    usable = Find<QPushButton>(form.get(), "Command1")->isEnabled() ||
             Find<QPushButton>(form.get(), "Command2")->isEnabled();
    visible = Find<QProgressBar>(form.get(), "ProgressBar1")->isVisible();
    form->close();
  });
  // By its signal: a simulated click would handle the timer before it.
  Find<QPushButton>(form.get(), "Command1")->click();
  EXPECT_FALSE(usable);
  EXPECT_TRUE(visible);
  EXPECT_EQ(dialogs.said.back().text, "The update is not finished. Stop it ?");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Listed(), QStringList{"02MAR26.d"});
  EXPECT_LT(Count("AAA"), 20028);
  EXPECT_TRUE(Find<QPushButton>(form.get(), "Command1")->isEnabled());
}

TEST_F(DLListTest, ARunThatFailsLeavesTheRestListed) {
  Download("02MAR26.d", DayText("20260302"));
  Download("03MAR26.d", DayText("20260303") + "DDD,20260303,1,1,1,1,1,0\r\n");
  session->files.MakeFolder("c:\\korawin\\data\\DDD.WDT");  // where a file is wanted
  ASSERT_TRUE(Open());
  Click(form.get(), "Command3");
  EXPECT_EQ(dialogs.said.back().title, "Error");
  EXPECT_EQ(dialogs.said.back().text,
            "There is a file access problem. Check directory paths option.\n"
            "c:\\korawin\\data\\DDD.WDT: Is a directory");
  EXPECT_EQ(Count("CCC"), 29);  // the first day alone
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Listed(), QStringList{"03MAR26.d"});
  EXPECT_EQ(LabelText("Label2"), "");
  EXPECT_EQ(LabelText("Label8(0)"), "");
  EXPECT_TRUE(Find<QPushButton>(form.get(), "Command3")->isEnabled());
  EXPECT_FALSE(Find<QProgressBar>(form.get(), "ProgressBar1")->isVisible());
  EXPECT_FALSE(dialogs.busy);
}

TEST_F(DLListTest, AFileThatIsGoneLeavesTheForm) {
  Download("02MAR26.d", DayText("20260302"));
  ASSERT_TRUE(Open());
  session->files.Remove("c:\\korawin\\download\\02MAR26.d");
  Click(form.get(), "Command1");
  EXPECT_EQ(dialogs.said.back().text, "File does not exist\nc:\\korawin\\download\\02MAR26.d");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(Listed(), QStringList{"02MAR26.d"});
  EXPECT_NE(LabelText("Label2"), "FINISHED");
}

}  // namespace
}  // namespace kora
