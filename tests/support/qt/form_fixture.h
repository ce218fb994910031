#pragma once

#include <gtest/gtest.h>

#include <QAction>
#include <QApplication>
#include <QTest>
#include <memory>

#include "indicators/osc_settings.h"
#include "shell/session.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// An installation with three securities, and a session on it.
class FormTest : public testing::Test {
 protected:
  FormTest() {
    session = std::make_unique<Session>(home.path(), dialogs);
    WriteDefaultSettings(session->ini);
    WriteDefaultOscPeriods(session->ini);
    home.Put("drive_c/korawin/koraprn.dat", std::string("\0\0\1\0", 4));
    home.Put("drive_c/korawin/data/Names.dat",
             Bytes(std::vector<NameRec>{Security("AAA"), Security("BBB"), Security("CCC")}));
    for (const char* code : {"AAA", "BBB", "CCC"}) {
      std::vector<PriceRec> days;
      for (int i = 1; i <= 28; ++i) {
        const float close = 10.0f + float((i * code[0]) % 7);
        days.push_back(Day("202602" + std::string(i < 10 ? "0" : "") + std::to_string(i), close,
                           close + 1, close - 1, close, 1000 * i));
      }
      home.Put("drive_c/korawin/data/" + std::string(code) + ".WDT", Bytes(days));
    }
  }

  void ReadSettings() { ASSERT_TRUE(ReadAllSettings(*session, "", false)); }

  // Handles what waits until `done`, for at most some seconds.
  template <typename Done>
  static bool WaitFor(Done done) {
    return QTest::qWaitFor(done, 5000);
  }

  template <typename Widget>
  static Widget* Find(QObject* form, const char* name) {
    auto* found = form->findChild<Widget*>(name);
    EXPECT_NE(found, nullptr) << name;
    return found;
  }
  // The widget of a kind that stands as a window of its own.
  template <typename Form>
  static Form* TopLevel() {
    for (QWidget* w : QApplication::topLevelWidgets())
      if (auto* form = dynamic_cast<Form*>(w); form && form->isVisible()) return form;
    return nullptr;
  }
  static void Click(QObject* form, const char* name) {
    if (auto* button = Find<QWidget>(form, name)) QTest::mouseClick(button, Qt::LeftButton);
  }

  TempHome home;
  ScriptedDialogs dialogs;
  std::unique_ptr<Session> session;
};

}  // namespace kora::test
