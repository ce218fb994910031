#pragma once

#include "maintenance/forms/work_form.h"

class QPushButton;

namespace kora {

// "Name File - Data Files Check": names without price files, and price files without names.
class NameData : public WorkForm {
 public:
  NameData(MaintenanceServices services, QWidget* parent);

 protected:
  void Told(ProgressLine line, const std::string& text) override;

 private:
  void Check();

  QLabel* label2_;
};

}  // namespace kora
