#include "looks/forms/F1Size.h"

#include <QGridLayout>
#include <QLabel>
#include <QSpinBox>

#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

F1Size::F1Size(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("F1Size");
  setWindowTitle("Form Size");
  text1_ = NewNumber(this, "Text1", kLeastZoom, kMostZoom, services_.settings.Zoom);
  text1_->setSingleStep(10);
  text1_->setSuffix(" %");

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "&Size of text in tables", text1_), 0, 0);
  grid->addWidget(text1_, 0, 1);
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text1_);
}

void F1Size::Save() {
  SaveZoom(services_.ini, services_.settings, std::int16_t(text1_->value()));
  accept();
  services_.Saved();
}

}  // namespace kora
