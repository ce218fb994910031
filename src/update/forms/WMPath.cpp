#include "update/forms/WMPath.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QRadioButton>
#include <QToolButton>

#include "base/text.h"
#include "update/download_settings.h"

namespace kora {

WMPath::WMPath(UpdateFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("WMPath");
  setWindowTitle("Data Destination Paths");
  static constexpr const char* kCaptions[] = {"&ASX ( All or Top 500 / 150 )",
                                              "&Indices",
                                              "S&FE Futures",
                                              "&Overseas",
                                              "O&ptions",
                                              "&Extra stocks"};
  const WmPaths lines = ReadWmPaths(services_.files, services_.settings.paths.SystemPath);
  const size_t order[] = {kWmAsx, kWmIndices, kWmFutures, kWmOverseas, kWmOptions, kWmSum};
  auto* grid = new QGridLayout(this);
  grid->addWidget(new QLabel("View charts from", this), 0, 3);
  for (int i = 0; i < 6; ++i) {
    const auto at = size_t(i);
    auto* label = new QLabel(kCaptions[i], this);
    texts_[at] = new QLineEdit(ToQt(lines[order[i]]), this);
    texts_[at]->setObjectName(QString("Text%1").arg(i + 1));
    texts_[at]->setMinimumWidth(fontMetrics().averageCharWidth() * 45);
    label->setBuddy(texts_[at]);
    grid->addWidget(NewDestinationButton(services_, i, texts_[at], this), i + 1, 2);
    options_[at] = new QRadioButton(this);
    options_[at]->setObjectName(QString("Option1(%1)").arg(i));
    options_[at]->setAccessibleName("View charts from " + label->text().remove('&'));
    options_[at]->setChecked(lines[kWmChosen] == std::to_string(i));
    grid->addWidget(label, i + 1, 0);
    grid->addWidget(texts_[at], i + 1, 1);
    grid->addWidget(options_[at], i + 1, 3, Qt::AlignCenter);
    connect(options_[at], &QRadioButton::clicked, this, [this, i] { Choose(i); });
  }
  grid->setColumnStretch(1, 1);
  auto* save = new QPushButton("&SAVE", this);
  save->setObjectName("Command1");
  save->setDefault(true);
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command2");
  close->setAutoDefault(false);
  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  buttons->addWidget(save);
  buttons->addWidget(close);
  grid->addLayout(buttons, 7, 0, 1, 4);
  connect(save, &QPushButton::clicked, this, [this] { Save(); });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
}

// Takes effect at once; where there is no folder to take yet, as the paths are saved.
void WMPath::Choose(int index) {
  const std::string folder = WithBackslash(Trim(texts_[size_t(index)]->text().toStdString()));
  waiting_ = folder.empty();
  if (waiting_) return;
  if (const std::string why = WhyNotKept(folder); !why.empty()) {
    services_.dialogs.Message(folder + " " + why, windowTitle().toStdString());
    texts_[size_t(index)]->setFocus();
    return;
  }
  services_.settings.paths.CurrentDataPath = folder;
  services_.ini.PutSetting("KoraPaths", "ChtData", folder);
  if (services_.pathChosen) services_.pathChosen();
}

void WMPath::Save() {
  std::array<std::string, 6> folders;
  int chosen = 0;
  for (size_t i = 0; i < folders.size(); ++i) {
    folders[i] = texts_[i]->text().toStdString();
    if (options_[i]->isChecked()) chosen = int(i);
  }
  if (!SaveOrTell(services_.dialogs, windowTitle(), [&] {
        return SaveWmPaths(services_.files, services_.settings.paths.SystemPath, folders, chosen,
                           services_.dialogs);
      }))
    return;
  if (waiting_) Choose(chosen);
  accept();
}

}  // namespace kora
