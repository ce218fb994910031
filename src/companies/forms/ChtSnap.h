#pragma once

#include <QDialog>
#include <memory>

#include "companies/snapshot.h"
#include "lists/forms/grid.h"
#include "lists/forms/work_panel.h"

class QComboBox;
class QLabel;
class QTabWidget;

namespace kora {

struct ChtSnapServices {
  SnapshotServices snapshot;
  Settings& settings;
  SettingsFile& user;
  std::function<void(const TextTable&, QWidget* over)> print = {};
  std::function<void(QWidget* over)> pageSetup = {};
  std::function<int(QWidget* over)> changeSize = {};
};

// "Current Snapshot": up to 15 securities with today's prices, and what is held of them.
class ChtSnap : public QDialog {
 public:
  ChtSnap(ChtSnapServices services, QWidget* parent);
  ~ChtSnap() override;

  void reject() override;

 private:
  class Prices;
  class Holdings;

  Grid* MakeGrid(GridSource& source, std::vector<GridColumn> columns, const char* key,
                 const char* name);
  void AddMenu();
  void ChooseList(int list);
  FileStamp StampOf(int list) const;
  // Asks where another program changed the list since it was shown.
  bool Save();
  bool AskToSave();  // false: the user stays
  void Add();
  void MoveTo(int list);
  void Fetch();
  void Print();
  void Changed();
  void ShowState();
  Grid* Front() const;

  ChtSnapServices services_;
  std::vector<SnapshotRow> rows_;
  std::unique_ptr<Prices> prices_;
  std::unique_ptr<Holdings> holdings_;
  QComboBox* combo1_;
  QTabWidget* sheets_;
  Grid *ss1_, *ss2_;
  QLabel *label1_, *label2_;
  WorkPanel* panel_;
  int list_ = 1;
  FileStamp stamp_;  // of the list as it was read
  bool changed_ = false;
};

}  // namespace kora
