#include "maintenance/forms/ADTotals.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>

#include "base/text.h"
#include "maintenance/data_checks.h"
#include "platform/qt/form_parts.h"

namespace kora {

ADTotals::ADTotals(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("ADTotals");
  setWindowTitle("Check Advance/Decline Totals");
  auto* rows = new QVBoxLayout(this);
  for (const char* text :
       {"This procedure checks Advance/Decline cumulative totals.(record type 3).",
        "The base of the Advance-Decline can be altered.",
        "It does not apply to the, already calculated, advance-declines issued by the ASX. eg "
        "ALODAD "})
    rows->addWidget(NewNote(this, text, 60));
  auto* grid = new QGridLayout;
  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  list1_->setAccessibleName("Advance/Declines");
  list1_->setMinimumWidth(fontMetrics().averageCharWidth() * 14);
  text1_ = NewField(this, "Text1", 12, 20);
  text1_->setText("0");
  grid->addWidget(list1_, 0, 0, 3, 1);
  grid->addWidget(NewLabel(this, "Advance/Decline &Base", text1_), 0, 1);
  grid->addWidget(text1_, 0, 2);
  state_ = new QLabel(this);
  state_->setObjectName("Label4");
  state_->setTextFormat(Qt::PlainText);
  grid->addWidget(state_, 1, 1, 1, 2);
  grid->setRowStretch(2, 1);
  grid->setColumnStretch(2, 1);
  rows->addLayout(grid, 1);
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command2", "Check &Totals", [this] { Check(); });
  buttons->Add("Command1", "&Close", [this] { reject(); })->setAutoDefault(false);
  rows->addLayout(buttons);
}

bool ADTotals::Fill() {
  list1_->clear();
  for (const std::string& code : AdvanceDeclines(services_.files, dataPath(), services_.dialogs))
    list1_->addItem(ToQt(FromAnsi(code)));
  list1_->setCurrentRow(0);
  return list1_->count() > 0;
}

void ADTotals::Check() {
  const QListWidgetItem* item = list1_->currentItem();
  if (!item) {
    list1_->setFocus();
    return;
  }
  state_->clear();
  const auto text = CheckTotals(services_.files, dataPath(), ToAnsi(item->text().toStdString()),
                                text1_->text().toStdString(), services_.dialogs);
  if (!text) {
    FocusField(text1_);
    return;
  }
  state_->setText(ToQt(*text));
  SetChanged();
}

}  // namespace kora
