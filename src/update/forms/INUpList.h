#pragma once

#include <QDialog>
#include <array>

#include "lists/forms/grid.h"
#include "update/download_settings.h"
#include "update/forms/update_form.h"
#include "update/master_list.h"

class QAction;
class QListWidget;
class QPushButton;
class QRadioButton;

namespace kora {

// "Download Update List": which securities an update takes.
class INUpList : public QDialog {
 public:
  INUpList(UpdateFormServices services, QWidget* parent);
  ~INUpList() override;

  // A changed list is saved on closing.
  void reject() override;

 private:
  void AddMenu();
  void LoadMaster();
  void AddRow(const UpdateRow& row);
  std::vector<UpdateRow> Rows() const;
  UpdateChoice Choice() const;
  void ShowChoice();
  void AddChecked();
  void Print();
  bool Save(QWidget* over);  // "Saved" shows over that window

  UpdateFormServices services_;
  TextGrid rows_;
  MasterList master_;
  std::array<QRadioButton*, 3> options_;
  Grid* ss1_;
  QListWidget* list1_;
  QPushButton* command1_;
  QAction *ulAdd_, *ulDel_;
  bool changed_ = false;
};

}  // namespace kora
