#include "names/forms/NameForm.h"

#include <QHeaderView>
#include <QMenuBar>
#include <QScrollBar>
#include <QShortcut>
#include <QVBoxLayout>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "names/forms/ExMaster.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/modal.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr int kRecColumn = 0;
constexpr int kCodeColumn = 1;

// Of the grid's columns behind "Rec", in the order in which they stand.
constexpr NameColumn kColumns[] = {NameColumn::kCode,  NameColumn::kType, NameColumn::kCategory,
                                   NameColumn::kClass, NameColumn::kName, NameColumn::kDetails,
                                   NameColumn::kBase,  NameColumn::kTop,  NameColumn::kPFInc,
                                   NameColumn::kId};

std::vector<GridColumn> Columns() {
  return {{.heading = "Rec", .chars = 6, .right = true, .editable = false},
          {.heading = "Code", .chars = 9, .limit = 6},
          {.heading = "Type", .chars = 6, .right = true, .limit = 1},
          {.heading = "Cat.", .chars = 6, .right = true, .limit = 2},
          {.heading = "Industy\nClass", .chars = 9, .right = true, .limit = 3},
          {.heading = "Name    (displayed on chart)", .chars = 36, .limit = 35},
          {.heading = "Other\nDetails", .chars = 18, .limit = 15},
          {.heading = "Base", .chars = 10, .right = true},
          {.heading = "Top", .chars = 10, .right = true},
          {.heading = "PF Inc", .chars = 9, .right = true},
          {.heading = "Id", .chars = 5, .limit = 1}};
}

NameColumn ColumnAt(int column) { return kColumns[column - 1]; }
int PlaceOf(NameColumn column) {
  int place = 1;
  while (ColumnAt(place) != column) ++place;
  return place;
}

}  // namespace

class NameForm::Source : public GridSource {
 public:
  explicit Source(NameEditor& editor) : editor_(editor) {}

  int RowCount() const override { return int(editor_.rows().size()); }
  std::string Text(int row, int column) const override {
    if (column == kRecColumn) return Str(std::int32_t(row + 1));
    return NameCell(editor_.rows()[size_t(row)], ColumnAt(column));
  }
  GridShade Shade(int row, int) const override {
    return editor_.rows()[size_t(row)].NameStatus == 1 ? GridShade::kFaint : GridShade::kNone;
  }
  std::string RowName(int row) const override {
    const std::string code = Text(row, kCodeColumn);
    return code.empty() ? GridSource::RowName(row) : code;
  }
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override {
    if (const auto fault = editor_.Put(size_t(row), ColumnAt(column), text))
      return Refusal{*fault, std::string(kNameFileTitle)};
    return std::nullopt;
  }
  void DeleteRows(RowBlock block) override {
    editor_.Delete(size_t(block.first), size_t(block.count()));
  }

 private:
  NameEditor& editor_;
};

NameForm::NameForm(NameFormServices services, QWidget* parent)
    : QDialog(parent),
      services_(std::move(services)),
      editor_({services_.files, services_.settings.paths.CurrentDataPath,
               services_.settings.paths.SystemPath, services_.dialogs, services_.ini,
               services_.settings.download}),
      source_(std::make_unique<Source>(editor_)) {
  setObjectName("NameForm");
  setWindowFlag(Qt::WindowMaximizeButtonHint);
  ss1_ = new Grid(*source_,
                  {.dialogs = services_.dialogs,
                   .files = services_.files,
                   .widths = &services_.user,
                   .section = std::string(kUserSection),
                   .key = "Name_Form"},
                  Columns(), "SS1", this);
  ss1_->setAccessibleName("Name File");
  ss1_->verticalHeader()->hide();  // "Rec" counts the rows
  ss1_->SetZoom(services_.settings.Zoom);
  ss1_->SetDeletable(true);
  ss1_->changed = [this] { ShowCount(); };
  auto* rows = new QVBoxLayout(this);
  rows->setContentsMargins(0, 0, 0, 0);
  rows->addWidget(ss1_);
  AddMenu();
  ShowCount();
  SizeInLetters(this, 160, 36);
}

// A cell that is open asks the rows once more as it goes.
NameForm::~NameForm() { delete ss1_; }

void NameForm::AddMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  const auto menu = [](auto* over, const char* name, const char* caption) {
    QMenu* made = over->addMenu(caption);
    made->setObjectName(name);
    return made;
  };
  QMenu* file = menu(bar, "nmFile", "&File");
  AddEntry(this, file, "nmSave", "&Save ", [this] { Save(); })->setShortcut(QKeySequence::Save);
  AddEntry(this, file, "nfPage", "Page Set&up", [this] {
    services_.pageSetup(this);
  })->setEnabled(bool(services_.pageSetup));
  AddEntry(this, file, "nmPrint", "&Print", [this] { Print(); })->setEnabled(bool(services_.print));
  AddEntry(this, file, "nmSaveAs", "Save &As (.csv)", [this] { ss1_->SaveAs(); });
  file->addSeparator();
  AddEntry(this, file, "nmQuit", "&Close", [this] { reject(); });

  QMenu* edit = menu(bar, "nmEdit", "&Edit");
  AddEntry(this, edit, "nmAdd", "&Add Row", [this] {
    Update([this] { editor_.Insert(editor_.rows().size()); });
    ss1_->GoTo(source_->RowCount() - 1, kCodeColumn);
    ss1_->setFocus();
  });
  AddEntry(this, edit, "nmDelete", "&Delete Row/s", [this] { ss1_->DeleteSelected(); });
  QMenu* sort = menu(edit, "nmSort", "&Sort");
  AddEntry(this, sort, "mnSrtCde", "Sort by Code", [this] { Sort(NameSort::kCode); });
  AddEntry(this, sort, "mnSrtCat", "Sort By Category", [this] { Sort(NameSort::kCategory); });
  AddEntry(this, sort, "mnSrtClass", "Sort by Industry Classification",
           [this] { Sort(NameSort::kIndClass); });
  edit->addSeparator();
  AddEntry(this, edit, "nmMList", "&Update Names from KORA Master list",
           [this] { UpdateFromMasterList(); });
  AddEntry(this, edit, "mnRmvWar", "Remove &Warrants from List", [this] {
    Update([this] {
      if (editor_.DeleteWarrants() && services_.saved) services_.saved();
    });
  });
  AddEntry(this, edit, "nmDupE", "Check for Du&plicate Entries",
           [this] { Update([this] { editor_.Dupnames(); }); });
  AddEntry(this, edit, "nmIndUp", "Update Indust.Classifications from underlying stock",
           [this] { Update([this] { editor_.FillClasses(); }); });
  AddEntry(this, edit, "nmCngCase", "&Change Case to Title Case",
           [this] { Update([this] { editor_.TitleCase(); }); });
  AddEntry(this, edit, "nmClean", "C&lean Optional Details",
           [this] { Update([this] { editor_.CleanOptional(); }); });
  AddEntry(this, edit, "nmRemExOpt", "&Remove Expired Options",
           [this] { Update([this] { editor_.RemoveExpired(); }); });
}

bool NameForm::Fill() {
  try {
    editor_.Load();
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kNameFileTitle);
    return false;
  }
  ss1_->Refresh();
  ss1_->GoTo(0, kCodeColumn);
  ss1_->horizontalScrollBar()->setValue(0);  // the numbers in sight, however narrow the grid was
  ShowCount();
  return true;
}

void NameForm::ShowCount() {
  setWindowTitle(QString("Name File   -   %1 securities%2")
                     .arg(source_->RowCount())
                     .arg(editor_.changed() ? " *" : ""));
}

// What a menu entry does to the rows; what is being typed counts first.
void NameForm::Update(const std::function<void()>& work) {
  if (!ss1_->EndEdit()) return;
  const int row = ss1_->CurrentRow(), column = std::max(ss1_->CurrentColumn(), kCodeColumn);
  work();
  ss1_->Refresh();
  ss1_->GoTo(std::clamp(row, 0, std::max(0, source_->RowCount() - 1)), column);
  ShowCount();
}

void NameForm::Sort(NameSort mode) {
  Update([this, mode] { editor_.Sort(mode); });
}

bool NameForm::Save() {
  if (!ss1_->EndEdit()) return false;
  services_.dialogs.SetBusy(true);
  const NameEditor::SaveEnd end = editor_.SaveNames();
  services_.dialogs.SetBusy(false);
  if (end.fault) {
    const bool code = end.fault->message == "Code must be entered";
    ss1_->GoTo(int(end.fault->row), PlaceOf(code ? NameColumn::kCode : NameColumn::kType));
    ss1_->setFocus();
  }
  ss1_->Refresh();
  ShowCount();
  if (end.saved && services_.saved) services_.saved();
  return end.saved;
}

void NameForm::UpdateFromMasterList() {
  Update([this] {
    Modal<ExMaster> form(this);
    form->start = [&] { return editor_.UpdateNames(form->ticks()); };
    form.Run();
  });
}

void NameForm::Print() {
  if (!ss1_->EndEdit()) return;
  TextTable table;
  table.layout.heading = "NAME FILE   " + MediumDate(services_.clock.Today());
  table.layout.columns = {"Item", "Code", "Name", "Class", "Other Details"};
  table.layout.at = {0, 0.08, 0.2, 0.64, 0.74};
  for (int row = 0; row < source_->RowCount(); ++row) {
    const NameRec& rec = editor_.rows()[size_t(row)];
    if (IsEmptyNameRow(rec)) continue;
    table.rows.push_back({Str(std::int32_t(row + 1)), NameCell(rec, NameColumn::kCode),
                          NameCell(rec, NameColumn::kName), NameCell(rec, NameColumn::kClass),
                          NameCell(rec, NameColumn::kDetails)});
  }
  services_.print(table, this);
}

void NameForm::reject() {
  if (!ss1_->EndEdit()) return;
  if (editor_.changed()) {
    const Answer answer =
        services_.dialogs.Ask(kNamesChanged, kNameFileTitle, Buttons::kYesNoCancel);
    if (answer == Answer::kCancel || (answer == Answer::kYes && !Save())) return;
  }
  QDialog::reject();
}

}  // namespace kora
