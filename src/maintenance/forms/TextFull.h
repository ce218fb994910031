#pragma once

#include <optional>

#include "maintenance/forms/TextData.h"
#include "store/name_file.h"

namespace kora {

// "Create Text File of Closing Prices" of one security, all dates.
class TextFull : public WorkForm {
 public:
  TextFull(MaintenanceServices services, QWidget* parent);

  // Shows the first security. False, and told, where the name file can't be read or has none.
  bool Fill();

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void Show(size_t place);
  void Step(int by);
  bool FindTyped();
  void Create();

  std::vector<NameRec> names_;
  size_t place_ = 0;
  QLineEdit *text7_, *text8_;
  QLabel* label3_;
  std::optional<ExportFormBoxes> boxes_;
};

}  // namespace kora
