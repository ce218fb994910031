#include "maintenance/forms/DataStat.h"

#include <QKeyEvent>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>

#include "base/text.h"
#include "maintenance/forms/RTypeCk.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr int kCodeRole = Qt::UserRole;  // ANSI
constexpr int kLinesInView = 6;

}  // namespace

DataStat::DataStat(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("DataStat");
  setWindowTitle("Checking Data Files");
  auto* rows = new QVBoxLayout(this);
  AddState(rows, "Label1");
  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Messages");
  list1_->setUniformItemSizes(true);
  list1_->installEventFilter(this);
  list1_->addItem("X");
  list1_->setFixedHeight(kLinesInView * list1_->sizeHintForRow(0) + 2 * list1_->frameWidth());
  list1_->clear();
  list1_->setMinimumWidth(fontMetrics().averageCharWidth() * 70);
  connect(list1_, &QListWidget::itemClicked, this,
          [this](QListWidgetItem* item) { DropItem(list1_->row(item)); });
  rows->addWidget(list1_);
  rows->addStretch();
  AddPanel(rows);
  auto* buttons = new QHBoxLayout;
  const auto button = [&](const char* name, const char* caption, auto pressed) {
    auto* made = new QPushButton(caption, this);
    made->setObjectName(name);
    made->setAutoDefault(false);
    connect(made, &QPushButton::clicked, this, pressed);
    buttons->addWidget(made);
    return made;
  };
  command1_ = button("Command1", "Chec&k", [this] { Begin(); });
  command2_ = button("Command2", "&Print Messages List", [this] { Print(); });
  command3_ = button("Command3", "&Edit List", [this] { EditList(); });
  command4_ = button("Command4", "&Remove", [this] { Remove(); });
  buttons->addStretch();
  button("Command5", "&Close", [this] { reject(); });
  rows->addLayout(buttons);
  panel_->Hold({command1_, command2_, command3_, command4_});
  EnableButtons();
}

void DataStat::EnableButtons() {
  const bool any = list1_->count() > 0;
  command2_->setEnabled(any && services_.print);
  command3_->setEnabled(any);
  command4_->setEnabled(any);
}

void DataStat::Begin() {
  if (panel_->running()) return;
  if (types_) {
    types_->activateWindow();
    return;
  }
  types_ = new RTypeCk(services_.dialogs, this);
  types_->setAttribute(Qt::WA_DeleteOnClose);
  connect(types_, &QDialog::accepted, this, [this] {
    const auto types = types_->types();
    // The form of the kinds goes first.
    QMetaObject::invokeMethod(
        this, [this, types] { Check(types); }, Qt::QueuedConnection);
  });
  types_->open();
}

void DataStat::Check(const std::array<bool, 6>& types) {
  const QPointer<DataStat> here = this;
  list1_->clear();
  editing_ = false;
  EnableButtons();
  DataCheck check;
  Run([&](Progress& progress) {
    check =
        CheckDataFiles(services_.files, dataPath(), {.types = types}, progress, services_.dialogs);
  });
  if (!here) return;
  // What was shown as it came stands there with its codes.
  list1_->clear();
  for (size_t i = 0; i < check.messages.size(); ++i) {
    auto* item = new QListWidgetItem(ToQt(FromAnsi(check.messages[i])), list1_);
    item->setData(kCodeRole, QByteArray::fromStdString(check.codes[i]));
  }
  list1_->scrollToBottom();
  EnableButtons();
  if (check.repaired > 0) SetChanged();
}

void DataStat::Told(ProgressLine line, const std::string& text) {
  if (line != ProgressLine::kNote) return;
  list1_->addItem(ToQt(FromAnsi(text)));
  list1_->scrollToBottom();
}

void DataStat::Print() {
  TextTable table;
  table.layout.heading = "Data Check - Messages";
  table.layout.continued = "  (cont)";
  table.layout.pageLabel = "      Page  ";
  for (int i = 0; i < list1_->count(); ++i)
    table.rows.push_back({list1_->item(i)->text().toStdString()});
  panel_->Show("PRINTING  -  WAIT");
  services_.print(table, this);
  panel_->Show({});
}

void DataStat::EditList() {
  services_.dialogs.Message(
      "Click any stocks that you DON'T want deleted.\nThis will remove them from the list.\nThe "
      "remaining stocks can be removed by clicking the REMOVE button",
      "Edit List and Remove");
  editing_ = true;
  list1_->setFocus();
  if (!list1_->currentItem()) list1_->setCurrentRow(0);
}

void DataStat::DropItem(int row) {
  if (!editing_ || panel_->running()) return;
  delete list1_->takeItem(row);
  EnableButtons();
}

// What a click does, for those without a mouse.
bool DataStat::eventFilter(QObject* object, QEvent* event) {
  if (object == list1_ && event->type() == QEvent::KeyPress && editing_) {
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Delete || key == Qt::Key_Space) {
      if (list1_->currentRow() >= 0) DropItem(list1_->currentRow());
      return true;
    }
  }
  return QDialog::eventFilter(object, event);
}

void DataStat::Remove() {
  std::vector<std::string> codes;
  for (int i = 0; i < list1_->count(); ++i)
    codes.push_back(list1_->item(i)->data(kCodeRole).toByteArray().toStdString());
  if (!RemoveListed(services_.files, dataPath(), codes, services_.dialogs)) return;
  SetChanged();
  list1_->clear();
  editing_ = false;
  state_->clear();
  EnableButtons();
}

}  // namespace kora
