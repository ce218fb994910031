#include "update/forms/INUpList.h"

#include <QFontDatabase>
#include <QGridLayout>
#include <QHeaderView>
#include <QLabel>
#include <QListWidget>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <algorithm>
#include <set>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/forms/RecSav.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr const char* kCodeLetters = R"([^,"\x00-\x20]*)";

// What is no category is kept as 0.
std::int16_t CategoryOf(const std::string& text) {
  const double category = Val(text);
  return category >= 0 && category <= 99 ? CInt(category) : std::int16_t(0);
}
std::string CategoryText(std::int16_t category) { return Format(double(category), "##0"); }

}  // namespace

INUpList::INUpList(UpdateFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("INUpList");
  setWindowTitle("Download Update List");
  auto* grid = new QGridLayout(this);
  static constexpr const char* kOptions[] = {"Update ALL STOCKS",
                                             "Update ONLY the stocks listed below",
                                             "Update ALL stocks but exclude WARRANTS"};
  for (int i = 0; i < 3; ++i) {
    auto*& option = options_[size_t(i)];
    option = new QRadioButton(kOptions[i], this);
    option->setObjectName(QString("Option1(%1)").arg(i));
    grid->addWidget(option, i, 0, 1, 2, Qt::AlignLeft);
    connect(option, &QRadioButton::clicked, this, [this] {
      changed_ = true;
      ShowChoice();
    });
  }
  options_[size_t(UpdateChoiceOf(services_.settings.download))]->setChecked(true);

  rows_.check = [](int, int column, std::string& text) -> std::optional<Refusal> {
    if (column == 0) text = UCase(Trim(text));
    // As it will be kept.
    if (column == 1) text = CategoryText(CategoryOf(text));
    return std::nullopt;
  };
  ss1_ = new Grid(rows_, {.dialogs = services_.dialogs, .files = services_.files},
                  {{.heading = "ASX Code", .chars = 12, .limit = 6, .typing = kCodeLetters},
                   {.heading = "CAT.", .chars = 7},
                   {.heading = "Name"}},
                  "SS1", this);
  ss1_->horizontalHeader()->setStretchLastSection(true);
  ss1_->setMinimumWidth(fontMetrics().averageCharWidth() * 55);
  ss1_->setAccessibleName("Securities to update");
  ss1_->SetDeletable(true, false);
  ss1_->SetZoom(services_.settings.Zoom);
  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Master list");
  list1_->setUniformItemSizes(true);
  list1_->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));  // names stand in line
  command1_ = new QPushButton("&Add checked items", this);
  command1_->setObjectName("Command1");
  command1_->setAutoDefault(false);
  grid->addWidget(ss1_, 3, 0, 2, 1);
  grid->addWidget(list1_, 3, 1);
  grid->addWidget(command1_, 4, 1);
  grid->setColumnStretch(0, 3);
  grid->setColumnStretch(1, 2);
  connect(command1_, &QPushButton::clicked, this, [this] { AddChecked(); });
  ss1_->changed = [this] { changed_ = true; };

  AddMenu();
  SaveOrTell(services_.dialogs, windowTitle(), [this] {
    const auto rows = ReadUpdateList(services_.files, services_.settings.paths.SystemPath);
    for (const UpdateRow& row : rows) AddRow(row);
    return true;
  });
  ss1_->Refresh();
  LoadMaster();
  ShowChoice();
  SizeInLetters(this, 130, 34);
}

// A cell that is open asks the rows once more as it goes.
INUpList::~INUpList() { delete ss1_; }

void INUpList::AddMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  QMenu* file = bar->addMenu("&File");
  AddEntry(this, file, "ulSave", "&Save List", [this] { Save(this); });
  AddEntry(this, file, "UlPrint", "&Print List", [this] {
    Print();
  })->setEnabled(bool(services_.print));
  AddEntry(this, file, "ulClose", "&Close", [this] { reject(); });
  QMenu* edit = bar->addMenu("&Edit");
  ulAdd_ = AddEntry(this, edit, "ulAdd", "&Add Row/s", [this] {
    if (!ss1_->EndEdit()) return;
    AddRow({});
    ss1_->Refresh();
    ss1_->GoTo(rows_.RowCount() - 1, 0);
    ss1_->setFocus();
  });
  ulDel_ = AddEntry(this, edit, "ulDel", "&Delete Row/s", [this] { ss1_->DeleteSelected(); });
}

void INUpList::LoadMaster() {
  try {
    master_.Records = ReadMasterRecords(services_.files, services_.settings.paths.SystemPath);
  } catch (const RunTimeError&) {
    master_.Records.clear();  // shows as missing
  }
  if (master_.Records.empty()) {
    for (const std::string_view line : MasterMissingLines()) list1_->addItem(ToQt(line));
    return;
  }
  for (size_t i = 1; i <= master_.Records.size(); ++i) {
    const MasterEntry entry = master_.Entry(std::int32_t(i));
    auto* item = new QListWidgetItem(ToQt(PadRight(entry.code, 6) + "  " + entry.name), list1_);
    item->setFlags(item->flags() | Qt::ItemIsUserCheckable);
    item->setCheckState(Qt::Unchecked);
  }
}

void INUpList::AddRow(const UpdateRow& row) {
  rows_.rows.push_back({{row.code, row.code.empty() ? "" : CategoryText(row.category), row.name}});
}

std::vector<UpdateRow> INUpList::Rows() const {
  std::vector<UpdateRow> rows;
  for (int i = 0; i < rows_.RowCount(); ++i) {
    rows.push_back({UCase(Trim(rows_.Text(i, 0))), CategoryOf(rows_.Text(i, 1)),
                    std::string(Trim(rows_.Text(i, 2)))});
  }
  return rows;
}

UpdateChoice INUpList::Choice() const {
  return options_[1]->isChecked()   ? UpdateChoice::kListed
         : options_[2]->isChecked() ? UpdateChoice::kNoWarrants
                                    : UpdateChoice::kAll;
}

// The grid lives, on the ground of fields, while the list is in use; else it is locked and as the form
// around it.
void INUpList::ShowChoice() {
  const bool live = Choice() == UpdateChoice::kListed;
  ss1_->SetLocked(!live);
  ss1_->viewport()->setBackgroundRole(live ? QPalette::Base : QPalette::Window);
  command1_->setEnabled(live && !master_.Records.empty());
  ulAdd_->setEnabled(live);
  ulDel_->setEnabled(live);
}

void INUpList::AddChecked() {
  if (!ss1_->EndEdit()) return;
  std::set<std::string> there;
  for (const UpdateRow& row : Rows()) there.insert(row.code);
  for (int i = 0; i < list1_->count(); ++i) {
    if (list1_->item(i)->checkState() != Qt::Checked) continue;
    const std::string code(master_.Records[size_t(i)].Code.trimmed());
    if (!there.insert(code).second) continue;
    const MasterEntry entry = FindMaster(master_, code, LookUpStart(i + 1));
    AddRow({code, CInt(Val(entry.category)), entry.name});
    changed_ = true;
  }
  std::stable_sort(
      rows_.rows.begin(), rows_.rows.end(),
      [](const TextGrid::Row& a, const TextGrid::Row& b) { return a.cells[0] < b.cells[0]; });
  ss1_->Refresh();
}

void INUpList::Print() {
  if (!ss1_->EndEdit()) return;
  TextTable table{.layout = {.heading = "DOWNLOAD UPDATE LIST",
                             .continued = "  (cont)",
                             .columns = {"ASX Code", "CAT.", "Name"},
                             .at = {0, 0.15, 0.25}},
                  .rows = {}};
  for (const UpdateRow& row : Rows())
    if (!row.code.empty()) table.rows.push_back({row.code, CategoryText(row.category), row.name});
  if (table.rows.empty()) {
    services_.dialogs.Message("No records to print", "Update List");
    return;
  }
  services_.print(table, this);
}

// What is being typed into a cell counts.
bool INUpList::Save(QWidget* over) {
  if (!ss1_->EndEdit()) return false;
  UpdateChoice choice = Choice();
  bool written = false;
  if (!SaveOrTell(services_.dialogs, windowTitle(), [&] {
        written =
            SaveUpdateList(services_.files, services_.settings.paths.SystemPath, Rows(), choice,
                           services_.ini, services_.settings.download, services_.dialogs);
        return true;
      }))
    return false;
  options_[size_t(choice)]->setChecked(true);
  ShowChoice();
  changed_ = false;
  if (written && over) (new RecSav(over))->show();
  return true;
}

void INUpList::reject() {
  if (!ss1_->EndEdit()) return;
  if (changed_ && !Save(parentWidget()) &&
      services_.dialogs.Ask("The list could not be saved. Close without saving ?", "Update List",
                            Buttons::kYesNo) != Answer::kYes)
    return;
  QDialog::reject();
}

}  // namespace kora
