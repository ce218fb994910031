#pragma once

#include "maintenance/forms/work_form.h"

class QPushButton;
class QRadioButton;

namespace kora {

// "Remove Specific Date": one date taken out of every price file of a folder, which becomes the
// data folder of the program.
class RemDate : public WorkForm {
 public:
  RemDate(MaintenanceServices services, QWidget* parent);

 private:
  void Remove();
  void ChooseFolder();

  QLineEdit *text1_, *text2_;
  QRadioButton* option1_[2];
  QPushButton* command2_;
};

}  // namespace kora
