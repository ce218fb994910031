#include "maintenance/forms/ChartBak.h"

#include <QGridLayout>
#include <QLabel>
#include <QListWidget>
#include <QPointer>
#include <QPushButton>

#include "base/numbers.h"
#include "maintenance/backup.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr const char* kCaption = " BACKUP  Charting Data Files";

QLabel* NewPlace(QWidget* form, const char* name, const std::string& text) {
  auto* label = new QLabel(ToQt(text), form);
  label->setObjectName(name);
  label->setTextFormat(Qt::PlainText);
  label->setTextInteractionFlags(Qt::TextSelectableByMouse);
  return label;
}

}  // namespace

ChartBak::ChartBak(MaintenanceServices services, Way way, QWidget* parent)
    : WorkForm(std::move(services), parent),
      way_(way),
      source_(way == Way::kBackup ? dataPath() : services_.settings.paths.ChartBackupPath),
      destination_(way == Way::kBackup ? services_.settings.paths.ChartBackupPath : dataPath()) {
  setObjectName("ChartBak");
  setWindowTitle(kCaption);
  auto* rows = new QVBoxLayout(this);
  auto* grid = new QGridLayout;
  grid->addWidget(NewPlace(this, "Label4", "Source"), 0, 0);
  grid->addWidget(NewPlace(this, "Label6", source_), 0, 1);
  grid->addWidget(NewPlace(this, "Label5", "Destination"), 1, 0);
  grid->addWidget(NewPlace(this, "Label7", destination_), 1, 1);
  grid->setColumnStretch(1, 1);
  rows->addLayout(grid);
  file1_ = new QListWidget(this);
  file1_->setObjectName("File1");
  file1_->setAccessibleName("Files of the source");
  file1_->setUniformItemSizes(true);
  file1_->setMinimumWidth(fontMetrics().averageCharWidth() * 60);
  rows->addWidget(file1_, 1);
  label1_ = NewPlace(this, "Label1", "");
  label2_ = NewPlace(this, "Label2", "");
  rows->addWidget(label1_);
  rows->addWidget(label2_);
  AddState(rows, "Label3");
  AddPanel(rows);
  auto* buttons = new ButtonRow(this);
  command3_ = buttons->Add("Command3", "&Backup all files", [this] { CopyAll(); });
  command2_ = buttons->Add("Command2", "Backup &Selected File", [this] { CopySelected(); });
  command1_ = buttons->Add("Command1", "&Close", [this] { reject(); });
  command2_->setAutoDefault(false);
  command1_->setAutoDefault(false);
  rows->addLayout(buttons);
  panel_->Hold({file1_, command1_, command2_, command3_});
}

bool ChartBak::Fill() {
  file1_->clear();
  const auto names = FilesToCopy(services_.files, source_, services_.dialogs);
  for (const std::string& name : names) file1_->addItem(ToQt(name));
  command2_->setEnabled(!names.empty());
  command3_->setEnabled(!names.empty());
  return !names.empty() || services_.files.IsFolder(source_);
}

void ChartBak::Told(ProgressLine line, const std::string& text) {
  if (line == ProgressLine::kItem) from_ = text;
  if (line == ProgressLine::kNote) to_ = text;
}

void ChartBak::Stepped(int done, int total) {
  label1_->setText(ToQt(from_));
  label2_->setText(ToQt(to_));
  if (total == file1_->count() && done < total) file1_->setCurrentRow(done);
}

void ChartBak::Copy(const std::function<void(Progress&)>& copy) {
  const QPointer<ChartBak> here = this;
  state_->clear();
  setWindowTitle(ToQt(BackupCaption(services_.files, source_, dataPath())));
  Run(copy);
  if (!here) return;
  setWindowTitle(kCaption);
  label1_->clear();
  label2_->clear();
}

void ChartBak::CopyAll() {
  if (panel_->running()) return;
  const QPointer<ChartBak> here = this;
  CopyCount count;
  Copy([&](Progress& progress) {
    count =
        way_ == Way::kBackup
            ? BackupAllFiles(services_.files, source_, destination_, progress, services_.dialogs)
            : RestoreAllFiles(services_.files, destination_, source_, progress, services_.dialogs);
  });
  if (!here) return;
  if (way_ == Way::kRestore && count.files > 0) SetChanged();
  if (count.done) state_->setText(ToQt(Str(count.files) + " files copied"));
}

void ChartBak::CopySelected() {
  if (panel_->running()) return;
  // What has the keyboard is not chosen yet.
  const auto chosen = file1_->selectedItems();
  if (chosen.isEmpty()) {
    file1_->setFocus();
    return;
  }
  const QPointer<ChartBak> here = this;
  const std::string name = chosen.first()->text().toStdString();
  bool copied = false;
  Copy([&](Progress& progress) {
    copied =
        CopySelectedFile(services_.files, source_, destination_, name, progress, services_.dialogs);
  });
  if (here && copied && way_ == Way::kRestore) SetChanged();
}

}  // namespace kora
