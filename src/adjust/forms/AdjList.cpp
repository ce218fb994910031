#include "adjust/forms/AdjList.h"

#include <QHeaderView>
#include <QLabel>
#include <QMenuBar>
#include <QVBoxLayout>
#include <algorithm>

#include "adjust/forms/AdjOpts.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr const char* kTitle = "Adjustments List";
constexpr const char* kHint = "Click MAKE ADJUSTMENTS (above) to process maintenance data";
constexpr size_t kRowsInSight = 15;
constexpr size_t kShownColumns = 10;

std::vector<GridColumn> Columns() {
  std::vector<GridColumn> columns{{.heading = "Act", .chars = 5},  {.heading = "Code", .chars = 8},
                                  {.heading = "File", .chars = 9}, {.heading = "", .chars = 4},
                                  {.heading = "ADJ", .chars = 5},  {.heading = "Name", .chars = 34},
                                  {.heading = "", .chars = 14},    {.heading = "", .chars = 8},
                                  {.heading = "", .chars = 8},     {.heading = "", .chars = 8}};
  for (size_t i = columns.size(); i < kAdjustColumns; ++i)
    columns.push_back({.heading = "", .chars = 8, .hidden = true});
  for (GridColumn& column : columns) column.typing = "[^,]*";
  columns.back().editable = false;  // what a line has beyond stands there, with its commas
  return columns;
}

}  // namespace

// The list, or one row that says that it is empty.
class AdjList::Source : public GridSource {
 public:
  explicit Source(AdjustRows& rows) : rows_(rows) {}

  int RowCount() const override { return std::max(1, int(rows_.size())); }
  std::string Text(int row, int column) const override {
    if (rows_.empty()) return column == 0 ? std::string(kNoBulletinData) : std::string();
    const auto& fields = rows_[size_t(row)].fields;
    return size_t(column) < fields.size() ? FromAnsi(fields[size_t(column)]) : std::string();
  }
  GridShade Shade(int row, int) const override {
    return !rows_.empty() && rows_[size_t(row)].IsMarked('D') ? GridShade::kDone : GridShade::kNone;
  }
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override {
    if (rows_.empty()) return Refusal{};
    std::string ansi = ToAnsi(text);
    if (FromAnsi(ansi) != text)
      return Refusal{"\"" + text + "\" has letters that the list can't keep", kTitle};
    rows_[size_t(row)].Set(size_t(column) + 1, std::move(ansi));
    return std::nullopt;
  }
  std::optional<Refusal> MayDelete(RowBlock) const override {
    if (rows_.empty()) return Refusal{};
    return std::nullopt;
  }
  void DeleteRows(RowBlock block) override { RemoveBlock(rows_, block); }

 private:
  AdjustRows& rows_;
};

AdjList::AdjList(AdjListServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)), source_(std::make_unique<Source>(rows_)) {
  setObjectName("AdjList");
  setWindowTitle("KORA Data Mainenance");
  setWindowFlag(Qt::WindowMaximizeButtonHint);
  ss1_ = new Grid(*source_,
                  {.dialogs = services_.dialogs,
                   .files = services_.files,
                   .widths = &services_.user,
                   .section = std::string(kUserSection),
                   .key = "AdjList"},
                  Columns(), "SS1", this);
  ss1_->setAccessibleName("Adjustments list");
  ss1_->SetZoom(services_.settings.Zoom);
  ss1_->SetDeletable(true);
  ss1_->changed = [this] {
    changed_ = true;
    ShowRows();
  };
  auto* hint = new QLabel(kHint, this);
  hint->setObjectName("Label1");
  panel_ = new WorkPanel(this);
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(hint);
  rows->addWidget(ss1_);
  rows->addWidget(panel_);
  AddMenu();
  panel_->Hold({ss1_, bar_});
  SizeInLetters(this, 130, 32);
  ss1_->setFocus();
}

// A cell that is open asks the rows once more as it goes.
AdjList::~AdjList() { delete ss1_; }

void AdjList::AddMenu() {
  bar_ = new QMenuBar(this);
  layout()->setMenuBar(bar_);
  QMenu* file = bar_->addMenu("&File");
  AddEntry(this, file, "alSave", "&Save", [this] { Save(); })->setShortcut(QKeySequence::Save);
  AddEntry(this, file, "alPage", "Pa&ge Setup", [this] {
    services_.pageSetup(this);
  })->setEnabled(bool(services_.pageSetup));
  AddEntry(this, file, "alPrint", "&Print Adjustments List", [this] {
    Print();
  })->setEnabled(bool(services_.print));
  file->addSeparator();
  AddEntry(this, file, "alExit", "&Close", [this] { reject(); });

  QMenu* edit = bar_->addMenu("&Edit");
  AddEntry(this, edit, "alSort", "&Sort List", [this] { Sort(); });
  edit->addSeparator();
  for (const char letter : {'Y', 'N', 'D'})
    AddEntry(this, edit,
             letter == 'Y'   ? "alSetY"
             : letter == 'N' ? "alSetN"
                             : "alSetD",
             letter == 'Y'   ? "Set all ADJ items to Y"
             : letter == 'N' ? "Set all ADJ items to N"
                             : "Set all ADJ items to D",
             [this, letter] { Change([this, letter] { MarkAll(rows_, letter); }); });
  edit->addSeparator();
  AddEntry(this, edit, "rmOPTS", "Remove ASX.OPT and OPT from list",
           [this] { Change([this] { MarkOptions(rows_); }); });
  AddEntry(this, edit, "rmWNT", "Remove ASX.WNT and WNT from list",
           [this] { Change([this] { MarkWarrants(rows_); }); });
  edit->addSeparator();
  AddEntry(this, edit, "alDelRow", "&Delete Row/s", [this] { ss1_->DeleteSelected(); });

  const auto top = [this](const char* name, const char* caption, auto work) {
    QAction* action = bar_->addAction(caption, this, work);
    action->setObjectName(name);
    return action;
  };
  top("alopt", "Options", [this] {
    auto* options = new AdjOpts(services_.ini, services_.settings, this);
    options->setAttribute(Qt::WA_DeleteOnClose);
    options->open();
  });
  top("alDisplay", "&Display", [this] {
    ss1_->SetZoom(services_.changeSize(this));
  })->setEnabled(bool(services_.changeSize));
  top("muAdj", "&MAKE ADJUSTMENTS", [this] { Make(); });
  top("muRemAdj", "&Remove Items Marked D", [this] { RemoveMarked(); });
}

bool AdjList::Tell(const std::function<void()>& work) {
  try {
    work();
    return true;
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(e.what(), kTitle);
    return false;
  }
}

bool AdjList::Fill() {
  if (!CheckMarketFolders(services_.files, services_.settings, services_.dialogs)) return false;
  return Tell([this] {
    folder_ = AdjustFolder(services_.files, services_.settings);
    stamp_ = services_.files.Stamp(AdjustListPath(folder_));
    rows_ = ReadAdjustList(services_.files, folder_);
    changed_ = false;
    ShowColumns();
  });
}

// Columns beyond those that are used show where a line has them.
void AdjList::ShowColumns() {
  size_t most = kShownColumns;
  for (const AdjustRow& row : rows_) most = std::max(most, row.fields.size());
  for (size_t i = kShownColumns; i < kAdjustColumns; ++i) ss1_->SetColumnShown(int(i), i < most);
  ShowRows();
}

// The one row of an empty list has the width of them all for what it says.
void AdjList::ShowRows() {
  ss1_->clearSpans();
  if (rows_.empty()) ss1_->setSpan(0, 0, 1, int(kShownColumns));
  ss1_->Refresh();
}

void AdjList::Change(const std::function<void()>& work) {
  if (!ss1_->EndEdit() || rows_.empty()) return;
  work();
  changed_ = true;
  ss1_->Refresh();
}

void AdjList::Sort() {
  panel_->Show("SORTING Adjustments List   -  WAIT");
  Change([this] { SortAdjustments(rows_); });
  panel_->Show({});
}

// What another program did to the list meanwhile is lost only where the user says so.
bool AdjList::MayReplace() {
  return services_.files.Stamp(AdjustListPath(folder_)) == stamp_ ||
         services_.dialogs.Ask(
             "Another program changed the list meanwhile. Replace it by the list shown here ?",
             kTitle, Buttons::kYesNo) == Answer::kYes;
}

bool AdjList::Save() {
  if (!ss1_->EndEdit()) return false;
  bool saved = false;
  return Tell([&] {
           const auto held = services_.files.lock().Hold();
           if (!MayReplace()) return;
           WriteAdjustList(services_.files, folder_, rows_);
           stamp_ = services_.files.Stamp(AdjustListPath(folder_));
           changed_ = false;
           saved = true;
         }) &&
         saved;
}

void AdjList::RemoveMarked() {
  if (!ss1_->EndEdit()) return;
  Tell([this] {
    const auto held = services_.files.lock().Hold();
    if (!MayReplace()) return;
    AdjustRows left = rows_;
    RemoveDone(left);
    WriteAdjustList(services_.files, folder_, left);
    rows_ = ReadAdjustList(services_.files, folder_);
    stamp_ = services_.files.Stamp(AdjustListPath(folder_));
    changed_ = false;
    ShowRows();
  });
}

void AdjList::Make() {
  if (panel_->running() || !ss1_->EndEdit()) return;
  AdjustResult result;
  Tell([&] {
    const auto held = services_.files.lock().Hold();
    if (!MayReplace()) return;
    made_ = true;
    services_.dialogs.SetBusy(true);
    panel_->Run({}, [&](Progress& progress) {
      result = MakeAdjustments({.files = services_.files,
                                .settings = services_.settings,
                                .noteColour = services_.noteColour,
                                .progress = progress,
                                .rowDone =
                                    [this](size_t row) {
                                      ss1_->RefreshRow(int(row));
                                      if (row >= kRowsInSight) ss1_->GoTo(int(row), 0);
                                    }},
                               rows_, folder_);
    });
    stamp_ = services_.files.Stamp(AdjustListPath(folder_));
  });
  if (!made_) return;
  services_.dialogs.SetBusy(false);
  ShowRows();
  if (!result.begun) return;
  changed_ = false;
  if (services_.adjusted) services_.adjusted();
  if (const std::string text = FailuresText(result); !text.empty())
    services_.dialogs.Message(text, kTitle);
}

void AdjList::Print() {
  if (!ss1_->EndEdit()) return;
  if (rows_.empty()) {
    services_.dialogs.Message("No records to print", kTitle);
    return;
  }
  services_.print(ss1_->ToPrint("ADJUSTMENTS LIST"), this);
}

void AdjList::reject() {
  if (panel_->StopFirst() || !ss1_->EndEdit()) return;
  if (changed_) {
    const Answer answer =
        services_.dialogs.Ask("File has changed. SAVE Changes?", kTitle, Buttons::kYesNoCancel);
    if (answer == Answer::kCancel || (answer == Answer::kYes && !Save())) return;
  }
  const std::int16_t service = services_.settings.download.DataService;
  if (!made_ && !rows_.empty() && (service == 1 || service == 3) &&
      services_.dialogs.Ask(
          "You have not processed the adjustments.Do you want to process these now ?",
          "Process Adjustments", Buttons::kYesNo) == Answer::kYes) {
    Make();
    return;
  }
  QDialog::reject();
}

}  // namespace kora
