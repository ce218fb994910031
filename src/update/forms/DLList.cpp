#include "update/forms/DLList.h"

#include <QApplication>
#include <QGridLayout>
#include <QLabel>
#include <QListWidget>
#include <QProgressBar>
#include <QPushButton>

#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr int kRefreshMs = 40;

}  // namespace

DLList::DLList(DLListServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("DLList");
  const DownloadSettings& download = services_.settings.download;
  setWindowTitle(download.DataService != 1 && !download.UpdateAll
                     ? "Update AS SELECTED with Downloaded Data"
                     : "Update with Downloaded Data ");

  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Dates that wait");
  label2_ = AddLabel("Label2");
  label3_ = AddLabel("Label3");
  label4_ = AddLabel("Label4");
  label5_ = AddLabel("Label5");
  label8_[0] = AddLabel("Label8(0)");
  label8_[1] = AddLabel("Label8(1)");
  label4_->setText(ToQt(download.DLPath));
  label5_->setText(ToQt(services_.settings.paths.CurrentDataPath));
  label8_[0]->setMinimumWidth(fontMetrics().averageCharWidth() * 50);
  bar_ = new QProgressBar(this);
  bar_->setObjectName("ProgressBar1");
  QSizePolicy place = bar_->sizePolicy();
  place.setRetainSizeWhenHidden(true);
  bar_->setSizePolicy(place);
  bar_->hide();

  command1_ = AddButton("Command1", "Update &1 Day");
  command1_->setDefault(true);
  command3_ = AddButton("Command3", "Update &All");
  command4_ = AddButton("Command4", "&Remove Date");
  command4_->setToolTip("Deletes an unwanted date from list");
  command2_ = AddButton("Command2", "&Close");

  auto* grid = new QGridLayout(this);
  grid->addWidget(list1_, 0, 0, 5, 1);
  const std::pair<const char*, QLabel*> lines[] = {
      {"", label2_}, {"Date", label3_}, {"From", label4_}, {"To", label5_}};
  int row = 0;
  for (const auto& [caption, label] : lines) {
    grid->addWidget(new QLabel(caption, this), row, 1);
    grid->addWidget(label, row++, 2);
  }
  auto* buttons = new QVBoxLayout;
  for (QPushButton* button : {command1_, command3_, command4_, command2_})
    buttons->addWidget(button);
  grid->addLayout(buttons, 0, 3, 5, 1);
  grid->addWidget(label8_[0], 5, 0, 1, 4);
  grid->addWidget(label8_[1], 6, 0, 1, 4);
  grid->addWidget(bar_, 7, 0, 1, 4);
  grid->setColumnStretch(2, 1);

  connect(list1_, &QListWidget::currentTextChanged, label3_, &QLabel::setText);
  connect(list1_, &QListWidget::itemDoubleClicked, this, [this] { UpdateDay(); });
  connect(command1_, &QPushButton::clicked, this, [this] { UpdateDay(); });
  connect(command3_, &QPushButton::clicked, this, [this] { UpdateAll(); });
  connect(command4_, &QPushButton::clicked, this, [this] { RemoveDate(); });
  connect(command2_, &QPushButton::clicked, this, &DLList::reject);
}

QLabel* DLList::AddLabel(const char* name) {
  auto* label = new QLabel(this);
  label->setObjectName(name);
  label->setTextFormat(Qt::PlainText);
  return label;
}

QPushButton* DLList::AddButton(const char* name, const char* caption) {
  auto* button = new QPushButton(caption, this);
  button->setObjectName(name);
  return button;
}

bool DLList::Fill() {
  services_.disableMenus();
  const ListResult result =
      BuildDownloadList(services_.files, services_.settings.download, services_.dialogs, entries_);
  FillList(0);
  if (result != ListResult::kNothingWaits) return true;
  services_.enableMenus();
  return false;
}

void DLList::FillList(int selected) {
  list1_->clear();
  for (const std::string& entry : entries_) list1_->addItem(ToQt(entry));
  list1_->setCurrentRow(std::min(selected, list1_->count() - 1));
}

UpdateRun DLList::Run() {
  return {services_.files,
          services_.settings,
          services_.current,
          services_.dialogs,
          services_.clock,
          *this,
          [this](const std::string& path, const std::string& baseName) {
            if (services_.CheckBulletins) services_.CheckBulletins(path, baseName, *this);
          }};
}

void DLList::UpdateDay() {
  const int selected = list1_->currentRow();
  if (running_ || selected < 0) return;
  const UpdateEnd end = UpdateOneDay(Run(), entries_, size_t(selected));
  if (end == UpdateEnd::kStopped) {
    ListAgain();
    return;
  }
  const bool last = end == UpdateEnd::kAbandoned && selected == list1_->count() - 1;
  FillList(IsTaken(end) ? 0 : selected);
  if (entries_.empty() || last) Leave();
}

void DLList::UpdateAll() {
  if (running_ || entries_.empty()) return;
  const UpdateEnd end =
      UpdateAllDays(Run(), entries_, [this](size_t place) { list1_->setCurrentRow(int(place)); });
  if (end != UpdateEnd::kStopped) {
    Leave();
    return;
  }
  ListAgain();
}

// Behind a run that stopped: what was done before is off the list.
void DLList::ListAgain() {
  const ListResult result =
      BuildDownloadList(services_.files, services_.settings.download, services_.dialogs, entries_);
  FillList(0);
  if (result == ListResult::kNothingWaits) Leave();
}

void DLList::RemoveDate() {
  const int selected = list1_->currentRow();
  if (running_ || selected < 0) return;
  const std::string entry = entries_[size_t(selected)];
  if (RemoveDownload(services_.files, services_.settings.download.DLPath, entry, services_.dialogs,
                     entries_))
    FillList(0);
}

void DLList::Leave() {
  services_.enableMenus();
  QDialog::reject();
}

void DLList::reject() {
  if (running_) {
    stopAsked_ = true;  // the update asks at its next record
    return;
  }
  Leave();
}

void DLList::Show(ProgressLine line, std::string_view text) {
  switch (line) {
    case ProgressLine::kState: label2_->setText(ToQt(text)); break;
    case ProgressLine::kTarget: label5_->setText(ToQt(text)); break;
    case ProgressLine::kItem: first_ = text; break;
    case ProgressLine::kNote:
      second_ = text;
      ShowTexts();
      break;
    case ProgressLine::kDate:
      label3_->setText(ToQt(text));
      ShowTexts();
      break;
  }
}

void DLList::ShowTexts() {
  label8_[0]->setText(ToQt(first_));
  label8_[1]->setText(ToQt(second_));
}

void DLList::SetRunning(bool running) {
  running_ = running;
  stopAsked_ = false;
  for (QWidget* widget :
       std::initializer_list<QWidget*>{command1_, command2_, command3_, command4_, list1_})
    widget->setEnabled(!running);
  QPalette colours;
  const bool dark = colours.color(QPalette::Window).lightness() < 128;
  if (running) colours.setColor(QPalette::WindowText, dark ? QColor(255, 120, 110) : Qt::red);
  label2_->setPalette(colours);
  bar_->setValue(0);
  bar_->setVisible(running);
  services_.dialogs.SetBusy(running);
  shown_.invalidate();  // the first step shows, however short the run
}

bool DLList::Step(int done, int total) {
  if (!shown_.isValid() || shown_.elapsed() >= kRefreshMs) {
    bar_->setRange(0, total);
    bar_->setValue(done);
    ShowTexts();
    QApplication::processEvents();
    shown_.start();
  }
  if (!stopAsked_) return true;
  stopAsked_ = false;
  return false;
}

}  // namespace kora
