#include "update/forms/DLWizard.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>

#include "update/download_settings.h"

namespace kora {

DLWizard::DLWizard(UpdateFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("DLWizard");
  setWindowTitle("Download Data Settings");
  static constexpr const char* kKinds[] = {
      "All ASX stocks, warrants", "Top 500, Top 150", "Indices (Aust)",
      "Overseas indices etc.",    "SFE Futures",      "Put / Call Options"};
  static constexpr const char* kFolders[] = {"ASX stocks",    "Aust Indices",       "SFE Futures",
                                             "Overseas Data", "Put / Call Options", "Extra stocks"};
  const auto ticks = WizardTicks(services_.ini);
  const auto folders =
      WizardFolders(ReadWmPaths(services_.files, services_.settings.paths.SystemPath));
  auto* grid = new QGridLayout(this);
  grid->addWidget(
      new QLabel("Download packages:  All ASX  Top500  Top150 or All Options", this), 0, 0, 1, 3);
  for (int i = 0; i < 6; ++i) {
    const auto at = size_t(i);
    checks_[at] = new QCheckBox(kKinds[i], this);
    checks_[at]->setObjectName(QString("Check1(%1)").arg(i));
    checks_[at]->setChecked(ticks[at]);
    grid->addWidget(checks_[at], i + 1, 0);
  }
  for (int i = 0; i < 6; ++i) {
    const auto at = size_t(i);
    auto* label = new QLabel(kFolders[i], this);
    texts_[at] = new QLineEdit(Shown(folders[at]), this);
    texts_[at]->setObjectName(QString("Text1(%1)").arg(i));
    texts_[at]->setAccessibleName(kFolders[i]);
    texts_[at]->setMinimumWidth(fontMetrics().averageCharWidth() * 40);
    grid->addWidget(label, i + 1, 1);
    grid->addWidget(texts_[at], i + 1, 2);
  }
  grid->setColumnStretch(2, 1);
  auto* save = new QPushButton("&Save Settings", this);
  save->setObjectName("Command1");
  save->setDefault(true);
  grid->addWidget(save, 7, 2, Qt::AlignRight);
  connect(save, &QPushButton::clicked, this, [this] { Save(); });
}

void DLWizard::Save() {
  std::array<std::string, 6> folders;
  std::array<bool, 6> ticks{};
  for (size_t i = 0; i < folders.size(); ++i) {
    folders[i] = texts_[i]->text().toStdString();
    ticks[i] = checks_[i]->isChecked();
  }
  if (!SaveOrTell(services_.dialogs, windowTitle(), [&] {
        return SaveWizardFolders(services_.files, services_.settings.paths.SystemPath, folders,
                                 services_.dialogs);
      }))
    return;
  SaveWizardTicks(services_.ini, ticks);
  accept();
}

}  // namespace kora
