#include "companies/forms/ChtSnap.h"

#include <QComboBox>
#include <QLabel>
#include <QMenuBar>
#include <QTabWidget>
#include <QVBoxLayout>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr std::string_view kMoney = "0.00";

// A typed number, or nothing to take the place of one.
std::optional<Refusal> TakeNumber(std::string& field, const std::string& text) {
  const std::string_view number = Trim(text);
  if (!number.empty() && (!ParseFloat(number) || *ParseFloat(number) < 0))
    return Refusal{std::string(kSnapMustBeNumeric), std::string(kSnapshotTitle)};
  field = number;
  return std::nullopt;
}

std::optional<Refusal> TakeCode(std::vector<SnapshotRow>& rows, int row, const std::string& text) {
  const std::string code = KeptCode(UCase(Trim(text)));
  if (code.empty() || !IsFileCode(code))
    return Refusal{std::string(kCodeNotFound), std::string(kSnapshotTitle)};
  SnapshotRow& one = rows[size_t(row)];
  if (one.code != code) one.prices = {};  // they were another security's
  one.code = code;
  return std::nullopt;
}

}  // namespace

// The sheet of today's prices.
class ChtSnap::Prices : public GridSource {
 public:
  explicit Prices(std::vector<SnapshotRow>& rows) : rows_(rows) {}
  int RowCount() const override { return int(rows_.size()); }
  std::string Text(int row, int column) const override {
    const SnapshotRow& one = rows_[size_t(row)];
    if (column == 0) return one.code;
    if (column == 8) return one.code.empty() ? std::string() : std::string(1, one.kind);
    return one.prices[size_t(column - 1)];
  }
  std::string RowName(int row) const override { return rows_[size_t(row)].code; }
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override {
    if (column == 0) return TakeCode(rows_, row, text);
    const std::string kind = UCase(Trim(text));
    if (kind != "S" && kind != "I")
      return Refusal{"S   for stock or\nI for index ", std::string(kSnapshotTitle)};
    rows_[size_t(row)].kind = kind[0];
    return std::nullopt;
  }
  void DeleteRows(RowBlock block) override { RemoveBlock(rows_, block); }

 private:
  std::vector<SnapshotRow>& rows_;
};

// The sheet of what is held.
class ChtSnap::Holdings : public GridSource {
 public:
  explicit Holdings(std::vector<SnapshotRow>& rows) : rows_(rows) {}
  int RowCount() const override { return int(rows_.size()); }
  std::string Text(int row, int column) const override {
    const SnapshotRow& one = rows_[size_t(row)];
    if (column == 0) return one.code;
    if (column == 1) return one.units;
    if (column == 2) return one.cost;
    if (column == 6) return one.dividend;
    const auto held = HoldingOf(one);
    if (!held) return {};
    if (column == 3) return Format(held->price, "0.00#");
    return Format(column == 4 ? held->previousValue : held->value, kMoney);
  }
  std::string RowName(int row) const override { return rows_[size_t(row)].code; }
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override {
    SnapshotRow& one = rows_[size_t(row)];
    switch (column) {
      case 0: return TakeCode(rows_, row, text);
      case 1: return TakeNumber(one.units, text);
      case 2: return TakeNumber(one.cost, text);
      default: return TakeNumber(one.dividend, text);
    }
  }
  void DeleteRows(RowBlock block) override { RemoveBlock(rows_, block); }

 private:
  std::vector<SnapshotRow>& rows_;
};

ChtSnap::ChtSnap(ChtSnapServices services, QWidget* parent)
    : QDialog(parent),
      services_(std::move(services)),
      prices_(std::make_unique<Prices>(rows_)),
      holdings_(std::make_unique<Holdings>(rows_)) {
  setObjectName("ChtSnap");
  setWindowTitle(ToQt(kSnapshotTitle));
  combo1_ = new QComboBox(this);
  combo1_->setObjectName("Combo1");
  combo1_->addItems({"LIST 1", "LIST 2", "LIST 3"});
  auto* top = new QHBoxLayout;
  top->addWidget(NewLabel(this, "&List", combo1_));
  top->addWidget(combo1_);
  top->addStretch();
  label1_ = new QLabel(this);
  label1_->setObjectName("Label1");
  top->addWidget(label1_);

  sheets_ = new QTabWidget(this);
  sheets_->setObjectName("Sheets");
  const auto number = [](const char* heading, int chars, bool editable) {
    return GridColumn{.heading = heading, .chars = chars, .right = true, .editable = editable};
  };
  ss1_ = MakeGrid(*prices_,
                  {{.heading = "Code", .chars = 9, .limit = 6},
                   number("Last", 10, false),
                   number("Bid", 10, false),
                   number("Ask", 10, false),
                   number("Close", 10, false),
                   number("Volume", 13, false),
                   number("Trade", 10, false),
                   number("Today", 10, false),
                   {.heading = "Tag", .chars = 5, .limit = 1}},
                  "Snap_Form", "SS1");
  ss2_ = MakeGrid(*holdings_,
                  {{.heading = "Code", .chars = 9, .limit = 6},
                   number("Units", 11, true),
                   number("Unit Cost", 11, true),
                   number("Price", 11, false),
                   number("Previous", 14, false),
                   number("Latest", 14, false),
                   number("Dividend", 11, true)},
                  "Snap_Holdings", "SS2");
  ss1_->setAccessibleName("Current Equity Snapshot");
  ss2_->setAccessibleName("Holdings");
  sheets_->addTab(ss1_, "Current Equity &Snapshot");
  sheets_->addTab(ss2_, "&Holdings");
  label2_ = new QLabel(this);
  label2_->setObjectName("Label2");
  panel_ = new WorkPanel(this);
  auto* rows = new QVBoxLayout(this);
  rows->addLayout(top);
  rows->addWidget(sheets_);
  rows->addWidget(label2_);
  rows->addWidget(panel_);
  AddMenu();
  panel_->Hold({combo1_, sheets_, layout()->menuBar()});
  ChooseList(1);
  connect(combo1_, &QComboBox::activated, this, [this](int index) {
    if (index + 1 == list_) return;
    if (AskToSave()) ChooseList(index + 1);
    combo1_->setCurrentIndex(list_ - 1);
  });
  SizeInLetters(this, 110, 30);
}

// A cell that is open asks the rows once more as it goes.
ChtSnap::~ChtSnap() {
  delete ss1_;
  delete ss2_;
}

Grid* ChtSnap::MakeGrid(GridSource& source, std::vector<GridColumn> columns, const char* key,
                        const char* name) {
  auto* grid = new Grid(source,
                        {.dialogs = services_.snapshot.dialogs,
                         .files = services_.snapshot.files,
                         .widths = &services_.user,
                         .section = std::string(kUserSection),
                         .key = key},
                        std::move(columns), name, this);
  grid->SetZoom(services_.settings.Zoom);
  grid->SetDeletable(true);
  grid->changed = [this] { Changed(); };
  return grid;
}

Grid* ChtSnap::Front() const { return sheets_->currentIndex() == 0 ? ss1_ : ss2_; }

void ChtSnap::AddMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  QMenu* file = bar->addMenu("&File");
  file->setObjectName("csFile");
  AddEntry(this, file, "smSave", "&Save List ", [this] { Save(); });
  AddEntry(this, file, "csPage", "Page Set&up", [this] {
    services_.pageSetup(this);
  })->setEnabled(bool(services_.pageSetup));
  AddEntry(this, file, "csPnt", "&Print", [this] { Print(); })->setEnabled(bool(services_.print));
  AddEntry(this, file, "csExit", "&Close", [this] { reject(); });
  QMenu* edit = bar->addMenu("&Edit");
  edit->setObjectName("csEdit");
  AddEntry(this, edit, "csAdd", "&Add Row", [this] { Add(); });
  AddEntry(this, edit, "cdDel", "&Delete Row/s", [this] { Front()->DeleteSelected(); });
  for (int list = 1; list <= kSnapshotLists; ++list)
    AddEntry(this, edit, qPrintable(QString("csMove(%1)").arg(list)),
             qPrintable(QString("Move to LIST &%1").arg(list)), [this, list] { MoveTo(list); });
  QMenu* display = bar->addMenu("&Display");
  display->setObjectName("csDisp");
  AddEntry(this, display, "csSize", "&Size", [this] {
    if (!services_.changeSize) return;
    const int size = services_.changeSize(this);
    ss1_->SetZoom(size);
    ss2_->SetZoom(size);
  });
  QMenu* fetch = bar->addMenu("&Get Prices");
  AddEntry(this, fetch, "csFetchSnap", "&Get Snapshot Prices (Tarvo On-line)", [this] { Fetch(); });
}

void ChtSnap::ChooseList(int list) {
  try {
    stamp_ = StampOf(list);
    rows_ = ReadSnapshot(services_.snapshot.files, services_.snapshot.paths.SystemPath, list);
  } catch (const RunTimeError& e) {
    services_.snapshot.dialogs.Message(e.what(), kSnapshotTitle);
    rows_.clear();
  }
  list_ = list;
  changed_ = false;
  ss1_->Refresh();
  ss2_->Refresh();
  ss1_->GoTo(0, 0);
  ShowState();
}

FileStamp ChtSnap::StampOf(int list) const {
  return services_.snapshot.files.Stamp(SnapshotFile(services_.snapshot.paths.SystemPath, list));
}

bool ChtSnap::Save() {
  if (!ss1_->EndEdit() || !ss2_->EndEdit()) return false;
  const Files& files = services_.snapshot.files;
  try {
    const auto held = files.lock().Hold();
    if (StampOf(list_) != stamp_ &&
        services_.snapshot.dialogs.Ask(kListChangedOutside, kSnapshotTitle, Buttons::kYesNo) !=
            Answer::kYes)
      return false;
    SaveSnapshot(files, services_.snapshot.paths.SystemPath, list_, rows_);
    stamp_ = StampOf(list_);
    changed_ = false;
    return true;
  } catch (const RunTimeError& e) {
    services_.snapshot.dialogs.Message(e.what(), kSnapshotTitle);
    return false;
  }
}

bool ChtSnap::AskToSave() {
  if (!ss1_->EndEdit() || !ss2_->EndEdit()) return false;
  if (!changed_) return true;
  const Answer answer =
      services_.snapshot.dialogs.Ask(kSaveChanges, kSnapshotTitle, Buttons::kYesNoCancel);
  return answer == Answer::kNo || (answer == Answer::kYes && Save());
}

void ChtSnap::Add() {
  if (!Front()->EndEdit()) return;
  if (rows_.size() >= kMostSnapshotRows) {
    services_.snapshot.dialogs.Message(kTooManyRows, kSnapshotTitle);
    return;
  }
  rows_.emplace_back();
  Changed();
  Front()->GoTo(int(rows_.size()) - 1, 0);
  Front()->setFocus();
}

void ChtSnap::MoveTo(int list) {
  if (list == list_ || !Front()->EndEdit()) return;
  const RowBlock block = Front()->SelectedRows();
  if (block.count() < 1) return;
  const std::string question =
      "Move " + rows_[size_t(block.first)].code +
      (block.count() > 1 ? " to " + rows_[size_t(block.last)].code : std::string()) + " to LIST " +
      Str(std::int32_t(list)) + " ?";
  Dialogs& dialogs = services_.snapshot.dialogs;
  if (dialogs.Ask(question, kSnapshotTitle, Buttons::kYesNo) != Answer::kYes) return;
  try {
    const auto& [files, system] = std::pair<const Files&, const std::string&>(
        services_.snapshot.files, services_.snapshot.paths.SystemPath);
    const auto held = files.lock().Hold();  // from what is read to what is saved
    std::vector<SnapshotRow> there = ReadSnapshot(files, system, list);
    if (there.size() + size_t(block.count()) > kMostSnapshotRows) {
      dialogs.Message(kTooManyRows, kSnapshotTitle);
      return;
    }
    there.insert(there.end(), rows_.begin() + block.first, rows_.begin() + block.last + 1);
    // The other list first: a row that stands in both is better than one that is lost.
    SaveSnapshot(files, system, list, there);
    RemoveBlock(rows_, block);
    Save();
  } catch (const RunTimeError& e) {
    dialogs.Message(e.what(), kSnapshotTitle);
  }
  Changed();
}

void ChtSnap::Fetch() {
  if (!ss1_->EndEdit() || !ss2_->EndEdit()) return;
  panel_->Run("Getting prices - WAIT", [this](Progress& progress) {
    FetchSnapshot(services_.snapshot, list_, rows_, [&progress] { return progress.Step(0, 1); });
  });
  panel_->Show("");
  ss1_->Refresh();
  ss2_->Refresh();
  ShowState();
}

void ChtSnap::Print() {
  if (!ss1_->EndEdit() || !ss2_->EndEdit()) return;
  const std::string date = ShortMediumDate(services_.snapshot.clock.Today());
  TextTable table = ss1_->ToPrint("Current Equity Snapshot   " + date);
  table.layout.pageLabel = "   Page  ";
  table.rows.push_back({});
  table.rows.push_back(
      {"Times accessed today = " + Str(std::int32_t(SnapshotAccesses(services_.snapshot)))});
  table.rows.push_back({});
  table.rows.push_back({"Code", "Units", "Unit Cost", "Price", "Previous", "Latest", "Dividend"});
  for (int row = 0; row < holdings_->RowCount(); ++row) {
    const auto held = HoldingOf(rows_[size_t(row)]);
    if (!held) continue;
    std::vector<std::string> cells;
    for (int column = 0; column < 6; ++column) cells.push_back(holdings_->Text(row, column));
    cells.push_back(Format(held->dividends, kMoney));
    table.rows.push_back(std::move(cells));
  }
  const Holding sum = Totals(rows_);
  table.rows.push_back({"Total", "", "", "", Format(sum.previousValue, kMoney),
                        Format(sum.value, kMoney), Format(sum.dividends, kMoney)});
  services_.print(table, this);
}

void ChtSnap::Changed() {
  changed_ = true;
  ss1_->Refresh();
  ss2_->Refresh();
  ShowState();
}

void ChtSnap::ShowState() {
  label1_->setText(QString("Times accessed today = %1").arg(SnapshotAccesses(services_.snapshot)));
  const Holding sum = Totals(rows_);
  label2_->setText(ToQt("Holdings: previous " + Format(sum.previousValue, kMoney) + ", latest " +
                        Format(sum.value, kMoney) + ", gain " + Format(sum.gain, kMoney) +
                        ", dividends of a year " + Format(sum.dividends, kMoney)));
}

void ChtSnap::reject() {
  if (panel_->StopFirst() || !AskToSave()) return;
  QDialog::reject();
}

}  // namespace kora
