// The forms of printing, on a recording printer.

#include <QCheckBox>
#include <QComboBox>
#include <QDoubleSpinBox>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QRadioButton>
#include <QSpinBox>

#include "chart/forms/CHTPage.h"
#include "chart/forms/Page.h"
#include "chart/forms/PrintKora.h"
#include "chart/forms/PrinterSetup.h"
#include "chart/forms/print_job.h"
#include "platform/qt/qt_printer.h"
#include "tests/support/failing_io.h"
#include "tests/support/qt/form_fixture.h"
#include "tests/support/recording_printer.h"

namespace kora {
namespace {

constexpr ChartSize kChart{638, 452};

class PrintForms : public test::FormTest {
 protected:
  void SetUp() override { ReadSettings(); }

  PrintServices Services() {
    return {session->files,   session->ini,     dialogs, session->settings,
            session->colours, session->printer, printer};
  }
  template <typename Form, typename... Rest>
  Form& Open(Rest&&... rest) {
    auto made = std::make_unique<Form>(Services(), std::forward<Rest>(rest)..., nullptr);
    Form& form = *made;
    open = std::move(made);
    form.show();
    form.activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(&form));
    return form;
  }
  Page& OpenPage(const std::string& script = "L,0,0,638,452,255\r\n") {
    return Open<Page>(kChart, script);
  }
  SheetView* View() { return Find<SheetView>(open.get(), "Sheet"); }
  // Drags the box by a distance on the paper, twips.
  void Drag(double dx, double dy) {
    SheetView* view = View();
    const QRectF box = view->Box();
    const QPoint from = view->ToView(box.center()).toPoint();
    const QPoint to = from + (view->ToView({dx, dy}) - view->ToView({0, 0})).toPoint();
    QTest::mousePress(view, Qt::LeftButton, {}, from);
    QTest::mouseMove(view, (from + to) / 2);
    QTest::mouseMove(view, to);
    QTest::mouseRelease(view, Qt::LeftButton, {}, to);
  }
  std::string Key(const char* section, const char* key) {
    return session->ini.GetSetting(section, key);
  }
  std::string Size() { return Find<QLabel>(open.get(), "Label1")->text().toStdString(); }

  test::RecordingPrinter printer;
  std::unique_ptr<QDialog> open;
};

// ---- Page

TEST_F(PrintForms, PageShowsTheSheetWithTheChartInItsMiddle) {
  OpenPage();
  EXPECT_EQ(open->windowTitle(), "Printer Page (Portrait)");
  // 18 twips a unit: 11484 by 8136 on 11506 by 16438.
  EXPECT_EQ(View()->Box(), QRectF(11, 4151, 11484, 8136));
  EXPECT_EQ(Size(), "Size 1.2");
}

TEST_F(PrintForms, PageOfALandscapePrinterSaysSo) {
  session->settings.page.Orient = kLandscape;
  OpenPage();
  EXPECT_EQ(open->windowTitle(), "Printer Page (Landscape)");
  EXPECT_EQ(printer.Orientation(), kLandscape);
  EXPECT_EQ(Size(), "Size 1.5");
  QTest::keyClick(open.get(), Qt::Key_Escape);
  EXPECT_EQ(printer.Orientation(), kPortrait) << "as it was";
}

TEST_F(PrintForms, DraggedChartIsKeptAsNegativeOrigins) {
  session->settings.page.Orient = kLandscape;
  OpenPage();
  const QRectF before = View()->Box();
  Drag(600, -300);
  EXPECT_TRUE(dialogs.said.empty());
  const QRectF after = View()->Box();
  const double pixel = 1 / (View()->ToView({1, 0}).x() - View()->ToView({0, 0}).x());
  EXPECT_NEAR(after.left(), before.left() + 600, pixel);
  EXPECT_NEAR(after.top(), before.top() - 300, pixel);
  Click(open.get(), "Command1");
  EXPECT_FALSE(open->isVisible());
  EXPECT_EQ(Key("Charts", "SW"), std::to_string(-int(after.left())));
  EXPECT_EQ(Key("Charts", "SH"), std::to_string(-int(after.top())));
  EXPECT_EQ(Key("Charts", "Cw"), "14036");  // 638 * 22
  EXPECT_EQ(Key("Charts", "Ch"), "9944");
  EXPECT_EQ(Key("Charts", "EFact"), "1.5");
  EXPECT_EQ(Key("ChtPage", "Orient"), "2");
  EXPECT_EQ(session->settings.charts.SW, -after.left());
}

TEST_F(PrintForms, ChartDroppedOffThePageGoesBack) {
  OpenPage();
  const QRectF before = View()->Box();
  Drag(3000, 0);
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "All edges of chart MUST be on page");
  EXPECT_EQ(dialogs.said[0].title, "Page Setup");
  EXPECT_EQ(View()->Box(), before);
}

TEST_F(PrintForms, ArrowKeysMoveTheChartByAMillimetre) {
  OpenPage();
  View()->setFocus();
  QTest::keyClick(View(), Qt::Key_Up);
  EXPECT_EQ(View()->Box().topLeft(), QPointF(11, 4094));  // 4151 - 56.69
  QTest::keyClick(View(), Qt::Key_Right);                 // 11 twips are left there
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(View()->Box().topLeft(), QPointF(11, 4094));
}

TEST_F(PrintForms, PressBesideTheChartDragsNothing) {
  OpenPage();
  const QRectF before = View()->Box();
  QTest::mousePress(View(), Qt::LeftButton, {}, View()->ToView({5000, 500}).toPoint());
  QTest::mouseRelease(View(), Qt::LeftButton, {}, View()->ToView({5000, 3000}).toPoint());
  EXPECT_EQ(View()->Box(), before);
}

TEST_F(PrintForms, EnlargingStopsAtTheEdgesAndReducingAt1Point2) {
  session->settings.page.Orient = kLandscape;
  OpenPage();
  // 16438 / 638 is 25.8 and 11506 / 452 is 25.5: 1.6 gives 24, 1.7 gives 26 (25.5 to even).
  Click(open.get(), "cmInc");
  EXPECT_EQ(Size(), "Size 1.6");
  EXPECT_EQ(View()->Box().size(), QSizeF(638 * 24, 452 * 24));
  EXPECT_TRUE(dialogs.said.empty());
  Click(open.get(), "cmInc");
  EXPECT_EQ(Size(), "Size 1.6");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "All edges of chart MUST be on page");
  QTest::keyClick(open.get(), Qt::Key_R, Qt::AltModifier);
  EXPECT_TRUE(WaitFor([&] { return Size() == "Size 1.5"; })) << Size();
  for (int i = 0; i < 9; ++i) Click(open.get(), "cmDec");
  EXPECT_EQ(Size(), "Size 1.2");
  Click(open.get(), "Command2");
  EXPECT_EQ(Key("Charts", "EFact"), "1.5") << "Cancel keeps nothing";
}

TEST_F(PrintForms, TurningThePageFindsAPlaceForTheChart) {
  OpenPage();
  auto* landscape = Find<QRadioButton>(open.get(), "Option1(1)");
  landscape->click();
  EXPECT_EQ(open->windowTitle(), "Printer Page (Landscape)");
  EXPECT_EQ(printer.Orientation(), kLandscape);
  // 1.7 would be 11,526 high on a sheet of 11,906 less its margins.
  EXPECT_EQ(Size(), "Size 1.6");
  EXPECT_TRUE(dialogs.said.empty());
  Click(open.get(), "cmInc");
  EXPECT_EQ(Size(), "Size 1.6") << "as large as the sheet takes";
  EXPECT_EQ(dialogs.said.size(), 1u);
  Find<QRadioButton>(open.get(), "Option1(0)")->click();
  EXPECT_EQ(Size(), "Size 1.2");
  EXPECT_EQ(View()->Box(), QRectF(11, 4151, 11484, 8136));
}

TEST_F(PrintForms, CentreTakesTheMarginsBack) {
  session->settings.charts.SW = -5;
  session->settings.charts.SH = -100;
  session->settings.charts.Cw = session->settings.charts.Ch = 1;
  session->settings.charts.EFact = 1.2;
  OpenPage();
  EXPECT_EQ(View()->Box().topLeft(), QPointF(5, 100));
  Click(open.get(), "Command3");
  Click(open.get(), "Command1");
  EXPECT_EQ(Key("Charts", "SW"), "0");
  EXPECT_EQ(Key("Charts", "SH"), "0");
}

TEST_F(PrintForms, AChartKeptOffThePageCanNotBeSaved) {
  session->settings.charts.SW = -5000;
  session->settings.charts.SH = -100;
  session->settings.charts.Cw = session->settings.charts.Ch = 1;
  session->settings.charts.EFact = 2;
  OpenPage();
  Click(open.get(), "Command1");
  EXPECT_TRUE(open->isVisible());
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "All edges of chart MUST be on page");
}

TEST_F(PrintForms, PageShowsTheChartItselfInItsBox) {
  session->printer.ColourPrinter = 1;
  OpenPage("F,100,100,500,350,255\r\n");
  const QImage shot = View()->grab().toImage();
  const auto at = [&](double x, double y) {
    const QPointF box = View()->Box().topLeft();
    return QColor(
        shot.pixel((View()->ToView(box + QPointF(x, y) * 18) * shot.devicePixelRatio()).toPoint()));
  };
  EXPECT_EQ(at(300, 200), QColor(255, 0, 0));
  EXPECT_EQ(at(50, 50), QColor(Qt::white));
}

TEST_F(PrintForms, AScriptThatBreaksShowsAsAnEmptyBox) {
  OpenPage("L,1,2,3,4,5,6,7\r\n");
  EXPECT_FALSE(View()->grab().isNull());
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(PrintForms, WithoutAPrinterBothPagesSaySoAndDoNotTurn) {
  printer.device.clear();
  const auto check = [&] {
    ASSERT_EQ(dialogs.said.size(), 1u);
    EXPECT_EQ(dialogs.said[0].text, "There is no default printer.");
    EXPECT_EQ(dialogs.said[0].title, "Printer Page");
    Find<QRadioButton>(open.get(), "Option1(1)")->click();
    ASSERT_EQ(dialogs.said.size(), 2u);
    EXPECT_EQ(dialogs.said[1].text, "There is no default printer. Cannot change orientation.");
    EXPECT_EQ(dialogs.said[1].title, "Printer Page");
    EXPECT_TRUE(Find<QRadioButton>(open.get(), "Option1(0)")->isChecked());
    EXPECT_EQ(printer.Orientation(), kPortrait);
    dialogs.said.clear();
  };
  OpenPage().CheckPrinter();
  check();
  Open<CHTPage>().CheckPrinter();
  check();
}

// ---- CHTPage

TEST_F(PrintForms, MarginsOfTextAreKeptInTwips) {
  Open<CHTPage>();
  EXPECT_EQ(open->windowTitle(), "Printer Page (Portrait)");
  const auto enter = [&](const char* name, const char* text) {
    auto* box = Find<QDoubleSpinBox>(open.get(), name);
    box->setFocus();
    box->selectAll();
    QTest::keyClicks(box, text);
  };
  enter("PPTop", "25.4");
  enter("PPBot", "12.7");
  enter("PPLft", "20");
  enter("PPRht", "10");
  Find<QRadioButton>(open.get(), "Option1(1)")->click();
  // 16438 by 11506; 20 mm are 1133.9 twips and 10 mm 566.9.
  const QRectF box = View()->Box();
  EXPECT_NEAR(box.left(), 1133.9, 0.1);
  EXPECT_NEAR(box.right(), 16438 - 566.9, 0.1);
  EXPECT_NEAR(box.top(), 1440, 0.1);
  EXPECT_NEAR(box.bottom(), 11506 - 720, 0.1);
  Click(open.get(), "Command1");
  EXPECT_EQ(Key("ChtPage", "PPTop"), "1440");
  EXPECT_EQ(Key("ChtPage", "PPBot"), "720");
  EXPECT_EQ(Key("ChtPage", "PPLft"), "1134");
  EXPECT_EQ(Key("ChtPage", "PPRht"), "567");
  EXPECT_EQ(Key("ChtPage", "Orient"), "2");
  EXPECT_EQ(session->settings.page.PPRht, 567);
}

TEST_F(PrintForms, MarginsOfTextLeaveRoomForText) {
  Open<CHTPage>();
  auto* left = Find<QDoubleSpinBox>(open.get(), "PPLft");
  left->setValue(1000);
  // 11506 - 1440 twips.
  EXPECT_NEAR(left->value(), 177.5, 0.11);
  EXPECT_NEAR(Find<QDoubleSpinBox>(open.get(), "PPRht")->maximum(), 0, 0.11);
  Click(open.get(), "Command2");
  EXPECT_EQ(session->settings.page.PPLft, 0);
}

// ---- PrintKora

TEST_F(PrintForms, CopiesAndPrinterAreAskedFor) {
  PrintChoice choice;
  Open<PrintKora>(choice);
  auto* printers = Find<QComboBox>(open.get(), "Combo1");
  EXPECT_EQ(printers->currentText(), "Press");
  QTest::keyClicks(Find<QSpinBox>(open.get(), "Text1"), "3");
  printers->setCurrentText("Other Press");
  QTest::keyClick(open.get(), Qt::Key_Return);
  EXPECT_TRUE(WaitFor([&] { return !open->isVisible(); }));
  EXPECT_FALSE(choice.PrintCancelled);
  EXPECT_EQ(choice.PrintCopies, 3);
  EXPECT_EQ(printer.device, "Other Press");
}

TEST_F(PrintForms, CancelOfTheCopyDialogChangesNothing) {
  for (const bool byKey : {false, true}) {
    PrintChoice choice;
    choice.PrintCancelled = false;
    Open<PrintKora>(choice);
    Find<QComboBox>(open.get(), "Combo1")->setCurrentText("Other Press");
    if (byKey)
      QTest::keyClick(open.get(), Qt::Key_Escape);
    else
      Click(open.get(), "Command2");
    EXPECT_TRUE(choice.PrintCancelled);
    EXPECT_EQ(printer.device, "Press");
  }
}

class PdfPrinter : public test::RecordingPrinter {
 public:
  std::vector<std::string> DeviceNames() const override {
    return {"Press", std::string(QtPrinter::kPdfPrinter)};
  }
};

TEST_F(PrintForms, APdfNeedsAFileNameAndAsksBeforeItOverwrites) {
  PdfPrinter pdf;
  PrintServices services{session->files,   session->ini,     dialogs, session->settings,
                         session->colours, session->printer, pdf};
  PrintChoice choice;
  choice.pdfFile = "c:\\korawin\\AAA.pdf";
  PrintKora form(services, choice, nullptr);
  form.show();
  auto* file = Find<QLineEdit>(&form, "Text2");
  EXPECT_FALSE(file->isEnabled());
  Find<QComboBox>(&form, "Combo1")->setCurrentIndex(1);
  EXPECT_TRUE(file->isEnabled());
  EXPECT_FALSE(Find<QSpinBox>(&form, "Text1")->isEnabled());
  for (const char* bad : {"", ".pdf", "c:\\korawin\\AAA.txt"}) {
    file->setText(bad);
    Click(&form, "Command1");
    EXPECT_EQ(dialogs.said.back().text, "File name invalid");
    EXPECT_TRUE(choice.PrintCancelled);
  }
  home.Put("drive_c/korawin/AAA.pdf", "old");
  file->setText("c:\\korawin\\AAA.pdf");
  dialogs.answers = {Answer::kCancel};
  Click(&form, "Command1");
  EXPECT_EQ(dialogs.said.back().text, "c:\\korawin\\AAA.pdf already exists - Overwrite");
  EXPECT_TRUE(form.isVisible());
  Click(&form, "Command1");
  EXPECT_FALSE(form.isVisible());
  EXPECT_FALSE(choice.PrintCancelled);
  EXPECT_EQ(choice.pdfFile, "c:\\korawin\\AAA.pdf");
  EXPECT_EQ(pdf.device, QtPrinter::kPdfPrinter);
}

TEST_F(PrintForms, APdfIsBrowsedForAndTakesAPathOfTheMachine) {
  PdfPrinter pdf;
  pdf.device = QtPrinter::kPdfPrinter;
  PrintServices services{session->files,   session->ini,     dialogs, session->settings,
                         session->colours, session->printer, pdf};
  PrintChoice choice;
  choice.pdfFile = "c:\\korawin\\AAA.pdf";
  std::string standing;
  choice.pickPdf = [&](const std::string& file) {
    standing = file;
    return home.path() + "/mine";
  };
  PrintKora form(services, choice, nullptr);
  form.show();
  Click(&form, "Command3");
  EXPECT_EQ(standing, home.path() + "/drive_c/korawin/AAA.pdf");
  EXPECT_EQ(Find<QLineEdit>(&form, "Text2")->text().toStdString(), home.path() + "/mine.pdf");
  Click(&form, "Command1");
  EXPECT_EQ(session->files.HostPath(choice.pdfFile), home.path() + "/mine.pdf");
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(PrintForms, DarkColoursAreOnInANewInstallationAndKept) {
  PdfPrinter pdf;
  PrintServices services{session->files,   session->ini,     dialogs, session->settings,
                         session->colours, session->printer, pdf};
  PrintChoice choice;
  PrintKora form(services, choice, nullptr);
  form.show();
  auto* dark = Find<QCheckBox>(&form, "Check1");
  EXPECT_EQ(dark->text(), "&Dark colours on white paper");
  EXPECT_TRUE(dark->isChecked());
  dark->click();
  Click(&form, "Command1");
  EXPECT_FALSE(session->settings.charts.DarkPaper);
  EXPECT_EQ(session->ini.GetSetting("Charts", "DarkPaper"), "False");
}

TEST_F(PrintForms, WithoutADefaultPrinterThePdfIsChosen) {
  PdfPrinter pdf;
  pdf.device.clear();
  PrintServices services{session->files,   session->ini,     dialogs, session->settings,
                         session->colours, session->printer, pdf};
  PrintChoice choice;
  choice.pdfFile = "c:\\korawin\\AAA.pdf";
  PrintKora form(services, choice, nullptr);
  form.show();
  EXPECT_EQ(Find<QComboBox>(&form, "Combo1")->currentText(), "PDF file");
  EXPECT_TRUE(Find<QLineEdit>(&form, "Text2")->isEnabled());
  EXPECT_EQ(pdf.device, "") << "looking chooses nothing";
  Click(&form, "Command1");
  EXPECT_TRUE(dialogs.said.empty());
  EXPECT_FALSE(choice.PrintCancelled);
  EXPECT_EQ(pdf.device, "PDF file");

  for (const char* gone : {"", "A press that was sold"}) {
    pdf.device = gone;
    PrinterSetup setup(services, nullptr);
    EXPECT_EQ(Find<QComboBox>(&setup, "Combo1")->currentText(), "PDF file");
  }
}

TEST_F(PrintForms, WithoutAnyPrinterTheCopyDialogSaysSo) {
  printer.device.clear();
  PrintChoice choice;
  Open<PrintKora>(choice);
  Click(open.get(), "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "There is no default printer.");
  EXPECT_TRUE(choice.PrintCancelled);
}

// ---- the menu entry

class PrintJobs : public PrintForms {
 protected:
  // Opens the copy dialog over a caller, presses `button` after `prepare`, and waits for the end.
  void Run(Printer& on, const char* button, std::function<void(PrintKora&)> prepare = {}) {
    home.Put("drive_c/korawin/data/TCht.Tmp", script);
    PrintServices services{session->files,   session->ini,     dialogs, session->settings,
                           session->colours, session->printer, on};
    bool done = false;
    AskAndPrint(services, choice,
                {.chart = kChart,
                 .scriptPath = "c:\\korawin\\data\\TCht.Tmp",
                 .swapCaption =
                     [this](const std::string& caption) {
                       captions.push_back(caption);
                       return std::string("CHARTS");
                     },
                 .done = [&] { done = true; }},
                nullptr);
    auto* form = TopLevel<PrintKora>();
    ASSERT_NE(form, nullptr);
    if (prepare) prepare(*form);
    Click(form, button);
    EXPECT_TRUE(WaitFor([&] { return done; }));
    EXPECT_EQ(home.Get("drive_c/korawin/data/TCht.Tmp"), script);
  }

  std::string script = "L,1,2,3,4,5\r\n";
  PrintChoice choice;
  std::vector<std::string> captions;
};

class ListJobs : public PrintForms {
 protected:
  void Run(const char* button) {
    AskAndPrintTable(
        Services(), choice,
        {.layout = {.heading = "LIST", .columns = {"Code"}, .at = {0}}, .rows = {{"ORE"}, {"ZAP"}}},
        nullptr);
    auto* form = TopLevel<PrintKora>();
    ASSERT_NE(form, nullptr);
    Find<QSpinBox>(form, "Text1")->setValue(2);
    const QPointer<PrintKora> there = form;
    Click(form, button);
    EXPECT_TRUE(WaitFor([&] { return there.isNull(); }));
  }
  PrintChoice choice;
};

TEST_F(ListJobs, AListIsPrintedOnceACopy) {
  Run("Command1");
  EXPECT_EQ(printer.sent.size(), 2u);
  EXPECT_TRUE(dialogs.said.empty());
}

TEST_F(ListJobs, ACancelledListIsNotPrinted) {
  Run("Command2");
  EXPECT_EQ(printer.started, 0);
}

TEST_F(ListJobs, TheFirstFailureIsToldAndEndsIt) {
  printer.failAtEnd = kDeviceNotAvailable;
  Run("Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].title, "Error");
  EXPECT_EQ(dialogs.said[0].text.find("There is an unexpected error - "), 0u);
  EXPECT_EQ(printer.started, 1);
}

TEST_F(PrintJobs, EachCopyIsPrinted) {
  printer.SetOrientation(kLandscape);
  session->settings.page.Orient = 0;
  session->settings.charts.FitSide = false;
  Run(printer, "Command1", [&](PrintKora& form) { Find<QSpinBox>(&form, "Text1")->setValue(3); });
  EXPECT_EQ(printer.sent.size(), 3u);
  EXPECT_EQ(session->settings.page.Orient, kPortrait) << "none was chosen";
  EXPECT_EQ(printer.Orientation(), kPortrait);
  EXPECT_EQ(captions.size(), 6u);
}

TEST_F(PrintJobs, APageThatWasNeverTurnedLiesOnTheChartsBetterSide) {
  session->settings.page.Orient = 0;
  EXPECT_TRUE(session->settings.charts.FitSide) << "a new installation";
  Run(printer, "Command1");
  EXPECT_EQ(session->settings.page.Orient, kLandscape);
  EXPECT_EQ(printer.Orientation(), kLandscape);
}

TEST_F(PrintJobs, TheOrientationFollowsThePrinter) {
  session->settings.page.Orient = kPortrait;
  printer.SetOrientation(kLandscape);
  Run(printer, "Command1");
  EXPECT_EQ(session->settings.page.Orient, kLandscape);
  EXPECT_EQ(printer.Orientation(), kLandscape);
}

TEST_F(PrintJobs, CancelPrintsNothing) {
  Run(printer, "Command2");
  EXPECT_TRUE(choice.PrintCancelled);
  EXPECT_EQ(printer.started, 0);
  EXPECT_TRUE(captions.empty());
}

TEST_F(PrintJobs, TheFirstCopyThatFailsIsTheLast) {
  script = "L,1,2,3,4,5,6,7\r\n";
  Run(printer, "Command1", [&](PrintKora& form) { Find<QSpinBox>(&form, "Text1")->setValue(3); });
  EXPECT_EQ(dialogs.said.size(), 1u);
  EXPECT_TRUE(printer.sent.empty());
}

TEST_F(PrintJobs, APdfComesIntoItsFileAndAFullDiskLeavesTheOldOne) {
  test::FailingIo io;  // the disk is full from the nth change on
  const Files files(home.path(), io);
  QtPrinter pdf([&](const std::string& bytes) { files.WriteAll(choice.pdfFile, bytes); });
  pdf.SetDevice(QtPrinter::kPdfPrinter);
  choice.pdfFile = "c:\\korawin\\chtsave\\AAA.pdf";
  Run(pdf, "Command1");
  ASSERT_EQ(dialogs.said.size(), 1u);
  EXPECT_EQ(dialogs.said[0].text, "Saved in " + home.path() + "/drive_c/korawin/chtsave/AAA.pdf");
  const std::string made = home.Get("drive_c/korawin/chtsave/AAA.pdf");
  EXPECT_EQ(made.substr(0, 5), "%PDF-");
  io.lasting = true;
  for (const int change : {1, 2, 3}) {
    io.Reset(change);
    dialogs.said.clear();
    Run(pdf, "Command1");
    ASSERT_EQ(dialogs.said.size(), 2u) << change;
    EXPECT_EQ(dialogs.said[0].text, "c:\\korawin\\chtsave\\AAA.pdf already exists - Overwrite");
    EXPECT_EQ(dialogs.said[1].text, "There is an unexpected error No. 61\nDisk full");
    EXPECT_EQ(dialogs.said[1].title, "Chart Printing");
    EXPECT_EQ(home.Get("drive_c/korawin/chtsave/AAA.pdf"), made) << change;
  }
}

// ---- PrinterSetup

TEST_F(PrintForms, PrinterPaperAndOrientationAreSet) {
  Open<PrinterSetup>();
  Find<QComboBox>(open.get(), "Combo1")->setCurrentText("Other Press");
  Find<QComboBox>(open.get(), "Combo2")->setCurrentText("Letter");
  Find<QRadioButton>(open.get(), "Option1(1)")->click();
  Click(open.get(), "Command1");
  EXPECT_FALSE(open->isVisible());
  EXPECT_EQ(printer.device, "Other Press");
  EXPECT_EQ(printer.PaperName(), "Letter");
  EXPECT_EQ(printer.Orientation(), kLandscape);
  EXPECT_EQ(Key("ChtPage", "Orient"), "2");
  EXPECT_EQ(session->settings.page.Orient, 2);
}

TEST_F(PrintForms, CancelOfThePrinterSetUpChangesNothing) {
  Open<PrinterSetup>();
  Find<QComboBox>(open.get(), "Combo1")->setCurrentText("Other Press");
  Find<QRadioButton>(open.get(), "Option1(1)")->click();
  QTest::keyClick(open.get(), Qt::Key_Escape);
  EXPECT_EQ(printer.device, "Press");
  EXPECT_EQ(printer.Orientation(), kPortrait);
}

// Pictures of the forms, to be looked at.
TEST_F(PrintForms, Look) {
  const QByteArray folder = qgetenv("KORA_FORM_PICTURES");
  if (folder.isEmpty()) GTEST_SKIP() << "no folder for pictures";
  const std::string scale = std::to_string(int(qApp->devicePixelRatio()));
  session->printer.ColourPrinter = 1;
  QFile script(qEnvironmentVariable("KORA_FORM_SCRIPT"));
  const auto shoot = [&](const std::string& name) {
    EXPECT_TRUE(open->grab().save(QString::fromUtf8(folder) + "/" +
                                  QString::fromStdString(name + "-" + scale + ".png")));
  };
  const std::string text =
      script.open(QIODevice::ReadOnly) ? script.readAll().toStdString() : "B,1,1,637,451,255\r\n";
  OpenPage(text);
  shoot("Page-portrait");
  Find<QRadioButton>(open.get(), "Option1(1)")->click();
  QCoreApplication::processEvents();
  shoot("Page-landscape");
  session->settings.page.PPTop = 1440;
  session->settings.page.PPRht = 2000;
  Open<CHTPage>();
  shoot("CHTPage");
  PrintChoice choice;
  choice.pdfFile = "c:\\korawin\\chtsave\\AAA.pdf";
  Open<PrintKora>(choice);
  shoot("PrintKora");
  Open<PrinterSetup>();
  shoot("PrinterSetup");
}

}  // namespace
}  // namespace kora
