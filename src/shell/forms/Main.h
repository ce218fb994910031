#pragma once

#include <QMainWindow>
#include <QPointer>
#include <functional>
#include <map>
#include <string>

#include "settings/forms/CPath.h"
#include "shell/forms/adjust_desk.h"
#include "shell/forms/chart_desk.h"
#include "shell/forms/company_desk.h"
#include "shell/forms/data_desk.h"
#include "shell/forms/maintenance_desk.h"
#include "shell/forms/name_desk.h"
#include "shell/forms/scan_desk.h"
#include "shell/forms/update_desk.h"
#include "shell/session.h"

class QKeyEvent;
class QMdiArea;

namespace kora {

class HelpWindow;

// The main window: a frame with the menu, over the windows of the work.
class Main : public QMainWindow {
 public:
  // `commandLine`: the words the program was started with, for reading the settings again.
  Main(Session& session, std::string commandLine);
  ~Main() override;

  // What an entry does. An entry without it is there and greyed.
  void SetOpener(const std::string& entry, std::function<void()> open);

  // While a long task runs the menus of the work are off.
  void DisableMenus();
  void EnableMenus();

  void PathsChanged();
  // The folder form, asking first where the paths are missing. False when the program ends
  // instead.
  bool OpenPaths();
  // The list of waiting downloads, to take them in.
  void OpenUpdate() { updates_.OpenUpdate(); }
  // The chart window with a saved chart, a file of the host.
  void OpenSavedChart(const std::string& hostPath);

  Chts* charts() const { return desk_.window(); }

 protected:
  void closeEvent(QCloseEvent* event) override;
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void BuildMenu();
  void SetOpeners();
  void Open(const std::string& entry);
  void TakeSize();
  void KeepSize();
  void OpenHelp();
  void OpenHelpAt(const QString& page);
  bool TakeKey(const QKeyEvent& key);
  // Runs a program of the program folder and waits for its end, without limit. False when the
  // main window was closed meanwhile.
  bool RunSibling(const std::string& program);
  // The sibling program where it is installed, otherwise the form of the program's own.
  void OpenSnapshot();
  // A download program, then the list of what it left.
  void Download(const std::string& program);
  void FolderChanged();
  void AskPrinter();
  int AskTableSize(QWidget* over);  // percent
  void EndProgram();

  Session& session_;
  std::string commandLine_;
  QMdiArea* mdi_;
  UpdateDesk updates_;
  ChartDesk desk_;
  AdjustDesk adjust_;
  DataDesk data_;
  NameDesk names_;
  CompanyDesk companies_;
  ScanDesk scans_;
  MaintenanceDesk maintenance_;
  QPointer<CPath> cpath_;
  QPointer<HelpWindow> help_;
  std::map<std::string, std::function<void()>> openers_;
  QSize mdiSize_;
  bool closed_ = false;
};

}  // namespace kora
