#pragma once

#include <QDialog>
#include <functional>
#include <string>

#include "platform/dialogs.h"

class QLineEdit;

namespace kora {

struct FinDateServices {
  Dialogs& dialogs;
  std::string& FinishDate;  // "yyyymmdd", empty when none was chosen yet
  bool& FinishDateOn;
  std::function<void()> saved;  // may be empty
};

// The date at which charts end. Cancel leaves both values as they were.
class FinDate : public QDialog {
 public:
  FinDate(FinDateServices services, QWidget* parent);

 private:
  void Save();

  FinDateServices services_;
  QLineEdit* text1_;
};

}  // namespace kora
