#include "maintenance/forms/TxtData.h"

#include <QKeyEvent>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>

#include "base/text.h"
#include "platform/qt/form_parts.h"

namespace kora {

TxtData::TxtData(TxtDataServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("TxtData");
  setWindowTitle(ToQt("Remove Text   " + FromAnsi(services_.code)));
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(NewLabel(this, "To remove an item double click that item"));
  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Texts of the chart");
  list1_->setMinimumWidth(fontMetrics().averageCharWidth() * 50);
  list1_->installEventFilter(this);
  connect(list1_, &QListWidget::itemDoubleClicked, this,
          [this](QListWidgetItem* item) { Drop(list1_->row(item)); });
  rows->addWidget(list1_, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Save", [this] {
    if (SaveNotes(services_.files, services_.ChartMiscPath, services_.code, notes_,
                  services_.dialogs))
      Refresh();
  });
  auto* command3 = buttons->Add("Command3", "&Remove All", [this] {
    if (!RemoveAllNotes(services_.files, services_.ChartMiscPath, services_.code,
                        services_.dialogs))
      return;
    accept();
  });
  auto* command2 = buttons->Add("Command2", "&Close", [this] { reject(); });
  command3->setAutoDefault(false);
  command2->setAutoDefault(false);
  rows->addLayout(buttons);
}

bool TxtData::Fill() {
  auto notes =
      OpenNotes(services_.files, services_.ChartMiscPath, services_.code, services_.dialogs);
  if (!notes) return false;
  notes_ = std::move(*notes);
  for (const NoteLine& line : notes_.lines) list1_->addItem(ToQt(NoteListText(line)));
  list1_->setCurrentRow(0);
  return true;
}

void TxtData::Drop(int row) {
  if (row < 0) return;
  notes_.lines.erase(notes_.lines.begin() + row);
  delete list1_->takeItem(row);
}

// What a double click does, for those without a mouse.
bool TxtData::eventFilter(QObject* object, QEvent* event) {
  if (object == list1_ && event->type() == QEvent::KeyPress &&
      static_cast<QKeyEvent*>(event)->key() == Qt::Key_Delete) {
    Drop(list1_->currentRow());
    return true;
  }
  return QDialog::eventFilter(object, event);
}

void TxtData::Refresh() {
  if (services_.refresh) services_.refresh();
}

void TxtData::done(int result) {
  QDialog::done(result);
  Refresh();
}

}  // namespace kora
