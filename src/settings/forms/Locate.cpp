#include "settings/forms/Locate.h"

#include <QComboBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>
#include <QStyle>

#include "base/text.h"

namespace kora {

Locate::Locate(const Files& files, Dialogs& dialogs, const LocateCase& what,
               std::function<void(const std::string&)> saved, QWidget* parent)
    : QDialog(parent), files_(files), dialogs_(dialogs), saved_(std::move(saved)) {
  setObjectName("Locate");
  setWindowTitle("Modify File Locations");

  for (int i = 0; i < 2; ++i) {
    label3_[i] = new QLabel(this);
    label3_[i]->setObjectName(QString("Label3(%1)").arg(i));
    label3_[i]->setTextFormat(Qt::PlainText);
  }
  label3_[0]->setFrameStyle(QFrame::Panel | QFrame::Sunken);
  label3_[0]->setTextInteractionFlags(Qt::TextSelectableByMouse);
  label3_[1]->setText(QString::fromStdString(what.purpose));
  QFont bold = label3_[1]->font();
  bold.setBold(true);
  label3_[1]->setFont(bold);

  drive1_ = new QComboBox(this);
  drive1_->setObjectName("Drive1");
  for (const std::string& drive : Drives(files_)) drive1_->addItem(QString::fromStdString(drive));
  dir1_ = new QListWidget(this);
  dir1_->setObjectName("Dir1");
  dir1_->setMinimumWidth(fontMetrics().averageCharWidth() * 45);

  auto* driveLabel = new QLabel("D&rive", this);
  driveLabel->setBuddy(drive1_);
  auto* folderLabel = new QLabel("&Folder", this);
  folderLabel->setBuddy(dir1_);
  auto* save = new QPushButton("&SAVE", this);
  save->setObjectName("Command1");
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command3");
  save->setDefault(true);
  close->setAutoDefault(false);

  auto* grid = new QGridLayout(this);
  grid->addWidget(label3_[1], 0, 0, 1, 2);
  grid->addWidget(label3_[0], 1, 0, 1, 2);
  grid->addWidget(driveLabel, 2, 0);
  grid->addWidget(drive1_, 2, 1);
  grid->addWidget(folderLabel, 3, 0, Qt::AlignTop);
  grid->addWidget(dir1_, 3, 1);
  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  buttons->addWidget(save);
  buttons->addWidget(close);
  grid->addLayout(buttons, 4, 0, 1, 2);
  grid->setColumnStretch(1, 1);

  const std::string start = NearestFolder(files_, what.start);
  drive1_->setCurrentIndex(
      drive1_->findText(QString::fromStdString(start.substr(0, 2)), Qt::MatchFixedString));
  ShowFolder(start);
  dir1_->setFocus();

  connect(drive1_, &QComboBox::textActivated, this,
          [this](const QString& drive) { ShowFolder(drive.toStdString() + "\\"); });
  connect(dir1_, &QListWidget::itemDoubleClicked, this,
          [this](QListWidgetItem* item) { Enter(item->text()); });
  dir1_->installEventFilter(this);
  connect(save, &QPushButton::clicked, this, [this] { Save(); });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
}

void Locate::ShowFolder(const std::string& folder) {
  folder_ = folder;
  label3_[0]->setText(QString::fromStdString(folder_));
  dir1_->clear();
  if (folder_.empty()) return;
  const QIcon icon = style()->standardIcon(QStyle::SP_DirIcon);
  if (ParentFolder(folder_) != folder_)
    new QListWidgetItem(style()->standardIcon(QStyle::SP_FileDialogToParent), "..", dir1_);
  for (const std::string& name : SubFolders(files_, folder_))
    new QListWidgetItem(icon, QString::fromStdString(name), dir1_);
  dir1_->setCurrentRow(0);
}

void Locate::Enter(const QString& name) {
  ShowFolder(name == ".." ? ParentFolder(folder_) : folder_ + name.toStdString() + "\\");
}

// Enter in the list goes into the folder and does not press the default button.
bool Locate::eventFilter(QObject* object, QEvent* event) {
  if (object == dir1_ && event->type() == QEvent::KeyPress && dir1_->currentItem()) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      Enter(dir1_->currentItem()->text());
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

void Locate::Save() {
  const std::string folder(Trim(folder_));
  if (folder.empty()) {
    dialogs_.Message("Path not set correctly", "Modify File Locations");
    return;
  }
  saved_(folder);
  accept();
}

}  // namespace kora
