#include "looks/forms/VHeight.h"

#include <QButtonGroup>
#include <QGridLayout>
#include <QLabel>
#include <QRadioButton>

#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

VHeight::VHeight(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("VHeight");
  setWindowTitle("Volume Height");
  auto* layout = new QVBoxLayout(this);
  layout->addWidget(NewNote(this, "Selects volume height display for your charts."));
  option1_ = new QButtonGroup(this);
  for (int height = 1; height <= 3; ++height) {
    auto* option = new QRadioButton(QString("Height &%1").arg(height), this);
    option->setObjectName(QString("Option1(%1)").arg(height - 1));
    option1_->addButton(option, height);
    layout->addWidget(option);
    if (height != services_.settings.charts.VolHeight) continue;
    option->setChecked(true);
    option->setFocus();
  }
  layout->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->AddOkCancel([this] { Save(); });
  layout->addLayout(buttons);
}

void VHeight::Save() {
  SaveVHeight(services_.ini, services_.settings, std::int16_t(option1_->checkedId()));
  accept();
  services_.Saved();
}

}  // namespace kora
