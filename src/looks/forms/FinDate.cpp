#include "looks/forms/FinDate.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>

#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

FinDate::FinDate(FinDateServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("FinDate");
  setWindowTitle("Finish Date");
  text1_ = NewField(this, "Text1", 10, 10);
  text1_->setPlaceholderText("d/m/yy");
  text1_->setText(ToQt(FinishDateText(services_.FinishDate)));

  auto* grid = new QGridLayout(this);
  grid->addWidget(NewLabel(this, "&Finish Date (d/m/yy)", text1_), 0, 0);
  grid->addWidget(text1_, 0, 1);
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text1_);
}

void FinDate::Save() {
  const auto date = ReadFinishDate(text1_->text().toStdString());
  if (!date) {
    services_.dialogs.Message(kDateMessage, kDateTitle);
    FocusField(text1_);
    return;
  }
  services_.FinishDate = *date;
  services_.FinishDateOn = true;
  accept();
  if (services_.saved) services_.saved();
}

}  // namespace kora
