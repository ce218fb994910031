#pragma once

#include <QPointer>
#include <functional>

#include "chart/forms/PrintKora.h"
#include "chartwindow/chart_selection.h"
#include "chartwindow/forms/Chts.h"
#include "chartwindow/forms/selection_form.h"
#include "platform/qt/qt_printer.h"
#include "shell/session.h"
#include "store/forms/look_services.h"

class QDialog;
class QMdiArea;

namespace kora {

// The forms of charting and what ties them together: the chart window, chart selection, and the
// dialogs that both open. It lives as long as the main window.
class ChartDesk {
 public:
  // `readSettings` reads the settings anew; `menusBack` is called when charting was left.
  ChartDesk(Session& session, QWidget* over, QMdiArea* mdi, std::function<void()> readSettings,
            std::function<void()> menusBack);

  // The chart window with chart selection over it; a window that stands comes to the front.
  void OpenCharts();
  void OpenDefaults();       // ChtDef
  void OpenFonts();          // ChtFonts
  void OpenLists();          // SubList
  void OpenListUtilities();  // SubList2
  void OpenListNames();      // CLNames
  void OpenTextPage();       // CHTPage
  void OpenPrinterSetup();   // PrinterSetup

  Chts* window() const { return chts_; }
  // After other folders were chosen.
  void PathsChanged();

 private:
  QWidget* Over() const;
  void OpenWindow();
  void OpenSelection();
  void OpenSecondChart();
  void WireWindow();
  ChtSelServices SelectionServices();
  LookServices Look(std::function<void()> saved);
  void Refresh();
  void OpenChtDef(bool fromWindow, bool fromSelection);
  void OpenOscFrm();
  bool OpenFinDate();
  void OpenChtBands();
  void OpenChtSp();
  PrintServices Printing();
  void OpenPage();
  void PrintChart();

  Session& session_;
  QWidget* over_;
  QMdiArea* mdi_;
  std::function<void()> readSettings_, menusBack_;
  ChartSelection selection_;
  QPointer<Chts> chts_;
  QPointer<QDialog> selectionForm_, secondForm_;
  PrintChoice printChoice_;
  QtPrinter printer_;
  bool pageTurned_ = false;
  float boxValue_ = 0;  // of the point-and-figure chart, as its settings box left it
};

}  // namespace kora
