#pragma once

#include <QDialog>
#include <optional>

#include "maintenance/data_rows.h"

class QCheckBox;
class QLabel;
class QPushButton;
class QRadioButton;

namespace kora {

// "Data Modification": multiplies or divides what is selected in the grid of `DataForm`.
class VolMod : public QDialog {
 public:
  // The form is accepted when the rows were changed.
  VolMod(DataRows& rows, RowBlock selected, Dialogs& dialogs, QWidget* parent);

 private:
  ScaleItems Items() const;
  std::optional<ScaleBy> By() const;
  void Process();

  DataRows& rows_;
  RowBlock selected_;
  Dialogs& dialogs_;
  QCheckBox* check1_[5];
  QRadioButton* option1_[4];
  QLabel* text_;
};

}  // namespace kora
