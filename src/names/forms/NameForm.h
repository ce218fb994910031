#pragma once

#include <QDialog>
#include <functional>
#include <memory>

#include "lists/forms/grid.h"
#include "names/name_editor.h"
#include "platform/clock.h"

namespace kora {

struct NameFormServices {
  const Files& files;
  Settings& settings;
  SettingsFile& ini;
  SettingsFile& user;  // keeps the column widths
  Dialogs& dialogs;
  const Clock& clock;
  std::function<void(const TextTable&, QWidget* over)> print = {};
  std::function<void(QWidget* over)> pageSetup = {};
  std::function<void()> saved = {};  // the name file is another one
};

// The name file in a grid.
class NameForm : public QDialog {
 public:
  NameForm(NameFormServices services, QWidget* parent);
  ~NameForm() override;

  // Reads the file. False, and told, when it can't be read.
  bool Fill();
  // Changes are saved or given up first, as the user answers.
  void reject() override;

 private:
  class Source;

  void AddMenu();
  bool Save();
  void Sort(NameSort mode);
  void Update(const std::function<void()>& work);
  void UpdateFromMasterList();
  void Print();
  void ShowCount();

  NameFormServices services_;
  NameEditor editor_;
  std::unique_ptr<Source> source_;
  Grid* ss1_;
};

}  // namespace kora
