#pragma once

#include <QDialog>
#include <functional>
#include <memory>
#include <string>

#include "adjust/make_adjustments.h"
#include "lists/forms/grid.h"
#include "lists/forms/work_panel.h"
#include "lists/text_print_out.h"

class QMenuBar;

namespace kora {

struct AdjListServices {
  const Files& files;
  Settings& settings;
  SettingsFile& ini;
  SettingsFile& user;  // keeps the column widths
  Dialogs& dialogs;
  std::int32_t noteColour = 0;
  std::function<void(const TextTable&, QWidget* over)> print = {};
  std::function<void(QWidget* over)> pageSetup = {};
  std::function<int(QWidget* over)> changeSize = {};  // asks for the size of tables, percent
  std::function<void()> adjusted = {};                // prices and names changed
};

// The adjustment list: what bulletins told, to be looked over and carried out.
class AdjList : public QDialog {
 public:
  AdjList(AdjListServices services, QWidget* parent);
  ~AdjList() override;

  // Reads the list. False, and told, when folders of the whole market are missing or it can't be
  // read.
  bool Fill();
  // Changes are saved and the list is carried out first, or not, as the user answers. While the
  // list is being carried out it stops that, and the form stays.
  void reject() override;

 private:
  class Source;

  void AddMenu();
  bool Save();
  bool MayReplace();
  void Change(const std::function<void()>& work);
  void Sort();
  void RemoveMarked();
  void Make();
  void Print();
  void ShowColumns();
  void ShowRows();
  // Runs `work`; what fails is told. False then.
  bool Tell(const std::function<void()>& work);

  AdjListServices services_;
  std::string folder_;
  AdjustRows rows_;
  FileStamp stamp_;  // of the file as it was read
  std::unique_ptr<Source> source_;
  Grid* ss1_;
  WorkPanel* panel_;
  QMenuBar* bar_;
  bool changed_ = false;
  bool made_ = false;
};

}  // namespace kora
