#include "looks/forms/BlankSpc.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QScreen>
#include <QSlider>

#include "base/numbers.h"
#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

// Ten millimetres as the screen tells its size, which is why it is told as approximate.
double PixelsInTenMillimetres(const QScreen* screen) {
  if (!screen) return 0;
  const double dots = screen->physicalDotsPerInchX();
  return (dots > 0 ? dots : screen->logicalDotsPerInchX()) / 2.54;
}

}  // namespace

BlankSpc::BlankSpc(LookServices services, QWidget* parent, double pixelsPerUnit)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("BlankSpc");
  setWindowTitle(ToQt(kBlankSpaceTitle));
  const ChartSettings& charts = services_.settings.charts;
  text1_ = NewField(this, "Text1", 4, 6);
  text1_->setText(ToQt(Str(std::int32_t(charts.BlankSpace))));
  const double units = RoundHalfEven(PixelsInTenMillimetres(screen()) / pixelsPerUnit);
  auto* width =
      NewLabel(this, "10mm = " + ToQt(Str(units)) + " approx (varies with some monitors)");
  width->setObjectName("Label2");
  slider1_ = new QSlider(Qt::Horizontal, this);
  slider1_->setObjectName("Slider1");
  slider1_->setRange(1, kWeekSteps);
  slider1_->setPageStep(5);
  slider1_->setTickPosition(QSlider::TicksBelow);
  slider1_->setTickInterval(5);
  slider1_->setValue(StepOfWeekFactor(charts.WeekFactor));
  label4_ = NewLabel(this, {});
  label4_->setObjectName("Label4");
  label4_->setMinimumWidth(fontMetrics().horizontalAdvance("0.000"));

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "&Blank space at end of chart", text1_), 0, 0);
  grid->addWidget(text1_, 0, 1, 1, 2);
  grid->addWidget(width, 1, 0, 1, 3);
  grid->addWidget(NewLabel(this, "&Days in a week of data", slider1_), 2, 0);
  grid->addWidget(slider1_, 2, 1);
  grid->addWidget(label4_, 2, 2);
  grid->setColumnStretch(1, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  connect(slider1_, &QSlider::valueChanged, this, [this] { ShowWeek(); });
  ShowWeek();
  FocusField(text1_);
}

void BlankSpc::ShowWeek() {
  label4_->setText(ToQt(Format(WeekFactorOfStep(slider1_->value()), "0.00")));
}

void BlankSpc::Save() {
  if (!SaveBlankSpace(services_.ini, services_.settings, text1_->text().toStdString(),
                      slider1_->value())) {
    services_.dialogs.Message(kBlankSpaceMessage, kBlankSpaceTitle);
    FocusField(text1_);
    return;
  }
  accept();
  services_.Saved();
}

}  // namespace kora
