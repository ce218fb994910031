#pragma once

#include <QDialog>
#include <functional>

#include "lists/forms/grid.h"
#include "lists/forms/work_panel.h"
#include "lists/text_print_out.h"
#include "maintenance/data_rows.h"
#include "settings/settings.h"
#include "store/name_rec.h"

class QMenuBar;

namespace kora {

struct DataFormServices {
  const Files& files;
  const Settings& settings;
  SettingsFile& user;  // keeps the column widths
  Dialogs& dialogs;
  std::function<void(const TextTable&, QWidget* over)> print = {};
  std::function<void(QWidget* over)> pageSetup = {};
  std::function<int(QWidget* over)> changeSize = {};  // asks for the size of tables, percent
  std::function<void()> saved = {};                   // the prices are others
};

// The security whose price file is shown.
struct DataFormFile {
  std::string code;
  std::string name;  // UTF-8, as the two others
  std::string path;
  std::int16_t RecType = kShare;
};

// A price file in a grid, to be corrected by hand.
class DataForm : public QDialog {
 public:
  DataForm(DataFormServices services, DataFormFile file, QWidget* parent);
  ~DataForm() override;

  // Reads the file; the last record is in hand. False, and told, when there is nothing to show.
  bool Fill();
  // Changes are saved or given up first, as the user answers. What goes on is stopped instead.
  void reject() override;

 private:
  void AddMenu();
  bool Save();
  void Sort();
  void AdjustData();
  void Print();
  void ShowCount();
  // Does the work with the bar on show. What it returns; false while other work goes on.
  bool Work(const QString& text, const std::function<bool(Progress&)>& work);

  DataFormServices services_;
  DataFormFile file_;
  DataRows rows_;
  Grid* ss1_;
  WorkPanel* panel_;
  QMenuBar* bar_;
};

}  // namespace kora
