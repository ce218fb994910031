#pragma once

#include <QDialog>
#include <array>

#include "update/download_settings.h"
#include "update/forms/update_form.h"
#include "update/master_list.h"

class QAction;
class QListWidget;
class QPushButton;
class QRadioButton;
class QTableWidget;

namespace kora {

// "Saved", closed by its timer.
class RecSav : public QDialog {
 public:
  explicit RecSav(QWidget* parent);
};

// "Download Update List": which securities an update takes.
class INUpList : public QDialog {
 public:
  INUpList(UpdateFormServices services, QWidget* parent);

  // A changed list is saved on closing.
  void reject() override;

 private:
  void AddMenu();
  void LoadMaster();
  void AddRow(const UpdateRow& row);
  void SetRow(int at, const UpdateRow& row);
  std::vector<UpdateRow> Rows() const;
  UpdateChoice Choice() const;
  void ShowChoice();
  void AddChecked();
  void DeleteRows();
  void Print();
  void EndEditing();
  bool Save(QWidget* over);  // "Saved" shows over that window

  UpdateFormServices services_;
  MasterList master_;
  std::array<QRadioButton*, 3> options_;
  QTableWidget* ss1_;
  QListWidget* list1_;
  QPushButton* command1_;
  QAction *ulAdd_, *ulDel_;
  bool loading_ = true;
  bool changed_ = false;
};

}  // namespace kora
