#pragma once

#include <QDialog>
#include <functional>

#include "indicators/swing_settings.h"
#include "platform/dialogs.h"

class QLineEdit;
class QRadioButton;

namespace kora {

struct SwingSetServices {
  Dialogs& dialogs;
  SwingChoice& choice;         // shown, and kept by OK
  std::function<void()> kept;  // after it was; may be empty
};

// "Swing": what a swing chart takes for a turn, and the days or points of it.
class SwingSet : public QDialog {
 public:
  SwingSet(SwingSetServices services, QWidget* parent);

 private:
  SwingKind Chosen() const;
  void ShowBoxes();
  void Save();

  SwingSetServices services_;
  QRadioButton* options_[4];
  QLineEdit *text1_, *text2_;  // days, points
};

}  // namespace kora
