#include "scans/forms/Statistics.h"

#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>
#include <QMenuBar>
#include <QPointer>
#include <QPushButton>
#include <QRadioButton>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/to_qt.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr int kSide = 6;  // columns of the rises, and of the falls

// Shows what is done in Label1 as well.
class Shown : public Progress {
 public:
  Shown(Progress& inner, QLabel* label) : inner_(inner), label_(label) {}
  void Show(ProgressLine line, std::string_view text) override {
    inner_.Show(line, text);
    if (line == ProgressLine::kState && label_) label_->setText(ToQt(text));
  }
  bool Step(int done, int total) override { return inner_.Step(done, total); }

 private:
  Progress& inner_;
  QPointer<QLabel> label_;
};

}  // namespace

Statistics::Statistics(ScanFormServices services, const Clock& clock, QWidget* parent)
    : ScanForm(std::move(services), parent), clock_(clock) {
  setObjectName("Statistics");
  setWindowTitle("Top Movers by Percentage");
  std::vector<GridColumn> columns;
  for (int i = 0; i < 2 * kSide; ++i) {
    const std::string side = i % kSide == 0 ? (i == 0 ? "RISES" : "FALLS") : "";
    const int place = i % kSide;
    columns.push_back({.heading = side + "\n" + StatsColumns()[size_t(i)],
                       .chars = place == 1   ? 24
                                : place == 2 ? 7
                                             : 10,
                       .right = place > 2,
                       .editable = false});
  }
  LayOut(Criteria(), "SS1", std::move(columns), "Statistics", rows_);
  grid_->SetWholeRows(false);
  command1_->setText("&Update Statistics");
  AddMenu();
  ShowTexts(KeptStats(services_.files, dataPath()));
  SizeInLetters(this, 160, 36);
}

QWidget* Statistics::Criteria() {
  auto* box = new QWidget(this);
  auto* grid = new QGridLayout(box);
  grid->setContentsMargins(0, 0, 0, 0);
  static constexpr const char* kCaptions[] = {"Check A&LL stocks", "Check only FP &shares",
                                              "Do N&OT check Warrants", "Check &Warrants only"};
  for (size_t i = 0; i < options_.size(); ++i) {
    options_[i] = new QRadioButton(kCaptions[i], this);
    options_[i]->setObjectName(QString("Option1(%1)").arg(i));
    grid->addWidget(options_[i], int(i) / 2, int(i) % 2);
  }
  options_[0]->setChecked(true);
  text1_ = NewText("Text1", "How many to show", "", 5);
  text1_->setEnabled(true);
  text1_->setPlaceholderText("20");
  grid->addWidget(NewLabel(this, "&Top", text1_), 0, 2);
  grid->addWidget(text1_, 0, 3);
  label1_ = new QLabel(this);
  label1_->setObjectName("Label1");
  grid->addWidget(label1_, 1, 2, 1, 3);
  grid->setColumnStretch(4, 1);
  return box;
}

void Statistics::AddMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  const auto menu = [&](const char* name, const char* caption) {
    QMenu* m = bar->addMenu(caption);
    m->setObjectName(name);
    return m;
  };
  QMenu* file = menu("nmFile", "&File");
  AddEntry(this, file, "nfPage", "Pa&ge Setup", [this] {
    services_.pageSetup();
  })->setEnabled(bool(services_.pageSetup));
  AddEntry(this, file, "nmPrint", "&Print", [this] {
    PrintHits();
  })->setEnabled(bool(services_.print));
  AddEntry(this, file, "nmQuit", "&Close", [this] { reject(); });
  AddEntry(this, menu("mnDisp", "&Display"), "mnUpStats", "&Update Statistics",
           [this] { Proceed(); });
  panel_->Hold({bar});
}

StatsMode Statistics::Mode() const {
  for (size_t i = 0; i < options_.size(); ++i)
    if (options_[i]->isChecked()) return StatsModes()[i].mode;
  return StatsMode::kAll;
}

void Statistics::ShowTexts(const std::vector<std::vector<std::string>>& texts) {
  texts_ = texts;
  rows_.rows.clear();
  for (const auto& line : texts) {
    TextGrid::Row row;
    for (const std::string& cell : line) row.cells.push_back(FromAnsi(cell));
    rows_.rows.push_back(std::move(row));
  }
  grid_->Refresh();
}

void Statistics::Proceed() {
  const QPointer<Statistics> here = this;
  MarketStats statistics;
  bool done = false;
  RunScan(ToQt(kStatsTitle), [&](Progress& progress) {
    ShowTexts({});
    Shown shown(progress, label1_);
    if (!services_.files.CheckFile(NameFilePath(dataPath()))) {
      services_.dialogs.Message(kNoNameFile, kStatsTitle);
      return;
    }
    try {
      statistics = ShowStats(Scan(shown), Mode(), StatsTop(text1_->text().toStdString()));
      done = true;
    } catch (const RunTimeError& e) {
      services_.dialogs.Message(StatsErrorText(e), "Error");
    }
  });
  if (!here) return;
  if (!done || statistics.stopped) {
    label1_->clear();
    ShowTexts(KeptStats(services_.files, dataPath()));
    return;
  }
  ShowTexts(StatsTexts(statistics));
  try {
    KeepStats(services_.files, dataPath(), texts_);
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(StatsErrorText(e), "Error");
  }
  if (const std::string unread = UnreadText(statistics.unread); !unread.empty())
    services_.dialogs.Message(unread, kStatsTitle);
  if (here) grid_->setFocus();
}

void Statistics::OpenRow(int row) {
  if (panel_->running() || !services_.openRecord) return;
  // A row of movers has all columns; of its two securities the one under the cell is meant.
  const auto& cells = texts_[size_t(row)];
  if (cells.size() < 2 * kSide) return;
  const std::string code = cells[grid_->CurrentColumn() >= kSide ? kSide : 0];
  NameRec found;
  try {
    const NameFile names(services_.files, NameFilePath(dataPath()));
    if (const std::int16_t number = FindCode(names, PadRight(code, 6), found))
      services_.openRecord(number);
    else
      services_.dialogs.Message("No File For That Name", "Name File");
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(StatsErrorText(e), "Error");
  }
}

void Statistics::PrintHits() {
  services_.print(StatsPrint(texts_, MediumDate(clock_.Today())), this);
}

}  // namespace kora
