#pragma once

#include <QDialog>
#include <array>
#include <functional>

#include "update/master_list.h"

class QCheckBox;

namespace kora {

// "Update Name File from KORA Master List": which items keep what they have.
class ExMaster : public QDialog {
 public:
  explicit ExMaster(QWidget* parent);

  KeepTicks ticks() const;
  // Does the update; the form closes when it says that it was done.
  std::function<bool()> start = {};

 private:
  std::array<QCheckBox*, 5> check1_;
};

}  // namespace kora
