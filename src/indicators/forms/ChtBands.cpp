#include "indicators/forms/ChtBands.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "base/runtime_error.h"
#include "indicators/price_overlays.h"
#include "looks/look_settings.h"
#include "platform/qt/form_parts.h"

namespace kora {

ChtBands::ChtBands(ChtBandsServices services, BandForm form, QWidget* parent)
    : QDialog(parent), services_(std::move(services)), form_(form) {
  setObjectName("ChtBands");
  setWindowTitle(BandFormTitle(form));
  const bool percentage = form == BandForm::kPercentage;
  const BandTexts standing = StandingBands(form, services_.current.Rec);
  const char* captions[] = {percentage ? "&Upper band %" : "&Periods",
                            percentage ? "&Lower band %" : "&Width"};
  auto* grid = new QGridLayout(this);
  for (int i = 0; i < 2; ++i) {
    text_[i] = NewField(this, QString("Text%1").arg(i + 1), 4, 6);
    text_[i]->setText(ToQt(i == 0 ? standing.first : standing.second));
    grid->addWidget(NewLabel(this, captions[i], text_[i]), i, 0);
    grid->addWidget(text_[i], i, 1);
  }
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  FocusField(text_[0]);
}

void ChtBands::Save() {
  try {
    if (!SaveBands(services_.files, services_.dataPath, services_.current, form_,
                   text_[0]->text().toStdString(), text_[1]->text().toStdString())) {
      services_.dialogs.Message(kBandsMessage, kBandsTitle);
      FocusField(text_[0]);
      return;
    }
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(NotSavedText(e), kNotSavedTitle);
    return;
  }
  accept();
  if (services_.saved) services_.saved();
}

}  // namespace kora
