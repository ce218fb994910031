#pragma once

#include <QPointer>
#include <functional>

#include "chart/forms/PrintKora.h"
#include "chartwindow/chart_selection.h"
#include "chartwindow/forms/Anal.h"
#include "chartwindow/forms/Chts.h"
#include "chartwindow/forms/selection_form.h"
#include "indicators/forms/ChtDef.h"
#include "lists/text_print_out.h"
#include "looks/forms/look_services.h"
#include "platform/qt/qt_printer.h"
#include "shell/session.h"

class QDialog;
class QMdiArea;

namespace kora {

// What the forms of charting need of the main window and of the rooms beside them.
struct ChartDeskHooks {
  std::function<void()> readSettings;  // anew
  std::function<void()> menusBack;     // charting was left
  // The data destination paths over a form; true when another data folder was chosen.
  std::function<bool(QWidget* over)> openWMPath;
  std::function<std::string(const NameRec&)> VolumeUnitText;
  // The codes of the name file over the editor of chart lists.
  std::function<void(QWidget* over, std::function<void(const std::string& code)> select)> openCodes;
  // The company details of a code over a form, and whether there are any.
  std::function<void(const std::string& code, QWidget* over)> showStock = {};
  std::function<bool()> canShowStock = {};
};

// The forms of charting and what ties them together: the chart window, chart selection, and the
// dialogs that both open. It lives as long as the main window.
class ChartDesk {
 public:
  ChartDesk(Session& session, QWidget* over, QMdiArea* mdi, ChartDeskHooks hooks);

  // The chart window with chart selection over it; a window that stands comes to the front.
  void OpenCharts();
  // The chart at a place, from 1, of a chart list or of the whole name file; from there the window
  // pages through that list.
  void ShowChart(std::int16_t ChartListNo, std::int16_t place);
  // A saved chart by its DOS path, as the chart window's own menu shows it.
  void ShowSavedChart(const std::string& path);
  void OpenDefaults();       // ChtDef
  void OpenFonts();          // ChtFonts
  void OpenLists();          // SubList
  void OpenListUtilities();  // SubList2
  void OpenListNames();      // CLNames
  void OpenTextPage();       // CHTPage
  void OpenPrinterSetup();   // PrinterSetup
  // Asks how to print a list, and prints it.
  void PrintList(const TextTable& table, QWidget* over);

  Chts* window() const { return chts_; }
  // After other folders were chosen.
  void PathsChanged();
  // After prices were taken in, with which company details may have come.
  void PricesChanged();

 private:
  QWidget* Over() const;
  void OpenWindow();
  void StandWindow();
  void OpenSelection();
  void OpenSecondChart();
  void OpenView(int set);
  void CloseView();
  void OpenMultiOsc();
  void OpenTexts();
  void PrintView();
  size_t CountSecurities() const;  // 0 too where they can't be read
  bool AnySecurity();
  void WireWindow();
  void OfferStock();
  ChtSelServices SelectionServices();
  LookServices Look(std::function<void()> saved);
  void Refresh();
  void OpenChtDef(ChtDefOpener opener, const std::function<void()>& averagesChanged = {});
  void OpenOscFrm();
  float AskBoxValue(float computed);
  void OpenSwingSet();
  bool OpenFinDate();
  void OpenChtBands();
  void OpenChtSp();
  PrintServices Printing();
  void OpenPage();
  void PrintChart();

  Session& session_;
  QWidget* over_;
  QMdiArea* mdi_;
  ChartDeskHooks hooks_;
  ChartSelection selection_;
  QPointer<Chts> chts_;
  QPointer<Anal> anal_;
  QPointer<QDialog> selectionForm_, secondForm_;
  PrintChoice printChoice_;
  QtPrinter printer_;
  bool pageTurned_ = false;
  float boxValue_ = 0;  // of the point-and-figure chart, as its settings box left it
};

}  // namespace kora
