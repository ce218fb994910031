#include "scans/forms/chtScan1.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QPushButton>
#include <algorithm>

#include "base/numbers.h"
#include "base/text.h"
#include "base/version.h"
#include "lists/forms/RecSav.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

enum Column { kCode, kLast, kPercent, kRecord = 8 };
constexpr const char* kSetting = "Scan1_Other";

}  // namespace

bool chtScan1::Hits::Sort(int column, bool descending) {
  std::vector<Row> sorted;
  if (column == kPercent) {
    std::vector<std::string> cells;
    for (int i = 0; i < RowCount(); ++i) cells.push_back(Text(i, kPercent));
    for (const size_t i : SortByPercentage(cells)) sorted.push_back(rows[i]);
    if (descending) std::reverse(sorted.begin(), sorted.end());
  } else {
    sorted = rows;
    const bool numbers = column == kLast || column == kRecord;
    std::stable_sort(sorted.begin(), sorted.end(), [&](const Row& a, const Row& b) {
      const auto& x = (descending ? b : a).cells[size_t(column)];
      const auto& y = (descending ? a : b).cells[size_t(column)];
      return numbers ? Val(x) < Val(y) : x < y;
    });
  }
  rows = std::move(sorted);
  return true;
}

chtScan1::chtScan1(ScanFormServices services, QWidget* parent)
    : ScanForm(std::move(services), parent) {
  setObjectName("chtScan1");
  setWindowTitle(
      "Indicates rises and falls over a selected magnitude and new buy/sell signals from selected "
      "indicators");
  Scan1Choices kept;
  TakeKeptScan1(services_.user.GetSetting(kUserSection, kSetting), kept);

  rows_.shade = [this](int row, int column) {
    const std::string text = rows_.Text(row, column);
    return column == kPercent && text.ends_with("D") ? GridShade::kFall : GridShade::kNone;
  };
  rows_.rowName = [this](int row) { return rows_.Text(row, kCode); };
  std::vector<GridColumn> columns;
  for (const std::string& heading : Scan1Columns())
    columns.push_back({.heading = heading, .chars = 11, .editable = false});
  columns[kCode].chars = 8;
  columns[kLast].chars = columns[kPercent].chars = columns[kRecord].chars = 8;
  columns[kLast].right = columns[kPercent].right = columns[kRecord].right = true;
  LayOut(Criteria(kept), "SS1", std::move(columns), "Scan1_Form", rows_);
  grid_->SetSortable(true);
  grid_->SetDeletable(true);
  grid_->rightClicked = [this](int row) {
    const RowBlock selected = grid_->SelectedRows();
    if (row < selected.first || row > selected.last) grid_->SelectRows({row, row});
    grid_->DeleteSelected();
  };
  command3_->setEnabled(false);
}

QWidget* chtScan1::Criteria(const Scan1Choices& kept) {
  auto* all = new QWidget(this);
  auto* beside = new QHBoxLayout(all);
  beside->setContentsMargins(0, 0, 0, 0);
  beside->setSpacing(4);
  const auto group = [&](const char* title) {
    auto* box = new QGroupBox(title, all);
    beside->addWidget(box);
    auto* grid = new QGridLayout(box);
    // Three groups beside one another have to go onto a small screen.
    grid->setContentsMargins(4, 6, 4, 6);
    grid->setHorizontalSpacing(4);
    return grid;
  };

  QGridLayout* which = group("Securities");
  text3_ = NewText("Text3", "Lowest price", kept.Text3, 4);
  text2_ = NewText("Text2", "Highest price", kept.Text2, 4);
  text1_ = NewText("Text1", "Rise in percent", kept.Text1, 4);
  text6_ = NewText("Text6", "Fall in percent", kept.Text6, 4);
  text4_ = NewText("Text4", "Category", kept.Text4, 4);
  text5_ = NewText("Text5", "Industry class", kept.Text5, 4);
  check7_ = AddCheck(which, 0, "Check7", "By closin&g price range", kept.Check7, {text3_, text2_});
  check1_ = AddCheck(which, 1, "Check1", "Percentage Ris&e", kept.Check1, {text1_});
  check15_ = AddCheck(which, 2, "Check15", "Percentage &Fall", kept.Check15, {text6_});
  check8_ = AddCheck(which, 3, "Check8", "Chec&k only Category ", kept.Check8, {text4_});
  check14_ = AddCheck(which, 4, "Check14", "Check only &Industry Class ", kept.Check14, {text5_});
  check16_ = AddCheck(which, 5, "Check16", "Do not check &warrants", kept.Check16);
  connect(text5_, &QLineEdit::editingFinished, this, [this] { LeaveText5(); });

  QGridLayout* oscillators = group("Oscillators");
  static constexpr const char* kNames[] = {"Check2", "Check3", "Check5", "Check6", "Check13"};
  static constexpr const char* kCaptions[] = {"&Stochastic ", "Wi&lliams %R", "Rate of Cha&nge",
                                              "&Momentum", "RSI"};
  for (size_t i = 0; i < kScanOscillators; ++i)
    oscillators_[i] = AddCheck(oscillators, int(i), kNames[i], kCaptions[i], false);
  QGridLayout* signals_ = group("Signals");
  check9_ = AddCheck(signals_, 0, "Check9", "&OB (over bought)", false);
  check12_ = AddCheck(signals_, 1, "Check12", "C&ut OB (up or down)", false);
  check10_ = AddCheck(signals_, 2, "Check10", "OS (over sol&d)", false);
  check11_ = AddCheck(signals_, 3, "Check11", "Cut OS (up or down) ", false);
  auto* caption = new QLabel("Latest date", this);
  label8_ = new QLabel(this);
  label8_->setObjectName("Label8");
  signals_->addWidget(caption, 4, 0);
  signals_->addWidget(label8_, 5, 0);
  oscillators->setRowStretch(kScanOscillators, 1);
  return all;
}

Scan1Choices chtScan1::Choices() const {
  const auto text = [](const QLineEdit* field) { return field->text().toStdString(); };
  Scan1Choices c;
  c.Check7 = check7_->isChecked();
  c.Text3 = text(text3_);
  c.Text2 = text(text2_);
  c.Check1 = check1_->isChecked();
  c.Text1 = text(text1_);
  c.Check15 = check15_->isChecked();
  c.Text6 = text(text6_);
  c.Check8 = check8_->isChecked();
  c.Text4 = text(text4_);
  c.Check14 = check14_->isChecked();
  c.Text5 = text(text5_);
  c.Check16 = check16_->isChecked();
  for (size_t i = 0; i < kScanOscillators; ++i) c.oscillators[i] = oscillators_[i]->isChecked();
  c.Check9 = check9_->isChecked();
  c.Check12 = check12_->isChecked();
  c.Check10 = check10_->isChecked();
  c.Check11 = check11_->isChecked();
  return c;
}

void chtScan1::LeaveText5() {
  if (!text5_->isModified()) return;
  text5_->setModified(false);
  if (const auto padded = PaddedIndustry(text5_->text().toStdString())) {
    text5_->setText(ToQt(*padded));
    return;
  }
  services_.dialogs.Message(kIndustryNotNumeric, "Chart Scan");
  FocusField(text5_);
}

void chtScan1::Proceed() {
  Scan1Criteria criteria;
  if (const auto fault = ReadScan1(Choices(), services_.settings.osc, criteria)) {
    Tell(*fault);
    return;
  }
  const QPointer<chtScan1> here = this;
  Scan1Result result;
  bool done = false;
  RunScan(ToQt(kScan1Title), [&](Progress& progress) {
    rows_.rows.clear();
    grid_->Refresh();
    label8_->clear();
    noHits_ = true;
    wanted_ = false;
    result = RunScan1(Scan(progress), criteria, [&](const Scan1Hit& hit) {
      if (!here) return;
      noHits_ = false;
      rows_.rows.push_back({CellsOf(hit)});
      RowAdded();
    });
    done = true;
  });
  if (!here || !done) return;
  label8_->setText(ToQt(LatestText(result.latest)));
  command3_->setEnabled(bool(services_.print));
  if (result.stopped) {
    wanted_ = !noHits_ && AskStopped(kScan1Title);
    if (here && wanted_) SaveGrid();
    return;
  }
  wanted_ = !noHits_;
  if (wanted_ && !SaveGrid()) return;
  TellEnd(kScan1Title, Scan1Ending(criteria, !noHits_), result.unread);
  if (here && !noHits_) grid_->setFocus();
}

bool chtScan1::SaveGrid() {
  return Store(kScan1Title, [this] {
    std::vector<ResultEntry> entries;
    for (int i = 0; i < rows_.RowCount(); ++i)
      entries.push_back({rows_.Text(i, kCode), CLng(Val(rows_.Text(i, kRecord)))});
    SaveScan(services_.files, dataPath(), entries);
  });
}

void chtScan1::OpenRow(int row) {
  if (panel_->running()) return;
  if (!wanted_) {
    if (services_.openRecord) services_.openRecord(CLng(Val(rows_.Text(row, kRecord))));
    return;
  }
  // The list as the grid has it now: rows may have gone, or changed places.
  if (SaveGrid() && services_.openResult) services_.openResult(CInt(row + 1.0));
}

void chtScan1::PrintHits() {
  if (rows_.rows.empty()) {
    services_.dialogs.Message("No records to print", "Analysis Results");
    return;
  }
  TextTable table = grid_->ToPrint("ANALYSIS RESULTS  " + std::string(kProgramTitle));
  table.layout.pageLabel = "Page ";
  table.layout.columns.pop_back();  // the record numbers
  table.layout.at.pop_back();
  for (auto& row : table.rows) row.pop_back();
  panel_->Show("PRINTING ANALYSIS RESULTS -  WAIT");
  services_.print(table, this);
  panel_->Show({});
}

bool chtScan1::Leave() {
  if (wanted_ && SaveGrid()) (new RecSav(parentWidget() ? parentWidget() : this))->show();
  services_.user.PutSetting(kUserSection, kSetting, KeptScan1(Choices()));
  return true;
}

}  // namespace kora
