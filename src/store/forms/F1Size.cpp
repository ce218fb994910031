#include "store/forms/F1Size.h"

#include <QGridLayout>
#include <QLabel>
#include <QSpinBox>

#include "platform/qt/form_parts.h"
#include "store/look_settings.h"

namespace kora {

F1Size::F1Size(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("F1Size");
  setWindowTitle("Form Size");
  text1_ = new QSpinBox(this);
  text1_->setObjectName("Text1");
  text1_->setRange(kLeastZoom, kMostZoom);
  text1_->setSingleStep(10);
  text1_->setSuffix(" %");
  text1_->setValue(services_.settings.Zoom);

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "&Size of text in tables", text1_), 0, 0);
  grid->addWidget(text1_, 0, 1);
  grid->setColumnStretch(2, 1);
  grid->setRowStretch(1, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&OK", [this] { Save(); });
  buttons->Add("Command2", "&Cancel", [this] { reject(); });
  grid->addLayout(buttons, 2, 0, 1, 3);
  text1_->setFocus();
  text1_->selectAll();
}

void F1Size::Save() {
  SaveZoom(services_.ini, services_.settings, std::int16_t(text1_->value()));
  accept();
  services_.Saved();
}

}  // namespace kora
