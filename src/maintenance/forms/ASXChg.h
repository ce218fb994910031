#pragma once

#include "maintenance/forms/work_form.h"

namespace kora {

// "Code Changed - Combine Files": the price file and the name of a security whose code has changed.
class ASXChg : public WorkForm {
 public:
  ASXChg(MaintenanceServices services, QWidget* parent);

 private:
  void Change();

  QLineEdit *text1_, *text2_;
};

}  // namespace kora
