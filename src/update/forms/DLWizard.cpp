#include "update/forms/DLWizard.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QToolButton>

#include "update/download_settings.h"

namespace kora {

DLWizard::DLWizard(UpdateFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("DLWizard");
  setWindowTitle("Download Data Settings");
  static constexpr const char* kKinds[] = {
      "All ASX stocks, warrants", "Top 500, Top 150", "Indices (Aust)",
      "Overseas indices etc.",    "SFE Futures",      "Put / Call Options"};
  // By box. The form shows overseas data before futures, as the kinds above.
  static constexpr const char* kFolders[] = {"&ASX stocks",         "Aust &Indices",
                                             "SFE &Futures",        "&Overseas Data",
                                             "&Put / Call Options", "&Extra stocks"};
  static constexpr int kOrder[] = {0, 1, 3, 2, 4, 5};
  const auto ticks = WizardTicks(services_.ini);
  const auto folders =
      WizardFolders(ReadWmPaths(services_.files, services_.settings.paths.SystemPath));

  auto* kinds = new QGroupBox("Data received", this);
  auto* kindsGrid = new QGridLayout(kinds);
  for (int i = 0; i < 6; ++i) {
    auto*& check = checks_[size_t(i)];
    check = new QCheckBox(kKinds[i], this);
    check->setObjectName(QString("Check1(%1)").arg(i));
    check->setChecked(ticks[size_t(i)]);
    kindsGrid->addWidget(check, i % 3, i / 3);
  }
  auto* places = new QGroupBox("Folders", this);
  auto* grid = new QGridLayout(places);
  for (int row = 0; row < 6; ++row) {
    const int i = kOrder[row];
    auto*& text = texts_[size_t(i)];
    auto* label = new QLabel(kFolders[i], this);
    text = new QLineEdit(ToQt(folders[size_t(i)]), this);
    text->setObjectName(QString("Text1(%1)").arg(i));
    text->setMinimumWidth(fontMetrics().averageCharWidth() * 40);
    label->setBuddy(text);
    grid->addWidget(label, row, 0);
    grid->addWidget(text, row, 1);
    grid->addWidget(NewDestinationButton(services_, i, text, this), row, 2);
  }
  grid->setColumnStretch(1, 1);
  texts_[5]->setToolTip("Saved as the folder of ASX stocks; Data Destination Paths has its own");

  auto* box = new QVBoxLayout(this);
  box->addWidget(new QLabel("Download packages:  All ASX  Top500  Top150 or All Options", this));
  box->addWidget(kinds);
  box->addWidget(places);
  auto* save = new QPushButton("&Save Settings", this);
  save->setObjectName("Command1");
  save->setDefault(true);
  box->addWidget(save, 0, Qt::AlignRight);
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
