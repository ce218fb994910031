#pragma once

#include <optional>

#include "maintenance/forms/work_form.h"
#include "maintenance/text_exports.h"

class QCheckBox;
class QRadioButton;

namespace kora {

// The two forms of a line in a text file, `Check1` and `Check2`, of which one is ticked.
class ExportFormBoxes {
 public:
  ExportFormBoxes(QDialog* form, QBoxLayout* rows, const char* commas, const char* columns);
  ExportForm form() const;
  QCheckBox *check1, *check2;
};

// "Create Text File of Closing Prices": all securities on one date.
class TextData : public WorkForm {
 public:
  TextData(MaintenanceServices services, QWidget* parent);

 private:
  void Create();

  QRadioButton *option1_, *option2_;
  QLineEdit* text1_;
  std::optional<ExportFormBoxes> boxes_;
};

}  // namespace kora
