#pragma once

#include <QDialog>
#include <QElapsedTimer>
#include <functional>
#include <initializer_list>
#include <string>
#include <vector>

#include "lists/forms/grid.h"
#include "lists/forms/work_panel.h"
#include "scans/result_list.h"
#include "scans/scan_filter.h"
#include "settings/settings.h"
#include "store/market_walk.h"

class QCheckBox;
class QGridLayout;
class QHBoxLayout;
class QLineEdit;
class QPushButton;

namespace kora {

// What the forms of the scans work with.
struct ScanFormServices {
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  SettingsFile& user;  // the per-user store
  // One scan at a time: shared by all forms.
  bool& scanning;
  std::function<void()> disableMenus = {}, enableMenus = {};
  // Asks how to print a table and prints it. Without it the button is greyed.
  std::function<void(const TextTable&, QWidget* over)> print = {};
  std::function<void()> pageSetup = {};
  // Shows the chart at this place, from 1, of the list of results.
  std::function<void(std::int16_t place)> openResult = {};
  // Shows the chart of a record of the name file.
  std::function<void(std::int32_t record)> openRecord = {};
};

// What the forms of the scans have in common: criteria above, the hits in a grid, progress below
// it, and the buttons.
class ScanForm : public QDialog {
 public:
  ~ScanForm() override;

  // Close. While a scan runs it is stopped instead, and the form stays.
  void reject() override;

 protected:
  ScanForm(ScanFormServices services, QWidget* parent);

  // A tick box with its fields behind it, which are live while it is ticked: a row of `grid`.
  QCheckBox* AddCheck(QGridLayout* grid, int row, const QString& name, const QString& caption,
                      bool ticked, std::initializer_list<QWidget*> fields = {});
  QLineEdit* NewText(const QString& name, const QString& about, const std::string& text,
                     int columns = 7);
  // Grid, progress and buttons under `criteria`; call once. `widthsKey`: where its column widths
  // are kept, empty for nowhere.
  void LayOut(QWidget* criteria, const char* gridName, std::vector<GridColumn> columns,
              const std::string& widthsKey, GridSource& rows);

  // Runs a scan, unless one is running: told then. What it raises is told under `title`.
  void RunScan(const QString& title, const std::function<void(Progress&)>& scan);
  // The rows changed; shown at once, or at the next chance while they come quickly.
  void RowAdded();
  // Shows what stands against the choices and leads to its control.
  void Tell(const ScanFault& fault);
  // What is told at the end, with the count of unread files on a line of its own.
  void TellEnd(std::string_view title, std::string text, const UnreadFiles& unread);
  // Asks whether the hits of a stopped scan go to the list of results.
  bool AskStopped(std::string_view title);
  // Stores by `save`; a failure is told, and false.
  bool Store(std::string_view title, const std::function<void()>& save);
  ScanRun Scan(Progress& progress) const;
  const std::string& dataPath() const { return services_.settings.paths.CurrentDataPath; }

  virtual void Proceed() = 0;
  virtual void PrintHits() = 0;
  // Before the form goes: what is kept of it. False: it stays.
  virtual bool Leave() { return true; }
  // Enter or a double click on a row of the grid.
  virtual void OpenRow(int row) = 0;

  ScanFormServices services_;
  Grid* grid_ = nullptr;
  WorkPanel* panel_ = nullptr;
  QPushButton *command1_ = nullptr, *command2_ = nullptr, *command3_ = nullptr;

 private:
  void AddToTabOrder(QWidget* widget);

  QElapsedTimer refreshed_;
  QWidget* lastInTabOrder_ = nullptr;
};

}  // namespace kora
