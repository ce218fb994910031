#include <gtest/gtest.h>

#include <QApplication>
#include <QInputDialog>
#include <QMenu>
#include <QMessageBox>
#include <QPointer>
#include <QProgressDialog>
#include <QPushButton>
#include <QTest>
#include <QTimer>
#include <functional>

#include "platform/qt/qt_dialogs.h"

namespace kora {
namespace {

// Runs `act` on the next dialog that opens.
template <class Box>
void OnNext(std::function<void(Box&)> act) {
  QTimer::singleShot(0, [act] {
    auto* box = qobject_cast<Box*>(QApplication::activeModalWidget());
    if (box)
      act(*box);
    else
      OnNext<Box>(act);
  });
}

TEST(QtDialogs, AMessageHasItsTextTitleAndOneButton) {
  QtDialogs dialogs;
  bool seen = false;
  OnNext<QMessageBox>([&](QMessageBox& box) {
    seen = true;
    EXPECT_EQ(box.text(), "No <b>File</b>");
    EXPECT_EQ(box.textFormat(), Qt::PlainText);
    EXPECT_EQ(box.windowTitle(), "Charts");
    EXPECT_EQ(box.buttons().size(), 1);
    QTest::keyClick(&box, Qt::Key_Return);
  });
  dialogs.Message("No <b>File</b>", "Charts");
  EXPECT_TRUE(seen);
}

TEST(QtDialogs, ABoxIsAsWideAsItsTitleAndIsNeitherMinimisedNorMaximised) {
  QtDialogs dialogs;
  const std::string title = "A title that is a good deal longer than the text below it";
  OnNext<QMessageBox>([&](QMessageBox& box) {
    QFont bold = box.font();
    bold.setBold(true);
    EXPECT_GE(box.width(), QFontMetrics(bold).horizontalAdvance(title.c_str()));
    EXPECT_FALSE(box.windowFlags() & Qt::WindowMinMaxButtonsHint);
    EXPECT_TRUE(box.windowFlags() & Qt::WindowCloseButtonHint);
    QTest::keyClick(&box, Qt::Key_Return);
  });
  dialogs.Message("No", title);
}

TEST(QtDialogs, AMessageOfAFormThatHasJustOpenedStandsOverIt) {
  QWidget window;
  window.show();
  ASSERT_TRUE(QTest::qWaitForWindowExposed(&window));
  QDialog form(&window);
  form.open();
  QtDialogs dialogs;
  const QWidget* over = nullptr;
  OnNext<QMessageBox>([&](QMessageBox& box) {
    over = box.parentWidget();
    QTest::keyClick(&box, Qt::Key_Return);
  });
  dialogs.Message("There is none", "Charts");
  EXPECT_EQ(over, &form);
}

TEST(QtDialogs, QuestionsAnswerAsTheirButtons) {
  QtDialogs dialogs;
  const auto press = [](QMessageBox::StandardButton which) {
    OnNext<QMessageBox>([which](QMessageBox& box) {
      ASSERT_NE(box.button(which), nullptr);
      QTest::mouseClick(box.button(which), Qt::LeftButton);
    });
  };
  press(QMessageBox::Yes);
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kYesNoCancel), Answer::kYes);
  press(QMessageBox::No);
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kYesNo), Answer::kNo);
  press(QMessageBox::Cancel);
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kOkCancel), Answer::kCancel);
  press(QMessageBox::Retry);
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kRetryCancel), Answer::kRetry);
}

TEST(QtDialogs, EscapeIsNoOrCancel) {
  QtDialogs dialogs;
  const auto escape = [] {
    OnNext<QMessageBox>([](QMessageBox& box) { QTest::keyClick(&box, Qt::Key_Escape); });
  };
  escape();
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kYesNo), Answer::kNo);
  escape();
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kYesNoCancel), Answer::kCancel);
  escape();
  EXPECT_EQ(dialogs.Ask("?", "t", Buttons::kOkCancel), Answer::kCancel);
}

TEST(QtDialogs, APromptGivesWhatWasTyped) {
  QtDialogs dialogs;
  OnNext<QInputDialog>([](QInputDialog& box) {
    EXPECT_EQ(box.textValue(), "C:");
    box.setTextValue("D:");
    QTest::keyClick(&box, Qt::Key_Return);
  });
  EXPECT_EQ(dialogs.Prompt("Drive?", "Drive", "C:"), "D:");
  OnNext<QInputDialog>([](QInputDialog& box) { QTest::keyClick(&box, Qt::Key_Escape); });
  EXPECT_EQ(dialogs.Prompt("Drive?", "Drive", "C:"), std::nullopt);
  OnNext<QInputDialog>([](QInputDialog& box) {
    box.setTextValue("");
    QTest::keyClick(&box, Qt::Key_Return);
  });
  EXPECT_EQ(dialogs.Prompt("Drive?", "Drive", "C:"), std::nullopt);
}

TEST(QtDialogs, TheBusyPointerIsGivenBackOnce) {
  {
    QtDialogs dialogs;
    dialogs.SetBusy(true);
    dialogs.SetBusy(true);
    ASSERT_NE(QApplication::overrideCursor(), nullptr);
    EXPECT_EQ(QApplication::overrideCursor()->shape(), Qt::WaitCursor);
    dialogs.SetBusy(false);
    EXPECT_EQ(QApplication::overrideCursor(), nullptr);
    dialogs.SetBusy(true);
  }
  EXPECT_EQ(QApplication::overrideCursor(), nullptr) << "with the dialogs goes the pointer";
}

TEST(QtDialogs, ProgressTellsWhenTheUserStops) {
  QtDialogs dialogs;
  auto progress = dialogs.StartProgress("Working");
  EXPECT_TRUE(progress->Step(1, 10));
  QProgressDialog* window = nullptr;
  for (QWidget* w : QApplication::topLevelWidgets())
    if (auto* p = qobject_cast<QProgressDialog*>(w)) window = p;
  ASSERT_NE(window, nullptr);
  window->cancel();
  EXPECT_FALSE(progress->Step(2, 10));
}

// What stands on a form and closes it may have more to say.
TEST(QtDialogs, ABoxThatGoesWithItsFormHasNoAnswer) {
  QtDialogs dialogs;
  QPointer<QDialog> form;
  const auto open = [&form] {
    form = new QDialog;
    form->open();
  };
  const auto goes = [&form](QWidget&) { delete form; };
  open();
  OnNext<QMessageBox>(goes);
  EXPECT_EQ(dialogs.Ask("Save ?", "Data", Buttons::kYesNoCancel), Answer::kCancel);
  EXPECT_TRUE(form.isNull());
  open();
  OnNext<QMessageBox>(goes);
  EXPECT_EQ(dialogs.Ask("Save ?", "Data", Buttons::kYesNo), Answer::kNo);
  open();
  OnNext<QInputDialog>(goes);
  EXPECT_EQ(dialogs.Prompt("Name", "Data", "A"), std::nullopt);
  open();
  const auto progress = dialogs.StartProgress("Working");
  delete form;
  EXPECT_FALSE(progress->Step(1, 10));
}

TEST(QtDialogs, WhatIsClickedAheadOfAnAnswerDoesNotReachTheFormBelow) {
  QDialog form;
  QPushButton button("Close", &form);
  int clicks = 0;
  QObject::connect(&button, &QPushButton::clicked, [&clicks] { ++clicks; });
  form.show();
  ASSERT_TRUE(QTest::qWaitForWindowExposed(&form));
  QtDialogs dialogs;
  OnNext<QMessageBox>([&](QMessageBox& box) {
    QTest::keyClick(&box, Qt::Key_Return);
    QTest::mouseClick(form.windowHandle(), Qt::LeftButton, {}, button.geometry().center());
    EXPECT_TRUE(InputIsHeldBack());
  });
  EXPECT_EQ(dialogs.Ask("Go on ?", "Data", Buttons::kOkCancel), Answer::kOk);
  EXPECT_EQ(clicks, 0);
  EXPECT_FALSE(InputIsHeldBack());
  QTest::mouseClick(form.windowHandle(), Qt::LeftButton, {}, button.geometry().center());
  EXPECT_EQ(clicks, 1);
}

TEST(QtDialogs, AMessageOverAMenuStandsOverTheFormOfTheMenu) {
  QWidget window;
  window.show();
  ASSERT_TRUE(QTest::qWaitForWindowExposed(&window));
  QMenu menu(&window);
  menu.addAction("Entry");
  menu.popup({});
  QApplication::setActiveWindow(&menu);
  QtDialogs dialogs;
  const QWidget* over = nullptr;
  OnNext<QMessageBox>([&](QMessageBox& box) {
    over = box.parentWidget();
    box.reject();
  });
  dialogs.Message("There is none", "Charts");
  EXPECT_EQ(over, &window);
}

TEST(QtDialogs, YieldHandlesWhatWaits) {
  QtDialogs dialogs;
  bool ran = false;
  QTimer::singleShot(0, [&] { ran = true; });
  dialogs.Yield();
  EXPECT_TRUE(ran);
}

}  // namespace
}  // namespace kora
