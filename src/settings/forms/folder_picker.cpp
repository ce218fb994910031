#include "settings/forms/folder_picker.h"

#include <QComboBox>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QListWidget>
#include <QStyle>

#include "platform/qt/form_parts.h"
#include "settings/locate.h"

namespace kora {

FolderPicker::FolderPicker(const Files& files, const QString& index, const QString& driveCaption,
                           const QString& folderCaption, QWidget* parent)
    : QWidget(parent), files_(files) {
  drive1_ = new QComboBox(this);
  drive1_->setObjectName("Drive1" + index);
  for (const std::string& drive : Drives(files_)) drive1_->addItem(ToQt(drive));
  dir1_ = new QListWidget(this);
  dir1_->setObjectName("Dir1" + index);
  dir1_->setAccessibleName(QString(folderCaption).remove('&'));
  auto* grid = new QGridLayout(this);
  grid->setContentsMargins(0, 0, 0, 0);
  grid->addWidget(NewLabel(this, driveCaption, drive1_), 0, 0);
  grid->addWidget(drive1_, 0, 1);
  grid->addWidget(NewLabel(this, folderCaption, dir1_), 1, 0, Qt::AlignTop);
  grid->addWidget(dir1_, 1, 1);
  grid->setColumnStretch(1, 1);

  connect(drive1_, &QComboBox::textActivated, this,
          [this](const QString& drive) { ShowFolder(drive.toStdString() + "\\"); });
  connect(dir1_, &QListWidget::itemDoubleClicked, this,
          [this](QListWidgetItem* item) { Enter(item->text()); });
  dir1_->installEventFilter(this);
}

void FolderPicker::SetFolder(const std::string& folder) {
  const std::string there = NearestFolder(files_, folder);
  drive1_->setCurrentIndex(drive1_->findText(ToQt(there.substr(0, 2)), Qt::MatchFixedString));
  ShowFolder(there);
}

void FolderPicker::FocusList() { dir1_->setFocus(); }

void FolderPicker::ShowFolder(const std::string& folder) {
  folder_ = folder;
  dir1_->clear();
  if (!folder_.empty()) {
    const QIcon icon = style()->standardIcon(QStyle::SP_DirIcon);
    if (ParentFolder(folder_) != folder_)
      new QListWidgetItem(style()->standardIcon(QStyle::SP_FileDialogToParent), "..", dir1_);
    for (const std::string& name : SubFolders(files_, folder_))
      new QListWidgetItem(icon, ToQt(name), dir1_);
    dir1_->setCurrentRow(0);
  }
  if (changed) changed();
}

void FolderPicker::Enter(const QString& name) {
  ShowFolder(name == ".." ? ParentFolder(folder_) : folder_ + name.toStdString() + "\\");
}

// Enter in the list goes into the folder and does not press the default button.
bool FolderPicker::eventFilter(QObject* object, QEvent* event) {
  if (object == dir1_ && event->type() == QEvent::KeyPress && dir1_->currentItem()) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Return || key == Qt::Key_Enter) {
      Enter(dir1_->currentItem()->text());
      return true;
    }
  }
  return QWidget::eventFilter(object, event);
}

}  // namespace kora
