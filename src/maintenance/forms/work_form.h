#pragma once

#include <QDialog>
#include <QElapsedTimer>
#include <functional>
#include <string>

#include "base/files.h"
#include "lists/forms/work_panel.h"
#include "lists/text_print_out.h"
#include "platform/dialogs.h"
#include "settings/settings.h"

class QBoxLayout;
class QGridLayout;
class QLabel;
class QLineEdit;

namespace kora {

// What the forms of maintenance work with.
struct MaintenanceServices {
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  // Prices or names of the data folder are other ones.
  std::function<void()> changed = {};
  // Another data folder was chosen for the whole program.
  std::function<void()> folderChanged = {};
  // Asks how to print a table and prints it. Without it the button is greyed.
  std::function<void(const TextTable&, QWidget* over)> print = {};
};

// What these forms have in common: a line that tells the stage and stays, the panel of long work,
// and what is told behind them.
class WorkForm : public QDialog {
 public:
  ~WorkForm() override;
  // Close. While work goes on it is stopped instead, and the form stays.
  void reject() override;
  void done(int result) override;

 protected:
  WorkForm(MaintenanceServices services, QWidget* parent);

  // The line of the stage, by its name; call once.
  QLabel* AddState(QBoxLayout* rows, const char* name);
  // The panel under what there is; call once. Widgets to be held are told to panel_.
  void AddPanel(QBoxLayout* rows);
  // Does long work with the panel, or short work without one. The pointer is busy meanwhile.
  void Run(const std::function<void(Progress&)>& work);
  // What the work tells besides its stage, and its steps; some times a second.
  virtual void Told(ProgressLine, const std::string&) {}
  virtual void Stepped(int /*done*/, int /*total*/) {}

  // The prices on show elsewhere are told once the form goes.
  void SetChanged() { changed_ = true; }
  const std::string& dataPath() const { return services_.settings.paths.CurrentDataPath; }

  MaintenanceServices services_;
  QLabel* state_ = nullptr;
  WorkPanel* panel_ = nullptr;

 private:
  class Shown;
  bool changed_ = false;
};

// A box that is shown and can be copied from, not typed into.
QLineEdit* NewShown(QWidget* form, const char* name, int columns);

// Two arrows that step through the name file: up to the next security, down to the one before.
QWidget* NewStepper(QWidget* form, const QString& name, std::function<void(int by)> step);

}  // namespace kora
