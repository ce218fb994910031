#include "settings/forms/Locate.h"

#include <QGridLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>

#include "base/text.h"

namespace kora {

Locate::Locate(const Files& files, Dialogs& dialogs, const LocateCase& what,
               std::function<void(const std::string&)> saved, QWidget* parent)
    : QDialog(parent), dialogs_(dialogs), saved_(std::move(saved)) {
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

  picker_ = new FolderPicker(files, {}, "D&rive", "&Folder", this);
  picker_->findChild<QListWidget*>()->setMinimumWidth(fontMetrics().averageCharWidth() * 45);
  auto* save = new QPushButton("&SAVE", this);
  save->setObjectName("Command1");
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command3");
  save->setDefault(true);
  close->setAutoDefault(false);

  auto* rows = new QVBoxLayout(this);
  rows->addWidget(label3_[1]);
  rows->addWidget(label3_[0]);
  rows->addWidget(picker_, 1);
  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  buttons->addWidget(save);
  buttons->addWidget(close);
  rows->addLayout(buttons);

  picker_->changed = [this] { label3_[0]->setText(QString::fromStdString(picker_->folder())); };
  picker_->SetFolder(what.start);
  picker_->FocusList();

  connect(save, &QPushButton::clicked, this, [this] { Save(); });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
}

void Locate::Save() {
  const std::string folder(Trim(picker_->folder()));
  if (folder.empty()) {
    dialogs_.Message("Path not set correctly", "Modify File Locations");
    return;
  }
  saved_(folder);
  accept();
}

}  // namespace kora
