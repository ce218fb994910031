#pragma once

#include <QDialog>
#include <array>

class QCheckBox;

namespace kora {

class Dialogs;

// "Record Types to Check": accepted with at least one kind of data ticked.
class RTypeCk : public QDialog {
 public:
  RTypeCk(Dialogs& dialogs, QWidget* parent);

  // By RecType, as the plan of a check has them.
  std::array<bool, 6> types() const;
  void accept() override;

 private:
  Dialogs& dialogs_;
  std::array<QCheckBox*, 4> checks_;
};

}  // namespace kora
