#include "lists/forms/IndClass.h"

#include <QAction>
#include <QTableView>

#include "lists/chart_list.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora::test {
namespace {

constexpr const char* kHost = "drive_c/korawin/IndClass.dat";

class IndClassTest : public ListFormTest {
 protected:
  void Open() {
    Stand(std::make_unique<IndClass>(home.files(), dialogs, session->settings.paths.SystemPath,
                                     nullptr, IndClass::Use::kEdit, &session->user));
    grid = On<QTableView>("SS1");
  }
  void Entry(const char* name) { Find<QAction>(form.get(), name)->trigger(); }
  void TypeKeys(const char* text) {
    for (; *text; ++text) QTest::keyClick(QApplication::focusWidget(), *text);
  }

  QTableView* grid = nullptr;
};

TEST_F(IndClassTest, AnAddedClassIsSavedOnClosing) {
  Open();
  Entry("icAddRow");
  TypeKeys("9");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Tab);
  TypeKeys("Tin");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  Entry("icSrtIC");
  Entry("icSave");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kHost), "009,Tin\r\n010,Gold\r\n011,Gold - producers\r\n012,Copper\r\n");
}

TEST_F(IndClassTest, AnUnchangedTableIsNotWritten) {
  Open();
  home.Put(kHost, "another program's");
  QTest::keyClick(form.get(), Qt::Key_Escape);
  EXPECT_EQ(home.Get(kHost), "another program's");
}

TEST_F(IndClassTest, ATableThatAnotherProgramChangedIsSavedOverOnlyWhenTheUserSaysSo) {
  const std::string theirs = "010,Gold\r\n099,Odds\r\n";
  Open();
  Entry("icAddRow");
  TypeKeys("9");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  home.Put(kHost, theirs);
  dialogs.answers = {Answer::kCancel};
  Entry("icSave");
  ExpectSaid(std::string(kListChangedOutside), "Industry Classification");
  EXPECT_TRUE(form->isVisible());
  EXPECT_EQ(home.Get(kHost), theirs);
  dialogs.answers = {Answer::kNo};
  Entry("icSave");
  EXPECT_FALSE(form->isVisible());
  EXPECT_EQ(home.Get(kHost), theirs);

  Open();
  Entry("icAddRow");
  TypeKeys("9");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  home.Put(kHost, "");
  dialogs.answers = {Answer::kYes};
  Entry("icSave");
  EXPECT_EQ(home.Get(kHost), theirs + "009,\r\n");
}

TEST_F(IndClassTest, LettersInAnIdAreRefused) {
  Open();
  grid->setCurrentIndex(grid->model()->index(0, 0));
  grid->setFocus();
  TypeKeys("x");
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_Return);
  ExpectSaid("Id must be numeric", "Industry Classification");
  EXPECT_EQ(grid->model()->index(0, 0).data(), "010");
}

}  // namespace
}  // namespace kora::test
