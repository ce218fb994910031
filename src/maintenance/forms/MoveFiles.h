#pragma once

#include "maintenance/forms/work_form.h"

class QListWidget;

namespace kora {

class FolderPicker;

// "Move KORA Data Files": a price file taken from one data folder to another.
class MoveFiles : public WorkForm {
 public:
  MoveFiles(MaintenanceServices services, QWidget* parent);

 private:
  struct Side {
    FolderPicker* picker;
    QListWidget* file1;
    QLabel* folder;
  };
  Side AddSide(QBoxLayout* columns, const char* title, int index);
  void ShowFiles(const Side& side);
  void Move();

  Side source_, destination_;
};

}  // namespace kora
