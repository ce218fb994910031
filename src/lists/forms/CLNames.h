#pragma once

#include "lists/forms/SubList.h"

namespace kora {

// "Rename Chart Lists": the names of the ten user lists.
class CLNames : public QDialog {
 public:
  CLNames(ListFormServices services, QWidget* parent);

  void reject() override;

 private:
  bool Save();

  ListFormServices services_;
  QLineEdit* text1_[kUserLists];
  bool changed_ = false;
};

}  // namespace kora
