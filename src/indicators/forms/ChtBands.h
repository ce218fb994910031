#pragma once

#include <QDialog>
#include <functional>

#include "indicators/overlay_settings.h"
#include "platform/dialogs.h"

class QLineEdit;

namespace kora {

struct ChtBandsServices {
  const Files& files;
  const std::string& dataPath;
  Dialogs& dialogs;
  CurrentName& current;         // the security whose record is written
  std::function<void()> saved;  // may be empty
};

// "Percentage Bands" or "Bollinger Bands": the band values of the current security.
class ChtBands : public QDialog {
 public:
  ChtBands(ChtBandsServices services, BandForm form, QWidget* parent);

 private:
  void Save();

  ChtBandsServices services_;
  BandForm form_;
  QLineEdit* text_[2];
};

}  // namespace kora
