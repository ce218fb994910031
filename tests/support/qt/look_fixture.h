#pragma once

#include <gtest/gtest.h>

#include <QAbstractButton>
#include <QApplication>
#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QTest>
#include <memory>
#include <string>
#include <vector>

#include "looks/colours.h"
#include "looks/forms/look_services.h"
#include "settings/settings.h"
#include "store/name_file.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// An installation with three securities, the second of them current, and one form on it.
class LookFormTest : public testing::Test {
 protected:
  LookFormTest() {
    WriteDefaultSettings(ini);
    EXPECT_TRUE(ReadSettings(ini, home.files(), dialogs, settings));
    NameRec current_ = Security("BBB");
    current_.Name.set("Broken Hill");
    current_.Base = 2.5f;
    current_.MinMove = 1;
    current_.BandUp = 7;
    current_.BandDown = 8;
    current_.BollPeriods = 21;
    current_.BollWidth = 2;
    home.Put("drive_c/korawin/data/Names.dat",
             Bytes(std::vector<NameRec>{Security("AAA"), current_, Security("CCC")}));
    current.Rec = current_;
    current.NameRecNo = 2;
    current.NameCount = 3;
    LoadColours(home.files(), settings.paths.SystemPath, "Black", colours);
  }

  LookServices Look() {
    return {.ini = ini, .settings = settings, .dialogs = dialogs, .saved = [this] { ++saved; }};
  }

  template <typename Form, typename... Args>
  Form& Open(Args&&... args) {
    auto made = std::make_unique<Form>(std::forward<Args>(args)..., nullptr);
    Form& opened = *made;
    form = std::move(made);
    Show();
    return opened;
  }
  void Show() {
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.get()));
  }

  template <typename Widget>
  Widget* Find(const char* name) {
    auto* found = form->findChild<Widget*>(name);
    EXPECT_NE(found, nullptr) << name;
    return found;
  }
  QLineEdit* Text(const char* name) { return Find<QLineEdit>(name); }
  QString Caption(const char* name) { return Find<QAbstractButton>(name)->text(); }
  // By the mouse; at the left, where the mark of an option or a box is.
  void Click(const char* name) {
    auto* button = Find<QWidget>(name);
    QTest::mouseClick(button, Qt::LeftButton, {}, QPoint(8, button->height() / 2));
  }
  void Press(Qt::Key key) { QTest::keyClick(QApplication::focusWidget(), key); }
  QString Focused() { return form->focusWidget() ? form->focusWidget()->objectName() : QString(); }
  // Types over what stands in the box.
  void Type(const char* name, const char* text) {
    QLineEdit* field = Text(name);
    field->setFocus();
    field->selectAll();
    QTest::keyClick(field, Qt::Key_Delete);
    QTest::keyClicks(field, text);
  }
  // The one message or question, taken away; empty when there was not just one.
  ScriptedDialogs::Said Told() {
    EXPECT_EQ(dialogs.said.size(), 1u);
    if (dialogs.said.size() != 1) return {};
    const auto said = dialogs.said[0];
    dialogs.said.clear();
    return said;
  }

  std::string Chart(const char* key) { return ini.GetSetting("Charts", key); }
  std::string Osc(const char* key) { return ini.GetSetting("OscDef", key); }
  NameRec OnDisk(int number) {
    const NameFile names(home.files(), NameFilePath(settings.paths.CurrentDataPath));
    return names.Read(number);
  }

  TempHome home;
  ScriptedDialogs dialogs;
  SettingsFile ini{home.files(), "C:\\WINDOWS\\Kora.ini"};
  Settings settings;
  ChartColours colours{};
  CurrentName current;
  std::unique_ptr<QDialog> form;
  int saved = 0;
};

}  // namespace kora::test
