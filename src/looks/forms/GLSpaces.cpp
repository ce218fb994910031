#include "looks/forms/GLSpaces.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>

#include "base/numbers.h"
#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

GLSpaces::GLSpaces(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("GLSpaces");
  setWindowTitle(ToQt(kGridSpaceTitle));
  const ChartSettings& charts = services_.settings.charts;
  text1_ = NewField(this, "Text1", 4, 6);
  text1_->setText(ToQt(Str(std::int32_t(charts.GridSpace))));
  check1_ = new QCheckBox("&Intermediate horizontal grid", this);
  check1_->setObjectName("Check1");
  check1_->setChecked(charts.HalfGrid);

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewNote(this,
                          " (1) Sets the number of bars between vertical grid lines. With "
                          "0 the lines move with the dates"),
                  0, 0, 1, 3);
  grid->addWidget(NewLabel(this, "&Grid line spacing", text1_), 1, 0);
  grid->addWidget(text1_, 1, 1);
  grid->addWidget(
      NewNote(this, " (2) Allows you to set the intermediate horizontal grid ON or OFF"), 2, 0, 1,
      3);
  grid->addWidget(check1_, 3, 0, 1, 3);
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text1_);
}

void GLSpaces::Save() {
  if (!SaveGridSpacing(services_.ini, services_.settings, text1_->text().toStdString(),
                       check1_->isChecked())) {
    services_.dialogs.Message(kGridSpaceMessage, kGridSpaceTitle);
    FocusField(text1_);
    return;
  }
  accept();
  services_.Saved();
}

}  // namespace kora
