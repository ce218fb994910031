#pragma once

#include "maintenance/forms/work_form.h"

class QListWidget;

namespace kora {

// "Check Advance/Decline Totals": running totals worked out anew from a base.
class ADTotals : public WorkForm {
 public:
  ADTotals(MaintenanceServices services, QWidget* parent);

  // False, and told, where there are no series of that kind.
  bool Fill();

 private:
  void Check();

  QListWidget* list1_;
  QLineEdit* text1_;
};

}  // namespace kora
