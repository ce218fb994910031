#include "chartwindow/forms/Anal.h"

#include <QLabel>
#include <QMenuBar>
#include <QPushButton>
#include <QScrollArea>

#include "base/numbers.h"
#include "base/text.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

// The view as a window of its own, on a share of 28 days.
class AnalTest : public test::FormTest {
 protected:
  void SetUp() override {
    ReadSettings();
    session->current.Rec = test::Security("AAA");
    for (const OscKey& key : OscKeys()) session->settings.osc[key] = {3, 3};
    SaveMOSets(session->user, 1, {"RSI", "None", "MACD", "Momentum"});
    SaveMOSets(session->user, 2, {"None", "Coppock", "None", "None"});
  }
  void TearDown() override { delete form.data(); }

  Anal& Open(int set = 1) {
    form = new Anal({.view = {.files = session->files,
                              .dialogs = dialogs,
                              .settings = session->settings,
                              .user = session->user,
                              .colours = session->colours,
                              .current = session->current,
                              .state = session->charts},
                     .print = [this] { ++printed; },
                     .openMultiOsc = [this] { ++opened; },
                     .returned = [this] { ++returned; }},
                    set);
    form->resize(800, 700);
    form->show();
    form->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(form.data()));
    form->Command2();
    return *form;
  }
  PictureBox* Box(const char* name) { return dynamic_cast<PictureBox*>(Find<QWidget>(form, name)); }
  PictureBox* Panel(int i) { return Box(qPrintable(QString("Picture2(%1)").arg(i))); }
  QAction* Entry(const char* name) { return Find<QAction>(form, name); }
  // Pixels that are not the background.
  int Ink(PictureBox* box) {
    const QImage& image = box->surface().image();
    const QRgb ground = QtSurface::Rgb(session->colours[kBackground]);
    int ink = 0;
    for (int y = 0; y < image.height(); ++y)
      for (int x = 0; x < image.width(); ++x) ink += (image.pixel(x, y) | 0xFF000000) != ground;
    return ink;
  }
  QString Status(int i) {
    return Find<QLabel>(form, qPrintable(QString("StatusBar1(%1)").arg(i)))->text();
  }

  QPointer<Anal> form;
  int printed = 0, opened = 0, returned = 0;
};

TEST_F(AnalTest, NoneInTheSecondSlotLeavesThreePanelsAtAThirdOfTheHeightEach) {
  Open();
  EXPECT_EQ(form->windowTitle(), "AAA        Multi-Oscillator 1");
  EXPECT_EQ(Entry("amSAn2")->text(), "Show &Multi-Oscillator 2");
  const double height = Box("Picture1")->surface().ScaleHeight();
  EXPECT_GT(height, 200);
  int top = Box("Picture1")->height();
  for (int i = 0; i < 3; ++i) {
    ASSERT_TRUE(Panel(i)->isVisible());
    EXPECT_DOUBLE_EQ(Panel(i)->surface().ScaleHeight(), height / 3);
    EXPECT_EQ(Panel(i)->width(), Box("Picture1")->width());
    EXPECT_EQ(Panel(i)->y(), top);
    top += Panel(i)->height();
    EXPECT_GT(Ink(Panel(i)), 500) << i;
  }
  EXPECT_FALSE(Panel(3)->isVisible());
  EXPECT_GT(Ink(Box("Picture1")), 500);
  // The same stands in the script that is printed.
  int frames = 0;
  const std::string script = home.Get("drive_c/korawin/data/TCht.Tmp");
  for (const std::string_view line : Split(script, '\n'))
    frames += line.starts_with("B,42,") && Val(Split(line, ',')[2]) > height;
  EXPECT_EQ(frames, 3);
}

TEST_F(AnalTest, SwappingShowsTheOtherSet) {
  Open();
  Entry("amSAn2")->trigger();
  EXPECT_EQ(form->windowTitle(), "AAA        Multi-Oscillator 2");
  EXPECT_EQ(Entry("amSAn2")->text(), "Show &Multi-Oscillator 1");
  EXPECT_EQ(form->view().MultiOscSet(), 2);
  EXPECT_EQ(Panel(0)->surface().ScaleHeight(), Box("Picture1")->surface().ScaleHeight());
  EXPECT_EQ(Panel(0)->accessibleName(), "Coppock");
  EXPECT_FALSE(Panel(1)->isVisible());
  QTest::keyClick(form, Qt::Key_F6);
  EXPECT_EQ(form->view().MultiOscSet(), 1);
  EXPECT_TRUE(Panel(2)->isVisible());
}

TEST_F(AnalTest, ASetWithoutOscillatorsIsToldAndEdited) {
  SaveMOSets(session->user, 1, {"None", "None", "None", "None"});
  Open();
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "No oscillators have been set");
  EXPECT_EQ(returned, 1);
  EXPECT_EQ(opened, 1);
}

TEST_F(AnalTest, TheGridGoesThroughAllPicturesAndReadsTheBar) {
  Open();
  const int before = Ink(Panel(2));
  QTest::keyClick(form, Qt::Key_F7);
  EXPECT_TRUE(Entry("amGrid")->isChecked());
  EXPECT_NE(Ink(Panel(2)), before);
  EXPECT_EQ(Status(1), "28-02-26");
  QTest::keyClick(form, Qt::Key_Left);
  EXPECT_EQ(Status(1), "27-02-26");
  Entry("amGrid")->trigger();
  EXPECT_EQ(Ink(Panel(2)), before);
  EXPECT_EQ(Status(1), "");
}

TEST_F(AnalTest, AnotherSizeDrawsAfresh) {
  Open();
  const double height = Box("Picture1")->surface().ScaleHeight();
  form->resize(900, 500);
  ASSERT_TRUE(
      WaitFor([&] { return Box("Picture1")->surface().ScaleHeight() < height && !dialogs.busy; }));
  EXPECT_GT(Ink(Panel(2)), 500);
}

TEST_F(AnalTest, PrintAndReturnAreTheDesksToDo) {
  Open();
  Entry("ampnt")->trigger();
  EXPECT_EQ(printed, 1);
  QTest::keyClick(form, Qt::Key_Escape);
  ASSERT_TRUE(WaitFor([&] { return form.isNull(); }));
  EXPECT_EQ(returned, 1);
}

TEST_F(AnalTest, ASecurityWithoutDataIsToldAndTheFormStays) {
  home.Put("drive_c/korawin/data/AAA.WDT", "");
  Open();
  ASSERT_FALSE(dialogs.said.empty());
  EXPECT_EQ(dialogs.said[0].text, "No Data for AAA.WDT");
  Entry("ampnt")->trigger();
  EXPECT_EQ(printed, 0);
  QTest::keyClick(form, Qt::Key_F7);
  EXPECT_EQ(Status(1), "");
}

}  // namespace
}  // namespace kora
