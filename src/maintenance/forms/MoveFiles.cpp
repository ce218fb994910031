#include "maintenance/forms/MoveFiles.h"

#include <QGroupBox>
#include <QLabel>
#include <QListWidget>
#include <QPointer>
#include <QPushButton>

#include "base/runtime_error.h"
#include "base/text.h"
#include "maintenance/move_files.h"
#include "maintenance/same_place.h"
#include "platform/qt/form_parts.h"
#include "settings/forms/folder_picker.h"

namespace kora {
namespace {

constexpr const char* kFindTheFile =
    "Find the required file on the source side. Click file to highlight. Click >>> button to move "
    "it.";

}  // namespace

MoveFiles::MoveFiles(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("MoveFiles");
  setWindowTitle("Move KORA Data Files");
  auto* rows = new QVBoxLayout(this);
  for (const char* text :
       {"Set SOURCE side to the folder that contains the file to move.",
        "Set DESTINATION side to the folder you want to accept files.", kFindTheFile})
    rows->addWidget(NewNote(this, text, 80));
  auto* columns = new QHBoxLayout;
  source_ = AddSide(columns, "SOURCE", 0);
  auto* command1 = new QPushButton(">>>", this);
  command1->setObjectName("Command1");
  command1->setAccessibleName("Move the file to the destination");
  command1->setToolTip(command1->accessibleName());
  command1->setDefault(true);
  connect(command1, &QPushButton::clicked, this, [this] { Move(); });
  columns->addWidget(command1);
  destination_ = AddSide(columns, "DESTINATION", 1);
  rows->addLayout(columns, 1);
  AddState(rows, "Label2");
  auto* foot = new QHBoxLayout;
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command2");
  close->setAutoDefault(false);
  connect(close, &QPushButton::clicked, this, [this] { reject(); });
  foot->addStretch();
  foot->addWidget(close);
  rows->addLayout(foot);
  for (const Side& side : {source_, destination_}) {
    side.picker->changed = [this, side] { ShowFiles(side); };
    side.picker->SetFolder(dataPath());
  }
  source_.file1->setFocus();
}

MoveFiles::Side MoveFiles::AddSide(QBoxLayout* columns, const char* title, int index) {
  auto* box = new QGroupBox(title, this);
  auto* rows = new QVBoxLayout(box);
  const QString number = QString("(%1)").arg(index);
  Side side;
  side.picker = new FolderPicker(services_.files, number, index == 0 ? "D&rive" : "Dri&ve",
                                 index == 0 ? "F&older" : "Fol&der", box);
  side.file1 = new QListWidget(box);
  side.file1->setObjectName("File1" + number);
  side.file1->setAccessibleName("Files");
  side.file1->setUniformItemSizes(true);
  side.folder = new QLabel(box);
  side.folder->setObjectName("Label3" + number);
  side.folder->setTextFormat(Qt::PlainText);
  side.folder->setTextInteractionFlags(Qt::TextSelectableByMouse);
  rows->addWidget(side.folder);
  rows->addWidget(side.picker, 1);
  rows->addWidget(NewLabel(box, index == 0 ? "&Files" : "F&iles", side.file1));
  rows->addWidget(side.file1, 1);
  columns->addWidget(box, 1);
  return side;
}

void MoveFiles::ShowFiles(const Side& side) {
  const QListWidgetItem* item = side.file1->currentItem();
  const QString chosen = item ? item->text() : QString();
  side.file1->clear();
  side.folder->setText(ToQt(side.picker->folder()));
  try {
    for (const std::string& name : services_.files.List(side.picker->folder()))
      if (UCase(name).ends_with(".WDT")) side.file1->addItem(ToQt(name));
  } catch (const RunTimeError&) {
    // A folder that can't be read shows none.
  }
  const auto found = side.file1->findItems(chosen, Qt::MatchFixedString);
  if (!chosen.isEmpty() && !found.isEmpty()) side.file1->setCurrentItem(found.first());
}

void MoveFiles::Move() {
  // What has the keyboard is not chosen yet.
  const auto chosen = source_.file1->selectedItems();
  if (chosen.isEmpty()) {
    services_.dialogs.Message(kFindTheFile, "Move KORA Data Files");
    source_.file1->setFocus();
    return;
  }
  const std::string name = chosen.first()->text().toStdString();
  const QPointer<MoveFiles> here = this;
  bool moved = false;
  state_->clear();
  Run([&](Progress& progress) {
    moved = MoveDataFile(services_.files, source_.picker->folder(), destination_.picker->folder(),
                         name.substr(0, name.size() - 4), progress, services_.dialogs);
  });
  if (!here) return;
  if (moved && IsSamePlace(services_.files, destination_.picker->folder(), dataPath()))
    SetChanged();
  ShowFiles(source_);
  ShowFiles(destination_);
}

}  // namespace kora
