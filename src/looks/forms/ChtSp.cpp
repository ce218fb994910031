#include "looks/forms/ChtSp.h"

#include <QGridLayout>
#include <QLabel>
#include <QSpinBox>

#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

ChtSp::ChtSp(LookServices services, Style chartStyle, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("ChtSp");
  setWindowTitle("Chart Spacing");
  // 0 was never set: charts stand 2 apart then.
  const std::int16_t spacing = services_.settings.charts.Spacing;
  text1_ =
      NewNumber(this, "Text1", LeastSpacing(chartStyle), kMostSpacing, spacing == 0 ? 2 : spacing);

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "Chart &Spacing", text1_), 0, 0);
  grid->addWidget(text1_, 0, 1);
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text1_);
}

void ChtSp::Save() {
  SaveSpacing(services_.ini, services_.settings, std::int16_t(text1_->value()));
  accept();
  services_.Saved();
}

}  // namespace kora
