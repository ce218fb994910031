#include "update/forms/INUpList.h"

#include <QFontDatabase>
#include <QFrame>
#include <QGridLayout>
#include <QHeaderView>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QMenuBar>
#include <QPushButton>
#include <QRadioButton>
#include <QRegularExpressionValidator>
#include <QScreen>
#include <QStyledItemDelegate>
#include <QTableWidget>
#include <QTimer>
#include <set>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr int kSavedMs = 900;

// Takes what a code can be.
class CodeDelegate : public QStyledItemDelegate {
 public:
  using QStyledItemDelegate::QStyledItemDelegate;
  QWidget* createEditor(QWidget* parent, const QStyleOptionViewItem&,
                        const QModelIndex&) const override {
    auto* editor = new QLineEdit(parent);
    editor->setFrame(false);
    editor->setMaxLength(6);
    editor->setValidator(new QRegularExpressionValidator(
        QRegularExpression("[^,\"\\x00-\\x20]*"), editor));
    return editor;
  }
  void setModelData(QWidget* editor, QAbstractItemModel* model,
                    const QModelIndex& index) const override {
    const std::string code = static_cast<QLineEdit*>(editor)->text().toStdString();
    model->setData(index, ToQt(UCase(code)));
  }
};

}  // namespace

// It takes neither the focus nor a place among the windows.
RecSav::RecSav(QWidget* parent) : QDialog(parent, Qt::ToolTip) {
  setObjectName("RecSav");
  auto* frame = new QFrame(this);
  frame->setFrameStyle(QFrame::Box | QFrame::Raised);
  auto* around = new QVBoxLayout(this);
  around->setContentsMargins(0, 0, 0, 0);
  around->addWidget(frame);
  auto* box = new QVBoxLayout(frame);
  const int margin = fontMetrics().height() * 2;
  box->setContentsMargins(margin, margin / 2, margin, margin / 2);
  box->addWidget(new QLabel("Saved", frame), 0, Qt::AlignCenter);
  setAttribute(Qt::WA_DeleteOnClose);
  QTimer::singleShot(kSavedMs, this, [this] { close(); });
}

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

  ss1_ = new QTableWidget(0, 3, this);
  ss1_->setObjectName("SS1");
  ss1_->setHorizontalHeaderLabels({"ASX Code", "CAT.", "Name"});
  ss1_->horizontalHeader()->setStretchLastSection(true);
  ss1_->setMinimumWidth(fontMetrics().averageCharWidth() * 55);
  ss1_->setSelectionBehavior(QAbstractItemView::SelectRows);
  ss1_->setAccessibleName("Securities to update");
  ss1_->setTabKeyNavigation(false);
  ss1_->setWordWrap(false);
  ss1_->setItemDelegateForColumn(0, new CodeDelegate(ss1_));
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
  connect(ss1_, &QTableWidget::itemChanged, this, [this] {
    if (!loading_) changed_ = true;
  });

  AddMenu();
  SaveOrTell(services_.dialogs, windowTitle(), [this] {
    const auto rows = ReadUpdateList(services_.files, services_.settings.paths.SystemPath);
    ss1_->setRowCount(int(rows.size()));
    for (size_t i = 0; i < rows.size(); ++i) SetRow(int(i), rows[i]);
    return true;
  });
  LoadMaster();
  ShowChoice();
  loading_ = false;
  const QFontMetrics metrics = fontMetrics();
  resize(QSize(metrics.averageCharWidth() * 130, metrics.height() * 34)
             .boundedTo(screen()->availableSize() * 0.9));
  ss1_->setColumnWidth(0, metrics.averageCharWidth() * 14);
  ss1_->setColumnWidth(1, metrics.averageCharWidth() * 9);
}

void INUpList::AddMenu() {
  auto* bar = new QMenuBar(this);
  layout()->setMenuBar(bar);
  const auto entry = [this](QMenu* menu, const char* name, const char* caption, auto work) {
    QAction* action = menu->addAction(caption, this, work);
    action->setObjectName(name);
    return action;
  };
  QMenu* file = bar->addMenu("&File");
  entry(file, "ulSave", "&Save List", [this] { Save(this); });
  entry(file, "UlPrint", "&Print List", [this] { Print(); })->setEnabled(bool(services_.print));
  entry(file, "ulClose", "&Close", [this] { reject(); });
  QMenu* edit = bar->addMenu("&Edit");
  ulAdd_ = entry(edit, "ulAdd", "&Add Row/s", [this] {
    AddRow({});
    ss1_->setCurrentCell(ss1_->rowCount() - 1, 0);
    ss1_->setFocus();
  });
  ulDel_ = entry(edit, "ulDel", "&Delete Row/s", [this] { DeleteRows(); });
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
  ss1_->insertRow(ss1_->rowCount());
  SetRow(ss1_->rowCount() - 1, row);
}

void INUpList::SetRow(int at, const UpdateRow& row) {
  const std::string category = row.code.empty() ? "" : Format(double(row.category), "##0");
  ss1_->setItem(at, 0, new QTableWidgetItem(ToQt(row.code)));
  ss1_->setItem(at, 1, new QTableWidgetItem(ToQt(category)));
  ss1_->setItem(at, 2, new QTableWidgetItem(ToQt(row.name)));
}

std::vector<UpdateRow> INUpList::Rows() const {
  const auto text = [this](int row, int column) {
    const QTableWidgetItem* item = ss1_->item(row, column);
    return item ? item->text().toStdString() : std::string();
  };
  std::vector<UpdateRow> rows;
  for (int i = 0; i < ss1_->rowCount(); ++i) {
    const double category = Val(text(i, 1));
    rows.push_back({UCase(Trim(text(i, 0))),
                    category >= 0 && category <= 99 ? CInt(category) : std::int16_t(0),
                    std::string(Trim(text(i, 2)))});
  }
  return rows;
}

UpdateChoice INUpList::Choice() const {
  return options_[1]->isChecked()   ? UpdateChoice::kListed
         : options_[2]->isChecked() ? UpdateChoice::kNoWarrants
                                    : UpdateChoice::kAll;
}

// The grid lives, on white, while the list is in use; else it is locked and grey.
void INUpList::ShowChoice() {
  const bool live = Choice() == UpdateChoice::kListed;
  ss1_->setEditTriggers(live ? QAbstractItemView::DoubleClicked |
                                   QAbstractItemView::EditKeyPressed |
                                   QAbstractItemView::AnyKeyPressed
                             : QAbstractItemView::NoEditTriggers);
  QPalette colours = ss1_->palette();
  colours.setColor(QPalette::Base, live ? Qt::white : Qt::lightGray);
  colours.setColor(QPalette::Text, Qt::black);
  ss1_->setPalette(colours);
  command1_->setEnabled(live && !master_.Records.empty());
  ulAdd_->setEnabled(live);
  ulDel_->setEnabled(live);
}

void INUpList::AddChecked() {
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
  ss1_->sortItems(0);
}

void INUpList::DeleteRows() {
  std::set<int, std::greater<>> rows;
  for (const QModelIndex& index : ss1_->selectionModel()->selectedIndexes())
    rows.insert(index.row());
  for (const int row : rows) ss1_->removeRow(row);
  if (!rows.empty()) changed_ = true;
}

void INUpList::Print() {
  EndEditing();
  TextTable table{.layout = {.heading = "DOWNLOAD UPDATE LIST",
                             .continued = "  (cont)",
                             .columns = {"ASX Code", "CAT.", "Name"},
                             .at = {0, 0.15, 0.25}},
                  .rows = {}};
  for (const UpdateRow& row : Rows())
    if (!row.code.empty())
      table.rows.push_back({row.code, Format(double(row.category), "##0"), row.name});
  if (table.rows.empty()) {
    services_.dialogs.Message("No records to print", "Update List");
    return;
  }
  services_.print(table, this);
}

// What is being typed into a cell counts.
void INUpList::EndEditing() { ss1_->setFocus(); }

bool INUpList::Save(QWidget* over) {
  EndEditing();
  UpdateChoice choice = Choice();
  bool written = false;
  if (!SaveOrTell(services_.dialogs, windowTitle(), [&] {
        written = SaveUpdateList(services_.files, services_.settings.paths.SystemPath, Rows(),
                                 choice, services_.ini, services_.settings.download,
                                 services_.dialogs);
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
  EndEditing();
  if (changed_ && !Save(parentWidget()) &&
      services_.dialogs.Ask("The list could not be saved. Close without saving ?", "Update List",
                            Buttons::kYesNo) != Answer::kYes)
    return;
  QDialog::reject();
}

}  // namespace kora
