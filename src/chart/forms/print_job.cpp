#include "chart/forms/print_job.h"

#include <QCoreApplication>
#include <QPointer>

#include "base/runtime_error.h"
#include "platform/qt/qt_printer.h"

namespace kora {
namespace {

// A page that came out of a printer is seen; a file must be found.
void TellWhere(const PrintServices& s, const PrintChoice& choice, const char* title) {
  if (s.printer.DeviceName() == QtPrinter::kPdfPrinter)
    s.dialogs.Message("Saved in " + s.files.HostPath(choice.pdfFile), title);
}

void PrintCopies(const PrintServices& s, const PrintChoice& choice, const PrintJob& job) {
  if (s.printer.Orientation() != s.settings.page.Orient)
    s.settings.page.Orient = s.printer.Orientation();
  const ChartPrintServices services{s.files,          s.dialogs, s.printer,
                                    s.settings.fonts, s.colours, job.swapCaption};
  const PrintSetup setup = PrintSetupFrom(s.settings, s.printerColours);
  for (int copy = 0; copy < choice.PrintCopies; ++copy)
    if (!PrintChart(services, setup, job.chart, job.scriptPath)) return;
  TellWhere(s, choice, "Print Chart");
}

// Asks, and goes on with `print` unless it was cancelled, then with `done`.
void Ask(const PrintServices& services, PrintChoice& choice, QWidget* parent, const QString& title,
         std::int16_t side, std::function<void()> print, std::function<void()> done = {}) {
  std::int16_t& orient = services.settings.page.Orient;
  if (orient != kPortrait && orient != kLandscape) {
    orient = side;
    services.printer.SetOrientation(orient);
  }
  auto* form = new PrintKora(services, choice, parent);
  form->setWindowTitle(title);
  form->setAttribute(Qt::WA_DeleteOnClose);
  QObject::connect(
      form, &QDialog::finished, form,
      [&choice, print = std::move(print), done = std::move(done),
       over = QPointer<QWidget>(parent)] {
        if (!choice.PrintCancelled) {
          // The question goes from the screen before the work begins. Where it asked about a file
          // it goes together with what it stood over, and the keyboard would be nobody's.
          if (over) over->activateWindow();
          QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
          print();
        }
        if (done) done();
      });
  form->open();
}

}  // namespace

void AskAndPrint(const PrintServices& services, PrintChoice& choice, PrintJob job,
                 QWidget* parent) {
  const auto done = job.done;
  const std::int16_t side = services.settings.charts.FitSide ? BetterSide(job.chart) : kPortrait;
  Ask(
      services, choice, parent, "Print Chart", side,
      [services, &choice, job = std::move(job)] { PrintCopies(services, choice, job); }, done);
}

void AskAndPrintTable(const PrintServices& services, PrintChoice& choice, TextTable table,
                      QWidget* parent) {
  Ask(services, choice, parent, "Print List", kPortrait,
      [services, &choice, table = std::move(table)] {
        try {
          for (int copy = 0; copy < choice.PrintCopies; ++copy)
            PrintTable(services.printer, services.settings.fonts, services.settings.page, table);
          TellWhere(services, choice, "Print List");
        } catch (const RunTimeError& e) {
          services.dialogs.Message(std::string("There is an unexpected error - ") + e.what(),
                                   "Error");
        }
      });
}

}  // namespace kora
