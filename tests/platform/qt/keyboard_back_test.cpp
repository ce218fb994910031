#include "platform/qt/keyboard_back.h"

#include <gtest/gtest.h>

#include <QApplication>
#include <QDialog>
#include <QEvent>
#include <QTest>

namespace kora {
namespace {

// Loses the keyboard whenever a dialog closes, as some window managers do.
class Forgetful : public QObject {
 public:
  Forgetful() { qApp->installEventFilter(this); }
  bool eventFilter(QObject* object, QEvent* event) override {
    if (event->type() == QEvent::Hide && qobject_cast<QDialog*>(object))
      QApplication::setActiveWindow(nullptr);
    return false;
  }
};

struct KeyboardBackTest : testing::Test {
  KeyboardBackTest() {
    below.show();
    below.activateWindow();
    form->open();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form));
  }
  QWidget below;
  QDialog* form = new QDialog(&below);
  KeyboardBack back;
  // The last filter made is the first that is asked.
  Forgetful forgetful;
};

TEST_F(KeyboardBackTest, GoesToTheWindowBelowAFormThatCloses) {
  form->close();
  EXPECT_TRUE(QTest::qWaitForWindowActive(&below));
}

}  // namespace
}  // namespace kora
