#include "maintenance/forms/DataForm.h"

#include <QHeaderView>
#include <QMenuBar>
#include <QScrollBar>
#include <QVBoxLayout>

#include "maintenance/forms/VolMod.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

std::vector<GridColumn> Columns(std::int16_t RecType) {
  std::vector<GridColumn> columns(kDataColumns);
  for (int i = 0; i < kDataColumns; ++i) {
    columns[size_t(i)].heading = DataHeading(DataColumn(i), RecType);
    columns[size_t(i)].chars = 12;
    columns[size_t(i)].right = i != kDataDate && i != kDataAdjDesc;
  }
  columns[kDataRec].chars = 9;
  columns[kDataVolume].chars = 14;
  columns[kDataAdjDesc].chars = 17;
  return columns;
}

}  // namespace

DataForm::DataForm(DataFormServices services, DataFormFile file, QWidget* parent)
    : QDialog(parent),
      services_(std::move(services)),
      file_(std::move(file)),
      rows_(services_.files, file_.path) {
  setObjectName("DataForm");
  setWindowFlag(Qt::WindowMaximizeButtonHint);
  ss1_ = new Grid(rows_,
                  {.dialogs = services_.dialogs,
                   .files = services_.files,
                   .widths = &services_.user,
                   .section = std::string(kUserSection),
                   .key = "Data_Form"},
                  Columns(file_.RecType), "SS1", this);
  ss1_->setAccessibleName("Price data");
  ss1_->verticalHeader()->hide();  // "Rec" counts the rows
  ss1_->SetZoom(services_.settings.Zoom);
  ss1_->SetDeletable(true);
  ss1_->changed = [this] { ShowCount(); };
  panel_ = new WorkPanel(this);
  panel_->layout()->setContentsMargins(6, 0, 6, 4);
  auto* rows = new QVBoxLayout(this);
  rows->setContentsMargins(0, 0, 0, 0);
  rows->addWidget(ss1_);
  rows->addWidget(panel_);
  AddMenu();
  panel_->Hold({ss1_, bar_});
  ShowCount();
  SizeInLetters(this, 135, 36);
}

// A cell that is open asks the rows once more as it goes.
DataForm::~DataForm() { delete ss1_; }

void DataForm::AddMenu() {
  bar_ = new QMenuBar(this);
  layout()->setMenuBar(bar_);
  QMenu* file = bar_->addMenu("&File");
  AddEntry(this, file, "nmSave", "&Save ", [this] { Save(); })->setShortcut(QKeySequence::Save);
  AddEntry(this, file, "nmPage", "Pa&ge Setup", [this] {
    services_.pageSetup(this);
  })->setEnabled(bool(services_.pageSetup));
  AddEntry(this, file, "nmPrint", "&Print", [this] { Print(); })->setEnabled(bool(services_.print));
  file->addSeparator();
  AddEntry(this, file, "nmClose", "&Close", [this] { reject(); });

  QMenu* edit = bar_->addMenu("&Edit");
  AddEntry(this, edit, "nmDelete", "&Delete Rows", [this] { ss1_->DeleteSelected(); });
  AddEntry(this, edit, "nmSort", "S&ort List", [this] { Sort(); });
  AddEntry(this, edit, "nmAdjVol", "&Adjust Data", [this] { AdjustData(); });

  AddEntry(this, bar_, "dmDisp", "&Display", [this] {
    ss1_->SetZoom(services_.changeSize(this));
  })->setEnabled(bool(services_.changeSize));
}

bool DataForm::Work(const QString& text, const std::function<bool(Progress&)>& work) {
  bool done = false;
  services_.dialogs.SetBusy(true);
  panel_->Run(text, [&](Progress& progress) { done = work(progress); });
  services_.dialogs.SetBusy(false);
  return done;
}

bool DataForm::Fill() {
  const bool shown = Work({}, [this](Progress& progress) {
    return rows_.ShowData(file_.code, progress, services_.dialogs);
  });
  ss1_->Refresh();
  if (shown) ss1_->GoTo(rows_.RowCount() - 1, kDataDate);
  ss1_->horizontalScrollBar()->setValue(0);  // the numbers in sight, however narrow the grid was
  ShowCount();
  return shown;
}

void DataForm::ShowCount() {
  setWindowTitle(QString("%1   -   %2%3")
                     .arg(ToQt(file_.code), ToQt(file_.name), rows_.changed() ? " *" : ""));
  panel_->Show(QString("%1   -   %2 records").arg(ToQt(file_.path)).arg(rows_.RowCount()));
}

bool DataForm::Save() {
  if (!ss1_->EndEdit()) return false;
  const bool saved = Work("SAVE DATA FILE   SAVING - WAIT", [this](Progress& progress) {
    return rows_.SaveData(progress, services_.dialogs);
  });
  ShowCount();
  if (saved && services_.saved) services_.saved();
  return saved;
}

void DataForm::Sort() {
  if (!ss1_->EndEdit()) return;
  Work("NOW SORTING DATA FILE  -  WAIT", [this](Progress& progress) {
    progress.Step(0, 1);  // shows the text
    rows_.SortByDate();
    return true;
  });
  ss1_->Refresh();
  ShowCount();
}

void DataForm::AdjustData() {
  if (!ss1_->EndEdit()) return;
  auto* form = new VolMod(rows_, ss1_->SelectedRows(), services_.dialogs, this);
  connect(form, &QDialog::accepted, this, [this] {
    ss1_->Refresh();
    ShowCount();
  });
  RunForm(form);
}

void DataForm::Print() {
  if (!ss1_->EndEdit()) return;
  services_.print(ss1_->ToPrint(file_.code + "   " + file_.name), this);
}

void DataForm::reject() {
  if (panel_->StopFirst() || !ss1_->EndEdit()) return;
  if (rows_.changed()) {
    const Answer answer = services_.dialogs.Ask("Data File has changed\nSAVE " + file_.path + "?",
                                                kDataFileTitle, Buttons::kYesNoCancel);
    if (answer == Answer::kCancel || (answer == Answer::kYes && !Save())) return;
  }
  QDialog::reject();
}

}  // namespace kora
