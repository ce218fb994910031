#pragma once

#include <QDialog>
#include <functional>

#include "platform/dialogs.h"
#include "store/name_file.h"

class QLineEdit;

namespace kora {

struct ScalesServices {
  const Files& files;
  const std::string& dataPath;
  Dialogs& dialogs;
  CurrentName& current;         // the security whose record is written
  std::function<void()> saved;  // may be empty
};

// The manual scale and point-and-figure box of the current security.
class Scales : public QDialog {
 public:
  Scales(ScalesServices services, QWidget* parent);

 private:
  void Save();

  ScalesServices services_;
  QLineEdit* text_[3];
};

}  // namespace kora
