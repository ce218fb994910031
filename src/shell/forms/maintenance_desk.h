#pragma once

#include <QPointer>
#include <functional>

#include "maintenance/forms/work_form.h"
#include "shell/session.h"

class QDialog;
class QWidget;

namespace kora {

// What the forms of maintenance need of the main window.
struct MaintenanceDeskHooks {
  std::function<void(const TextTable&, QWidget* over)> printTable;
  // Prices and names of the data folder may have changed.
  std::function<void()> changed;
  // Another data folder was chosen.
  std::function<void()> folderChanged;
};

// The forms that keep the data. Each holds the main window back while it is open. It lives as long
// as the main window.
class MaintenanceDesk {
 public:
  MaintenanceDesk(Session& session, QWidget* over, MaintenanceDeskHooks hooks)
      : session_(session), over_(over), hooks_(std::move(hooks)) {}

  void OpenEntry();       // DataEntry
  void OpenCodeChange();  // ASXChg
  void OpenMove();        // MoveFiles
  void OpenDataCheck();   // DataStat, RTypeCk
  void OpenNameCheck();   // NameData
  void OpenTotals();      // ADTotals
  void OpenBackup();      // ChartBak
  void OpenRestore();     // ChartBak
  void OpenCloses();      // TextData
  void OpenHistory();     // TextFull
  void OpenRemoveDate();  // RemDate

 private:
  MaintenanceServices Services() const;
  // Opens a form unless one is open; nothing where it has nothing to show, which it has told.
  template <typename Form, typename... Args>
  void Open(const std::function<bool(Form&)>& fill, Args... args);

  Session& session_;
  QWidget* over_;
  MaintenanceDeskHooks hooks_;
  QPointer<QDialog> form_;
};

}  // namespace kora
