#include "update/forms/ModDetails.h"

#include <QComboBox>
#include <QEvent>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QTimer>
#include <QToolButton>
#include <utility>

#include "base/numbers.h"
#include "base/text.h"
#include "update/download_settings.h"
#include "update/forms/DLWizard.h"
#include "update/forms/INUpList.h"

namespace kora {

namespace {

constexpr int kLongestPath = 60;  // what the settings file gives back

}  // namespace

ModDetails::ModDetails(UpdateFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("ModDetails");
  setWindowTitle("Data Download Service Details");
  const DownloadSettings& download = services_.settings.download;

  combo1_ = new QComboBox(this);
  combo1_->setObjectName("Combo1");
  for (const ServiceEntry& entry : ServiceEntries()) combo1_->addItem(ToQt(entry.text));
  combo1_->setCurrentIndex(ServiceIndex(download.DataService));
  text1_ = new QLineEdit(ToQt(download.DLPath), this);
  text1_->setObjectName("Text1");
  text1_->setMinimumWidth(fontMetrics().averageCharWidth() * 45);
  text1_->setMaxLength(kLongestPath);
  combo2_ = new QComboBox(this);
  combo2_->setObjectName("Combo2");
  for (const FormatEntry& entry : FormatEntries()) combo2_->addItem(ToQt(entry.text));
  combo2_->setCurrentIndex(FormatIndex(download.InternetDLfmt));
  format_ = FormatToStore(download.InternetDLfmt);
  text2_ = new QLineEdit(ToQt(Str(download.VolumeDivisor)), this);
  text2_->setObjectName("Text2");
  text2_->installEventFilter(this);

  auto* grid = new QGridLayout(this);
  const auto add = [&](const char* caption, QWidget* field, int row) {
    auto* label = new QLabel(caption, this);
    label->setBuddy(field);
    grid->addWidget(label, row, 0);
    grid->addWidget(field, row, 1);
    return label;
  };
  add("Data &Service", combo1_, 0);
  add("Download &Folder", text1_, 1);
  grid->addWidget(NewLocateButton(
                      services_, "Picture1", text1_,
                      [this] {
                        return LocateCase{"Download Folder", text1_->text().toStdString()};
                      },
                      this),
                  1, 2);
  formatLabel_ = add("File &Names", combo2_, 2);
  divisorLabel_ = add("&Volume Divisor", text2_, 3);
  grid->setColumnStretch(1, 1);

  command1_ = new QPushButton("Edit &Update List", this);
  command1_->setObjectName("Command1");
  command1_->setAutoDefault(false);
  auto* save = new QPushButton("SAV&E", this);
  save->setObjectName("Command3");
  save->setDefault(true);
  auto* buttons = new QHBoxLayout;
  buttons->addWidget(command1_);
  buttons->addStretch();
  buttons->addWidget(save);
  grid->addLayout(buttons, 4, 0, 1, 3);

  connect(combo1_, &QComboBox::currentIndexChanged, this, [this] {
    changed_ = true;
    ShowService();
    ProposeFolder();
  });
  connect(combo1_, &QComboBox::activated, this, [this](int index) {
    if (!std::exchange(changed_, false) || ServiceOfIndex(index) != 3) return;
    auto* wizard = new DLWizard(services_, this);
    wizard->setAttribute(Qt::WA_DeleteOnClose);
    wizard->open();
  });
  connect(combo2_, &QComboBox::currentIndexChanged, this,
          [this](int index) { format_ = FormatEntries()[size_t(index)].stored; });
  connect(command1_, &QPushButton::clicked, this, [this] {
    if (text2_->isVisible() && !CheckDivisor()) return;
    auto* list = new INUpList(services_, this);
    list->setAttribute(Qt::WA_DeleteOnClose);
    list->open();
  });
  connect(save, &QPushButton::clicked, this, [this] { Save(); });
  ShowService();
}

void ModDetails::ShowService() {
  const int service = ServiceOfIndex(combo1_->currentIndex());
  for (QWidget* widget :
       std::initializer_list<QWidget*>{combo2_, text2_, formatLabel_, divisorLabel_})
    widget->setVisible(service == 4);
  command1_->setEnabled(service != 1);
}

void ModDetails::ProposeFolder() {
  if (!Trim(text1_->text().toStdString()).empty()) return;
  text1_->setText(
      ToQt(ProposedDownloadFolder(services_.files, ServiceOfIndex(combo1_->currentIndex()),
                                  services_.settings.paths.SystemPath)));
}

bool ModDetails::CheckDivisor() {
  if (text2_->text() == "0") text2_->setText("1");
  if (VolumeDivisorOf(text2_->text().toStdString())) return true;
  services_.dialogs.Message(kBadDivisor, "Volume Divisor");
  text2_->setFocus();
  return false;
}

bool ModDetails::eventFilter(QObject* object, QEvent* event) {
  if (object == text2_ && event->type() == QEvent::FocusOut && text2_->isVisible() &&
      isActiveWindow()) {
    // The focus is on its way: it is brought back once it is there.
    QTimer::singleShot(0, this, [this] {
      if (isVisible() && !text2_->hasFocus()) CheckDivisor();
    });
  }
  return QDialog::eventFilter(object, event);
}

void ModDetails::Save() {
  if (text2_->isVisible() && !CheckDivisor()) return;
  const ServiceChoice choice{combo1_->currentIndex(), text1_->text().toStdString(), format_,
                             VolumeDivisorOf(text2_->text().toStdString()).value_or(1)};
  if (!SaveServiceChoice(choice, services_.ini, services_.settings.download, services_.dialogs))
    return;
  accept();
  if (services_.serviceSaved) services_.serviceSaved();
}

}  // namespace kora
