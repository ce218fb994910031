#include "looks/forms/PLW.h"

#include <QGridLayout>
#include <QLabel>
#include <QSpinBox>

#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

PLW::PLW(LookServices services, QWidget* parent) : QDialog(parent), services_(std::move(services)) {
  setObjectName("PLW");
  setWindowTitle("Line Width (Printing)");
  text1_ = NewNumber(this, "Text1", kLeastLineWidth, kMostLineWidth,
                     PrintedLineWidth(services_.settings));

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewNote(this, "Select a line width to be used on your PRINTED charts"), 0, 0, 1,
                  3);
  grid->addWidget(NewNote(this, "Chart Price, Averages, Volume, Oscillator and Bands only."), 1, 0,
                  1, 3);
  grid->addWidget(NewLabel(this, "&Line width", text1_), 2, 0);
  grid->addWidget(text1_, 2, 1);
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text1_);
}

void PLW::Save() {
  SaveLineWidth(services_.ini, services_.settings, std::int16_t(text1_->value()));
  accept();
  services_.Saved();
}

}  // namespace kora
