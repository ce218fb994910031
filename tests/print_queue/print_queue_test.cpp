// Printing to a real queue: pages go through CUPS and its filters and come out as PDFs.

#include <gtest/gtest.h>

#include <QDir>
#include <QFile>
#include <QImage>
#include <QPrinterInfo>
#include <QProcess>
#include <QTemporaryDir>

#include "base/runtime_error.h"
#include "chart/chart_printing.h"
#include "platform/qt/qt_printer.h"
#include "tests/print_queue/cups_queue.h"
#include "tests/support/error_of.h"
#include "tests/support/places.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora {
namespace {

using test::CupsQueue;
using test::ErrorOf;

constexpr int kDpi = 96;

class PrintQueue : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    if (CupsQueue::Missing().isEmpty()) queue_ = std::make_unique<CupsQueue>();
  }
  static void TearDownTestSuite() { queue_.reset(); }

  void SetUp() override {
    if (!queue_) GTEST_SKIP() << "missing: " << CupsQueue::Missing().toStdString();
    ASSERT_TRUE(queue_->Works()) << queue_->Log().toStdString();
    std::copy(StandardColours().begin(), StandardColours().end(), colours_.begin());
    setup_.PrintEnlarge = 1.2f;
    setup_.PrintColourMode = 1;
    fonts_.Font2Size = 8;
  }

  bool PrintGolden(QtPrinter& printer) {
    QFile script(QString::fromStdString(SourceDir()) + "/tests/golden/charts/osc_macd.cht");
    EXPECT_TRUE(script.open(QIODevice::ReadOnly));
    const ChartPrintServices services{home_.files(), dialogs_, printer, fonts_, colours_, {}};
    return PrintChartScript(services, setup_, {638, 596}, script.readAll().toStdString());
  }

  // The pages of a PDF.
  static QList<QImage> Pictures(const QByteArray& pdf) {
    QTemporaryDir folder;
    QFile file(folder.filePath("a.pdf"));
    if (!file.open(QIODevice::WriteOnly)) return {};
    file.write(pdf);
    file.close();
    QProcess gs;
    gs.start("gs", {"-q", "-dSAFER", "-dBATCH", "-dNOPAUSE", "-sDEVICE=png16m",
                    "-r" + QString::number(kDpi), "-dTextAlphaBits=4", "-dGraphicsAlphaBits=4",
                    "-sOutputFile=" + folder.filePath("%02d.png"), file.fileName()});
    if (!gs.waitForFinished(60000)) return {};
    QList<QImage> pages;
    for (const QString& name : QDir(folder.path()).entryList({"*.png"}, QDir::Files, QDir::Name))
      pages << QImage(folder.filePath(name));
    return pages;
  }

  // Keeps what came out where somebody wants to look at it.
  static void Keep(const QByteArray& pdf, const char* name) {
    const QByteArray folder = qgetenv("KORA_FORM_PICTURES");
    if (folder.isEmpty()) return;
    QFile file(QString::fromUtf8(folder) + "/" + name);
    EXPECT_TRUE(file.open(QIODevice::WriteOnly) && file.write(pdf) == pdf.size());
  }

  static inline std::unique_ptr<CupsQueue> queue_;
  test::TempHome home_;
  test::ScriptedDialogs dialogs_;
  FontSettings fonts_;
  ChartColours colours_{};
  PrintSetup setup_;
};

TEST_F(PrintQueue, QueueIsAmongThePrintersAndItsPagesLieAsAskedFor) {
  QtPrinter printer({});
  const auto names = printer.DeviceNames();
  EXPECT_NE(std::find(names.begin(), names.end(), CupsQueue::kName), names.end());
  printer.SetDevice(CupsQueue::kName);
  EXPECT_EQ(printer.PaperName(), "A4");
  EXPECT_NEAR(printer.Page().width, 11906, 20);
  printer.SetOrientation(kLandscape);
  EXPECT_NEAR(printer.Page().width, 16838, 20);

  const auto before = queue_->Done();
  printer.StartDoc("Boxes");
  // An inch in; 3 by 1 inches.
  const Sheet sheet = printer.Page();
  printer.FilledBox(1440 - sheet.left, 1440 - sheet.top, 5760 - sheet.left, 2880 - sheet.top,
                    0x0000FF);
  printer.NewPage();
  printer.FilledBox(1440 - sheet.left, 1440 - sheet.top, 2880 - sheet.left, 2880 - sheet.top,
                    0xFF0000);
  printer.EndDoc();
  const QList<QImage> pages = Pictures(queue_->NextPdf(before));
  ASSERT_EQ(pages.size(), 2) << queue_->Log().toStdString();
  // Some filters leave a landscape page on a sheet that stands.
  const auto lying = [](QImage page) {
    return page.width() > page.height() ? page : page.transformed(QTransform().rotate(90));
  };
  const QImage first = lying(pages[0]), second = lying(pages[1]);
  EXPECT_EQ(first.pixelColor(kDpi * 3, kDpi * 3 / 2), QColor(255, 0, 0));
  EXPECT_EQ(first.pixelColor(kDpi * 9 / 10, kDpi * 3 / 2), QColor(Qt::white));
  EXPECT_EQ(first.pixelColor(kDpi * 3, kDpi * 22 / 10), QColor(Qt::white));
  EXPECT_EQ(second.pixelColor(kDpi * 3 / 2, kDpi * 3 / 2), QColor(0, 0, 255));
  EXPECT_EQ(second.pixelColor(kDpi * 3, kDpi * 3 / 2), QColor(Qt::white));
}

// What the queue prints and the PDF printer's page differ in nothing that one sees.
TEST_F(PrintQueue, AChartComesOutAsThePdfPrinterMakesIt) {
  std::string made;
  QtPrinter pdf([&](const std::string& bytes) { made = bytes; });
  pdf.SetDevice(QtPrinter::kPdfPrinter);
  ASSERT_TRUE(PrintGolden(pdf));

  QtPrinter printer({});
  printer.SetDevice(CupsQueue::kName);
  const auto before = queue_->Done();
  ASSERT_TRUE(PrintGolden(printer));
  const QByteArray printed = queue_->NextPdf(before);
  Keep(printed, "queue.pdf");
  Keep(QByteArray::fromStdString(made), "file.pdf");

  const QList<QImage> one = Pictures(printed), other = Pictures(QByteArray::fromStdString(made));
  ASSERT_EQ(one.size(), 1) << queue_->Log().toStdString();
  ASSERT_EQ(other.size(), 1);
  ASSERT_NEAR(one[0].width(), other[0].width(), 2);
  ASSERT_NEAR(one[0].height(), other[0].height(), 2);
  // A grid of squares of 4 pixels: how dark each is.
  const auto darkness = [](const QImage& page, int column, int row) {
    int sum = 0;
    for (int y = 0; y < 4; ++y)
      for (int x = 0; x < 4; ++x) sum += 255 - qGray(page.pixel(column * 4 + x, row * 4 + y));
    return sum / 16;
  };
  int inked = 0, different = 0;
  for (int row = 0; row < std::min(one[0].height(), other[0].height()) / 4; ++row)
    for (int column = 0; column < std::min(one[0].width(), other[0].width()) / 4; ++column) {
      const int a = darkness(one[0], column, row), b = darkness(other[0], column, row);
      inked += a > 20 || b > 20;
      different += std::abs(a - b) > 60;
    }
  EXPECT_GT(inked, 2000);
  EXPECT_LT(different, inked / 50);
}

TEST_F(PrintQueue, AQueueThatStoppedOrTakesNothingIsToldAndGetsNoPage) {
  QtPrinter printer({});
  printer.SetDevice(CupsQueue::kName);
  const auto before = queue_->Done();
  const std::string told =
      std::string("There is an unexpected error No. 68\n") + ErrorText(kDeviceNotAvailable);
  for (const auto& [off, on] :
       {std::pair{"cupsdisable", "cupsenable"}, std::pair{"cupsreject", "cupsaccept"}}) {
    ASSERT_TRUE(queue_->Run(off, {CupsQueue::kName}));
    dialogs_.said.clear();
    EXPECT_FALSE(PrintGolden(printer)) << off;
    ASSERT_TRUE(queue_->Run(on, {CupsQueue::kName}));
    ASSERT_EQ(dialogs_.said.size(), 1u) << off;
    EXPECT_EQ(dialogs_.said[0].title, "Chart Printing");
    EXPECT_EQ(dialogs_.said[0].text, told);
  }
  dialogs_.said.clear();
  EXPECT_TRUE(PrintGolden(printer)) << "it goes on where the queue does";
  EXPECT_FALSE(queue_->NextPdf(before).isEmpty());
  EXPECT_EQ(queue_->Done().size(), before.size() + 1);
}

TEST_F(PrintQueue, AQueueTakenAwayIsToldAndTheNextOneServes) {
  QtPrinter printer({});
  printer.SetDevice(CupsQueue::kName);
  EXPECT_GT(printer.Page().width, 0);
  ASSERT_TRUE(queue_->Run("lpadmin", {"-x", CupsQueue::kName}));
  EXPECT_FALSE(PrintGolden(printer));
  ASSERT_EQ(dialogs_.said.size(), 1u);
  EXPECT_EQ(dialogs_.said[0].text.substr(0, 35), "There is an unexpected error No. 68");
  EXPECT_EQ(ErrorOf([&] { QtPrinter({}).SetDevice(CupsQueue::kName); }), kDeviceNotAvailable);

  ASSERT_TRUE(queue_->AddQueue());
  const auto before = queue_->Done();
  EXPECT_TRUE(PrintGolden(printer));
  EXPECT_FALSE(queue_->NextPdf(before).isEmpty());
}

TEST_F(PrintQueue, ADroppedDocumentNeverReachesTheQueue) {
  QtPrinter printer({});
  printer.SetDevice(CupsQueue::kName);
  const auto before = queue_->Done();
  printer.StartDoc("Dropped");
  printer.FilledBox(0, 0, 5000, 5000, 0);
  printer.KillDoc();
  ASSERT_TRUE(PrintGolden(printer));
  EXPECT_FALSE(queue_->NextPdf(before).isEmpty());
  EXPECT_EQ(queue_->Done().size(), before.size() + 1);
}

TEST_F(PrintQueue, WithADefaultQueueItIsThePrinterInUse) {
  ASSERT_TRUE(queue_->Run("lpadmin", {"-d", CupsQueue::kName}));
  QtPrinter printer({});
  EXPECT_EQ(printer.DeviceName(), CupsQueue::kName);
  EXPECT_TRUE(printer.Exists());
}

}  // namespace
}  // namespace kora
