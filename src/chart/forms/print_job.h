#pragma once

#include "chart/forms/PrintKora.h"
#include "lists/text_print_out.h"

namespace kora {

struct PrintJob {
  ChartSize chart;
  std::string scriptPath;  // TCht.Tmp, or the saved chart on show
  std::function<std::string(const std::string&)> swapCaption;  // as in ChartPrintServices
  std::function<void()> done;                                  // printed, failed or cancelled
};

// What the menu entry "Print Chart" does: an orientation that was never chosen becomes portrait;
// PrintKora is asked; the orientation follows the printer; and the chart is printed once a copy,
// until one fails. Returns while the question is open; `choice` and what the services name must
// live until `done`.
void AskAndPrint(const PrintServices& services, PrintChoice& choice, PrintJob job, QWidget* parent);

// The same for a list: asked, then printed once a copy. What fails is told, and ends it.
void AskAndPrintTable(const PrintServices& services, PrintChoice& choice, TextTable table,
                      QWidget* parent);

}  // namespace kora
