#include "store/forms/PLW.h"

#include <QGridLayout>
#include <QLabel>
#include <QSpinBox>

#include "platform/qt/form_parts.h"
#include "store/look_settings.h"

namespace kora {

PLW::PLW(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("PLW");
  setWindowTitle("Line Width (Printing)");
  text1_ = new QSpinBox(this);
  text1_->setObjectName("Text1");
  text1_->setRange(kLeastLineWidth, kMostLineWidth);
  text1_->setValue(PrintedLineWidth(services_.settings));

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewNote(this, "Select a line width to be used on your PRINTED charts"), 0, 0,
                  1, 3);
  grid->addWidget(
      NewNote(this, "Chart Price, Averages, Volume, Oscillator and Bands only."), 1, 0, 1, 3);
  grid->addWidget(NewLabel(this, "&Line width", text1_), 2, 0);
  grid->addWidget(text1_, 2, 1);
  grid->setColumnStretch(2, 1);
  grid->setRowStretch(3, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&OK", [this] { Save(); });
  buttons->Add("Command2", "&Cancel", [this] { reject(); });
  grid->addLayout(buttons, 4, 0, 1, 3);
  text1_->setFocus();
  text1_->selectAll();
}

void PLW::Save() {
  SaveLineWidth(services_.ini, services_.settings, std::int16_t(text1_->value()));
  accept();
  services_.Saved();
}

}  // namespace kora
