#pragma once

#include <QPointer>
#include <functional>

#include "scans/forms/scan_form.h"
#include "shell/session.h"

class QDialog;
class QWidget;

namespace kora {

// What the forms of the scans need of the main window and of charting.
struct ScanDeskHooks {
  std::function<void()> disableMenus, enableMenus;
  std::function<void(const TextTable&, QWidget* over)> printTable;
  std::function<void()> textPage;  // the page set-up of print-outs
  // The chart at a place of a chart list, from 1.
  std::function<void(std::int16_t ChartListNo, std::int16_t place)> showChart;
};

// The forms of the menu Chart Scans, each opened once. It lives as long as the main window.
class ScanDesk {
 public:
  ScanDesk(Session& session, QWidget* over, ScanDeskHooks hooks);

  void OpenScan1();  // chtScan1
  void OpenScan2();  // ChtScan2
  void OpenScan3();  // ChtScan3
  void OpenStats();  // Statistics
  // Another data folder was chosen: hits of the old one are no longer of use.
  void FolderChanged();

 private:
  template <typename Make>
  void Open(QPointer<QDialog>& form, Make make);
  ScanFormServices FormServices();

  Session& session_;
  QWidget* over_;
  ScanDeskHooks hooks_;
  bool scanning_ = false;
  QPointer<QDialog> scan1_, scan2_, scan3_, stats_;
};

}  // namespace kora
