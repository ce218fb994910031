#include "indicators/forms/MMASet.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "base/numbers.h"
#include "indicators/overlay_settings.h"
#include "indicators/price_overlays.h"
#include "platform/qt/form_parts.h"

namespace kora {

MMASet::MMASet(LookServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("MMASet");
  setWindowTitle(ToQt(kMMASetTitle));
  auto* grid = new QGridLayout(this);
  const char* captions[] = {"&Short", "&Long"};
  for (int i = 0; i < 12; ++i) {
    text1_[i] = NewField(this, QString("Text1(%1)").arg(i), 4, 6);
    text1_[i]->setAccessibleName(QString("Average %1").arg(i + 1));
    grid->addWidget(text1_[i], i / 6, 1 + i % 6);
    if (i % 6 == 0) grid->addWidget(NewLabel(this, captions[i / 6], text1_[i]), i / 6, 0);
  }
  Fill(services_.settings.osc.MMASet);
  grid->setColumnStretch(7, 1);
  grid->setRowStretch(2, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "S&ave", [this] { Save(); });
  buttons->Add("Command2", "&Cancel", [this] { reject(); });
  buttons->Add("Command3", "&Defaults", [this] { Fill(kDefaultMMASet); });
  grid->addLayout(buttons, 3, 0, 1, 8);
  FocusField(text1_[0]);
}

void MMASet::Fill(const std::array<std::int16_t, 12>& periods) {
  for (size_t i = 0; i < 12; ++i) text1_[i]->setText(ToQt(Str(std::int32_t(periods[i]))));
}

void MMASet::Save() {
  std::array<std::string, 12> typed;
  for (size_t i = 0; i < 12; ++i) typed[i] = text1_[i]->text().toStdString();
  size_t refused = 0;
  if (!SaveMMASet(services_.ini, services_.settings, typed, refused)) {
    services_.dialogs.Message(kMMASetMessage, kMMASetTitle);
    FocusField(text1_[refused]);
    return;
  }
  accept();
  services_.Saved();
}

}  // namespace kora
