#include "shell/forms/help_pages.h"

#include <QHash>

namespace kora {
namespace {

constexpr const char* kFirstPage = "index.html";

const QHash<QString, QString>& Pages() {
  static const QHash<QString, QString> pages{
      {"Main", "start.html"},
      {"FirstStart", "start.html"},
      {"CPath", "folders.html"},
      {"Locate", "folders.html"},
      {"Chts", "charts.html"},
      {"Chart2", "charts.html"},
      {"SaveKora", "charts.html"},
      {"ChtSel", "selecting.html"},
      {"ChtOptions", "selecting.html"},
      {"Search", "selecting.html"},
      {"FinDate", "selecting.html"},
      {"KoraScroll", "zoom.html"},
      {"ZoomKora", "zoom.html"},
      {"Anal", "oscillators.html"},
      {"ChtBands", "oscillators.html"},
      {"ChtDef", "oscillators.html"},
      {"MMASet", "oscillators.html"},
      {"MultiOsc", "oscillators.html"},
      {"OscFrm", "oscillators.html"},
      {"StpLs", "oscillators.html"},
      {"SwingSet", "turns.html"},
      {"BlankSpc", "looks.html"},
      {"ChtFonts", "looks.html"},
      {"ChtSp", "looks.html"},
      {"ColNew", "looks.html"},
      {"GLSpaces", "looks.html"},
      {"PLW", "looks.html"},
      {"Scales", "looks.html"},
      {"VHeight", "looks.html"},
      {"F1Size", "tables.html"},
      {"Adjust", "adjust.html"},
      {"AdjustB", "adjust.html"},
      {"AdjustC", "adjust.html"},
      {"AdjustCC", "adjust.html"},
      {"AdjustD", "adjust.html"},
      {"AdjustR", "adjust.html"},
      {"AdjustSS", "adjust.html"},
      {"AdjDate", "adjustments.html"},
      {"AdjList", "adjustments.html"},
      {"AdjOpts", "adjustments.html"},
      {"ExMaster", "names.html"},
      {"NameForm", "names.html"},
      {"ChtSnap", "companies.html"},
      {"Fundmnt", "companies.html"},
      {"StockInf", "companies.html"},
      {"chtScan1", "scans.html"},
      {"ChtScan2", "scans.html"},
      {"ChtScan3", "scans.html"},
      {"Statistics", "scans.html"},
      {"CLNames", "lists.html"},
      {"SubList", "lists.html"},
      {"SubList2", "lists.html"},
      {"IndClass", "lists.html"},
      {"CHTPage", "printing.html"},
      {"Page", "printing.html"},
      {"PrintKora", "printing.html"},
      {"PrinterSetup", "printing.html"},
      {"DLList", "update.html"},
      {"DLWizard", "update.html"},
      {"INUpList", "update.html"},
      {"ModDetails", "update.html"},
      {"WMPath", "update.html"},
      {"EnterCode", "data.html"},
      {"DataForm", "data.html"},
      {"VolMod", "data.html"},
      {"ADTotals", "maintenance.html"},
      {"ASXChg", "maintenance.html"},
      {"ChartBak", "maintenance.html"},
      {"DataEntry", "maintenance.html"},
      {"DataStat", "maintenance.html"},
      {"MoveFiles", "maintenance.html"},
      {"NameData", "maintenance.html"},
      {"RTypeCk", "maintenance.html"},
      {"RemDate", "maintenance.html"},
      {"TextData", "maintenance.html"},
      {"TextFull", "maintenance.html"},
      {"TxtData", "maintenance.html"},
  };
  return pages;
}

}  // namespace

QString HelpPageOf(const QString& form) { return Pages().value(form, kFirstPage); }

bool HasHelpPage(const QString& form) { return HelpPageOf(form) != kFirstPage; }

QStringList FormsOfTheGuide() {
  QStringList forms = Pages().keys();
  forms.sort();
  return forms;
}

}  // namespace kora
