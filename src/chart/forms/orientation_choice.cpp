#include "chart/forms/orientation_choice.h"

#include <QRadioButton>
#include <QVBoxLayout>

#include "base/runtime_error.h"

namespace kora {

OrientationChoice::OrientationChoice(QWidget* form, Printer& printer, Dialogs& dialogs,
                                     std::function<void()> changed)
    : QGroupBox("Orientation", form),
      printer_(printer),
      dialogs_(dialogs),
      changed_(std::move(changed)),
      portrait_(new QRadioButton("Por&trait", this)),
      landscape_(new QRadioButton("&Landscape", this)) {
  portrait_->setObjectName("Option1(0)");
  landscape_->setObjectName("Option1(1)");
  auto* column = new QVBoxLayout(this);
  column->addWidget(portrait_);
  column->addWidget(landscape_);
  Show();
  connect(portrait_, &QRadioButton::clicked, this, [this] { Pressed(kPortrait); });
  connect(landscape_, &QRadioButton::clicked, this, [this] { Pressed(kLandscape); });
}

void OrientationChoice::Show() {
  (printer_.Orientation() == kLandscape ? landscape_ : portrait_)->setChecked(true);
}

void OrientationChoice::Pressed(std::int16_t orientation) {
  if (orientation == printer_.Orientation()) return;
  if (!printer_.Exists()) {
    Show();
    dialogs_.Message("There is no default printer. Cannot change orientation.", "Printer Page");
    return;
  }
  try {
    printer_.SetOrientation(orientation);
  } catch (const RunTimeError& e) {
    Show();
    dialogs_.Message(std::string("There is an unexpected error - ") + e.what(), "Error");
    return;
  }
  changed_();
}

}  // namespace kora
