#pragma once

#include <QDialog>
#include <array>

#include "update/forms/update_form.h"

class QLineEdit;
class QRadioButton;

namespace kora {

// "Data Destination Paths": the folders of the whole market, and which one charts come from.
class WMPath : public QDialog {
 public:
  WMPath(UpdateFormServices services, QWidget* parent);

 private:
  void Choose(int index);
  void Save();

  UpdateFormServices services_;
  std::array<QLineEdit*, 6> texts_;
  std::array<QRadioButton*, 6> options_;
  bool waiting_ = false;  // a folder was chosen that is not filled in yet
};

}  // namespace kora
