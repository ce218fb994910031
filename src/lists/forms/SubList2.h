#pragma once

#include <QDialog>

#include "lists/forms/SubList.h"

class QLabel;

namespace kora {

// "Chart List Utilities": copies and moves between two lists.
class SubList2 : public QDialog {
 public:
  SubList2(ListFormServices services, QWidget* parent);

  void reject() override;

 protected:
  bool event(QEvent* event) override;

 private:
  void ListChosen(int side, int index);
  void ShowSide(int side);
  void Transfer(int from, bool move);
  void DeleteSelected(int side);
  void DeleteAll(int side);
  void CheckAll();
  void Edited();
  bool SaveSL(int side);
  // False when a changed list could not be saved.
  bool LeaveList(int side);
  std::string NameOf(int side) const;

  ListFormServices services_;
  QComboBox* combo1_[2];
  CodeList* list1_[2];
  QPushButton* save_;
  QLabel* state_;
  ListSide sides_[2];
  FileStamp stamps_[2];  // of the files that they were read from
  CodeNames names_;
};

}  // namespace kora
