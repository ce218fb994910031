#pragma once

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <memory>

#include "lists/chart_list.h"
#include "tests/support/qt/form_fixture.h"

namespace kora::test {

// An installation with six securities of all kinds, and the steps of a user on one form.
class ListFormTest : public FormTest {
 protected:
  ListFormTest() {
    PutNames({Named("AAA", "Alpha Mining", kShare, "011"), Named("BBB", "Beta Bank", kShare, "021"),
              Named("BHP", "Broken Hill", kShare, "012"), Named("XAO", "All Ords", kIndex),
              Named("ADV", "Advances", kAdvanceDecline),
              Named("ZZZ", "Last Bank", kCloseOnly, "012")});
    home.Put("drive_c/korawin/IndClass.dat", "010,Gold\r\n011,Gold - producers\r\n012,Copper\r\n");
  }
  void SetUp() override { ReadSettings(); }

  static NameRec Named(std::string_view code, std::string_view name, std::int16_t recType = kShare,
                       std::string_view indClass = "") {
    NameRec rec = Security(code, 1, recType, indClass);
    rec.Name.set(name);
    return rec;
  }
  void PutNames(const std::vector<NameRec>& names) {
    home.Put("drive_c/korawin/data/Names.dat", Bytes(names));
  }
  static ListRec Entry(std::int16_t record, std::string_view code) {
    ListRec rec;
    rec.ListRecNo = record;
    rec.ListCode.set(code);
    return rec;
  }
  void PutList(char letter, const std::vector<ListRec>& records) {
    home.Put(std::string("drive_c/korawin/data/SubList") + letter + ".Dat", Bytes(records));
  }
  std::string ListBytes(char letter) {
    return home.Get(std::string("drive_c/korawin/data/SubList") + letter + ".Dat");
  }

  template <typename Form>
  Form& Stand(std::unique_ptr<Form> made) {
    Form& standing = *made;
    form = std::move(made);
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
    return standing;
  }

  template <typename Widget>
  Widget* On(const char* name) {
    return Find<Widget>(form.get(), name);
  }
  QLineEdit* Text(const char* name) { return On<QLineEdit>(name); }
  std::string TextOf(const char* name) { return Text(name)->text().toStdString(); }
  QComboBox* Combo(const char* name) { return On<QComboBox>(name); }
  QListWidget* List(const char* name) { return On<QListWidget>(name); }
  void Press(const char* name) { Click(form.get(), name); }
  void Type(const char* name, const char* text) {
    Text(name)->setFocus();
    Text(name)->selectAll();
    QTest::keyClick(Text(name), Qt::Key_Delete);
    QTest::keyClicks(Text(name), text);
  }
  void Enter(const char* name, const char* text) {
    Type(name, text);
    QTest::keyClick(Text(name), Qt::Key_Return);
  }
  // By keyboard, as a user does: down or up to the entry.
  void Choose(const char* name, int index) {
    QComboBox* combo = Combo(name);
    combo->setFocus();
    while (combo->currentIndex() < index) QTest::keyClick(combo, Qt::Key_Down);
    while (combo->currentIndex() > index) QTest::keyClick(combo, Qt::Key_Up);
  }
  static void ClickItem(QListWidget* list, int row, Qt::KeyboardModifiers keys = Qt::NoModifier) {
    list->scrollToItem(list->item(row));
    QTest::mouseClick(list->viewport(), Qt::LeftButton, keys,
                      list->visualItemRect(list->item(row)).center());
  }
  static void DoubleClickItem(QListWidget* list, int row) {
    ClickItem(list, row);
    QTest::mouseDClick(list->viewport(), Qt::LeftButton, Qt::NoModifier,
                       list->visualItemRect(list->item(row)).center());
  }
  std::vector<std::string> Items(const char* name) {
    std::vector<std::string> out;
    for (int i = 0; i < List(name)->count(); ++i)
      out.push_back(List(name)->item(i)->text().toStdString());
    return out;
  }
  void ExpectSaid(const std::string& text, const std::string& title) {
    ASSERT_FALSE(dialogs.said.empty());
    EXPECT_EQ(dialogs.said.back().text, text);
    EXPECT_EQ(dialogs.said.back().title, title);
    EXPECT_EQ(dialogs.said.size(), 1u);
    dialogs.said.clear();
  }
  // A form that the one under test opened over itself.
  template <typename Form>
  Form* Opened() {
    Form* found = nullptr;
    EXPECT_TRUE(WaitFor([&] {
      for (QObject* child : form->children())
        if (auto* one = dynamic_cast<Form*>(child); one && one->isVisible()) found = one;
      return found != nullptr;
    }));
    return found;
  }

  std::unique_ptr<QDialog> form;
};

}  // namespace kora::test
