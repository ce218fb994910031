#pragma once

#include <QDialog>
#include <array>

#include "update/forms/update_form.h"

class QCheckBox;
class QLineEdit;

namespace kora {

// "Download Data Settings": what the user receives, and a folder for each kind.
class DLWizard : public QDialog {
 public:
  DLWizard(UpdateFormServices services, QWidget* parent);

 private:
  void Save();

  UpdateFormServices services_;
  std::array<QCheckBox*, 6> checks_;
  std::array<QLineEdit*, 6> texts_;
};

}  // namespace kora
