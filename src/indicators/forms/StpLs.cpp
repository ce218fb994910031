#include "indicators/forms/StpLs.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>

#include "base/numbers.h"
#include "indicators/overlay_settings.h"
#include "indicators/price_overlays.h"
#include "platform/qt/form_parts.h"

namespace kora {

StpLs::StpLs(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("StpLs");
  setWindowTitle(ToQt(kStopLossTitle));
  const ChartSettings& charts = services_.settings.charts;
  on_ = new QRadioButton("O&n", this);
  on_->setObjectName("Option1(0)");
  auto* off = new QRadioButton("O&ff", this);
  off->setObjectName("Option1(1)");
  (charts.StopLoss ? on_ : off)->setChecked(true);
  text1_ = NewField(this, "Text1", 6, 10);
  text1_->setText(ToQt(Str(charts.StopLossPct)));

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "Stop loss"), 0, 0);
  auto* options = new QHBoxLayout;
  options->addWidget(on_);
  options->addWidget(off);
  options->addStretch();
  grid->addLayout(options, 0, 1, 1, 2);
  grid->addWidget(NewLabel(this, "&Percent below the low", text1_), 1, 0);
  grid->addWidget(text1_, 1, 1);
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text1_);
}

void StpLs::Save() {
  if (!SaveStopLoss(services_.ini, services_.settings, on_->isChecked(),
                    text1_->text().toStdString())) {
    services_.dialogs.Message(kStopLossMessage, kStopLossTitle);
    FocusField(text1_);
    return;
  }
  accept();
  services_.Saved();
}

}  // namespace kora
