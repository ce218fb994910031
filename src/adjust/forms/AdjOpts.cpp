#include "adjust/forms/AdjOpts.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QRadioButton>

#include "adjust/adjust_options.h"
#include "platform/qt/form_parts.h"

namespace kora {

AdjOpts::AdjOpts(SettingsFile& ini, Settings& settings, QWidget* parent)
    : QDialog(parent), ini_(ini), settings_(settings) {
  setObjectName("AdjOpts");
  setWindowTitle("Options");
  auto* dividends = new QGroupBox("Dividends", this);
  auto* choices = new QVBoxLayout(dividends);
  static constexpr const char* kChoices[] = {"&Leave dividends out of the list", "Set ADJ to &Y",
                                             "Set ADJ to &N", "Set ADJ to &D"};
  for (size_t i = 0; i < divs_.size(); ++i) {
    divs_[i] = new QRadioButton(kChoices[i], dividends);
    divs_[i]->setObjectName(QString("Option1(%1)").arg(i));
    choices->addWidget(divs_[i]);
  }
  divs_[size_t(ShownDivs(settings_) - 1)]->setChecked(true);
  shortNames_ = new QCheckBox("Leave new issues with &short names out of the list", this);
  shortNames_->setObjectName("Check1");
  shortNames_->setChecked(settings_.NoShortNames);
  auto* grid = new QGridLayout(this);
  grid->addWidget(dividends, 0, 0);
  grid->addWidget(shortNames_, 1, 0);
  AddOkCancel(this, grid, [this] { Save(); });
}

void AdjOpts::Save() {
  std::int16_t divs = 1;
  for (size_t i = 0; i < divs_.size(); ++i)
    if (divs_[i]->isChecked()) divs = std::int16_t(i + 1);
  SaveAdjustOptions(ini_, settings_, divs, shortNames_->isChecked());
  accept();
}

}  // namespace kora
