#include "lists/forms/work_panel.h"

#include <QDialog>
#include <QLabel>
#include <QLineEdit>
#include <QProgressBar>
#include <QPushButton>
#include <QTimer>
#include <QVBoxLayout>

#include "base/runtime_error.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

class WorkPanelTest : public test::FormTest {
 protected:
  void SetUp() override {
    form = std::make_unique<QDialog>();
    auto* box = new QVBoxLayout(form.get());
    start = new QPushButton("Start", form.get());
    other = new QPushButton("Other", form.get());
    other->setEnabled(false);
    panel = new WorkPanel(form.get());
    panel->Hold({start, other});
    box->addWidget(start);
    box->addWidget(other);
    box->addWidget(panel);
    form->show();
    form->activateWindow();
    ASSERT_TRUE(QTest::qWaitForWindowActive(form.get()));
    start->setFocus();
  }
  QPushButton* StopButton() { return Find<QPushButton>(form.get(), "StopWork"); }
  // Steps until the panel says stop, for at most some seconds.
  static int StepToTheEnd(Progress& progress) {
    QElapsedTimer time;
    time.start();
    int steps = 0;
    while (time.elapsed() < 5000 && progress.Step(++steps % 1000, 1000)) {
    }
    return steps;
  }

  std::unique_ptr<QDialog> form;
  QPushButton *start, *other;
  WorkPanel* panel;
};

TEST_F(WorkPanelTest, ShowsTheWorkAndLeavesTheFormAsItWas) {
  EXPECT_FALSE(StopButton()->isVisible());
  EXPECT_TRUE(panel->Run("Checking Data - WAIT", [this](Progress& progress) {
    EXPECT_TRUE(panel->running());
    EXPECT_FALSE(start->isEnabled());
    EXPECT_TRUE(StopButton()->isVisible());
    EXPECT_EQ(Find<QLabel>(form.get(), "WorkText")->text(), "Checking Data - WAIT");
    for (int i = 1; i <= 10; ++i) EXPECT_TRUE(progress.Step(i, 10));
  }));
  EXPECT_FALSE(panel->running());
  EXPECT_FALSE(panel->stopped());
  EXPECT_TRUE(start->isEnabled());
  EXPECT_FALSE(other->isEnabled());  // it was not before
  EXPECT_FALSE(StopButton()->isVisible());
  EXPECT_EQ(Find<QLabel>(form.get(), "WorkText")->text(), "");
  EXPECT_TRUE(start->hasFocus());
}

TEST_F(WorkPanelTest, TheButtonStopsTheWork) {
  QTimer::singleShot(0, panel, [this] { StopButton()->click(); });
  panel->Run("", [](Progress& progress) { StepToTheEnd(progress); });
  EXPECT_TRUE(panel->stopped());
  EXPECT_TRUE(start->isEnabled());
  panel->Run("", [](Progress& progress) { EXPECT_TRUE(progress.Step(1, 2)); });
  EXPECT_FALSE(panel->stopped());
}

TEST_F(WorkPanelTest, CanNotBeStartedTwice) {
  int runs = 0;
  panel->Run("", [&](Progress&) {
    ++runs;
    EXPECT_FALSE(panel->Run("", [&](Progress&) { ++runs; }));
  });
  EXPECT_EQ(runs, 1);
}

TEST_F(WorkPanelTest, AClosingFormStopsTheWorkFirst) {
  EXPECT_FALSE(panel->StopFirst());
  bool asked = false;
  QTimer::singleShot(0, panel, [&] { asked = panel->StopFirst(); });
  panel->Run("", [](Progress& progress) { StepToTheEnd(progress); });
  EXPECT_TRUE(asked);
  EXPECT_TRUE(panel->stopped());
}

TEST_F(WorkPanelTest, WhatTheWorkThrowsReachesTheCaller) {
  EXPECT_THROW(panel->Run("", [](Progress&) { throw RunTimeError(kDiskFull); }), RunTimeError);
  EXPECT_FALSE(panel->running());
  EXPECT_TRUE(start->isEnabled());
}

TEST_F(WorkPanelTest, WorkEndsWithItsPanel) {
  bool more = true;
  panel->Run("", [&](Progress& progress) {
    QTimer::singleShot(0, qApp, [this] { form.reset(); });
    StepToTheEnd(progress);
    more = progress.Step(1, 2);
  });
  EXPECT_FALSE(more);
  EXPECT_EQ(form, nullptr);
}

}  // namespace
}  // namespace kora
