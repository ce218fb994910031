#include "chart/forms/print_job.h"

#include <QCoreApplication>
#include <QPointer>

namespace kora {
namespace {

void PrintCopies(const PrintServices& s, const PrintChoice& choice, const PrintJob& job) {
  if (s.printer.Orientation() != s.settings.page.Orient)
    s.settings.page.Orient = s.printer.Orientation();
  const ChartPrintServices services{s.files,   s.dialogs, s.printer, s.settings.fonts,
                                    s.colours, job.swapCaption};
  const PrintSetup setup = PrintSetupFrom(s.settings, s.printerColours);
  for (int copy = 0; copy < choice.PrintCopies; ++copy)
    if (!PrintChart(services, setup, job.chart, job.scriptPath)) return;
}

}  // namespace

void AskAndPrint(const PrintServices& services, PrintChoice& choice, PrintJob job,
                 QWidget* parent) {
  std::int16_t& orient = services.settings.page.Orient;
  if (orient != kPortrait && orient != kLandscape) {
    orient = kPortrait;
    services.printer.SetOrientation(orient);
  }
  auto* form = new PrintKora(services, choice, parent);
  form->setAttribute(Qt::WA_DeleteOnClose);
  QObject::connect(form, &QDialog::finished, form, [services, &choice, job = std::move(job),
                                                      over = QPointer<QWidget>(parent)] {
    if (!choice.PrintCancelled) {
      // The question goes from the screen before the work begins. Where it asked about a file
      // it goes together with what it stood over, and the keyboard would be nobody's.
      if (over) over->activateWindow();
      QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
      PrintCopies(services, choice, job);
    }
    if (job.done) job.done();
  });
  form->open();
}

}  // namespace kora
