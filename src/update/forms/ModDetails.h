#pragma once

#include <QDialog>

#include "update/forms/update_form.h"

class QComboBox;
class QLabel;
class QLineEdit;
class QPushButton;

namespace kora {

// "Data Download Service Details": the service in use and where its files land.
class ModDetails : public QDialog {
 public:
  ModDetails(UpdateFormServices services, QWidget* parent);

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void ShowService();
  void ProposeFolder();
  bool CheckDivisor();
  void Save();

  UpdateFormServices services_;
  std::string format_;    // InternetDLfmt as it is to be stored
  bool changed_ = false;  // of Combo1, since it was last chosen from
  QComboBox *combo1_, *combo2_;
  QLineEdit *text1_, *text2_;
  QLabel *formatLabel_, *divisorLabel_;
  QPushButton* command1_;
};

}  // namespace kora
