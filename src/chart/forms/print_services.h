#pragma once

#include <functional>
#include <string>

#include "chart/chart_printing.h"
#include "platform/dialogs.h"

namespace kora {

// What the forms of printing work on.
struct PrintServices {
  const Files& files;
  SettingsFile& ini;
  Dialogs& dialogs;
  Settings& settings;
  const ChartColours& colours;
  const PrinterColours& printerColours;
  Printer& printer;
};

inline constexpr std::string_view kNoPrinter = "There is no default printer.";
inline constexpr std::string_view kPrinterPage = "Printer Page";

}  // namespace kora
