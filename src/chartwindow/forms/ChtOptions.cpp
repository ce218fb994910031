#include "chartwindow/forms/ChtOptions.h"

#include <QLabel>
#include <QListWidget>
#include <QPushButton>

#include "platform/qt/form_parts.h"

namespace kora {

ChtOptions::ChtOptions(const ChtOptionsServices& services, QWidget* parent)
    : QDialog(parent), selection_(services.selection) {
  setObjectName("ChtOptions");
  setWindowTitle("Viewing Options");
  entries_ = ListEntries(services.files, services.settings.paths.CurrentDataPath, services.user);

  list1_ = new QListWidget(this);
  list1_->setObjectName("List1");
  for (const ListEntry& entry : entries_) list1_->addItem(QString::fromStdString(entry.text));
  list1_->setMinimumSize(fontMetrics().averageCharWidth() * 40,
                         fontMetrics().height() * (int(entries_.size()) + 3));
  label1_ = new QLabel(this);
  label1_->setObjectName("Label1");
  label1_->setTextFormat(Qt::PlainText);
  label1_->setFrameStyle(QFrame::Panel | QFrame::Sunken);
  label1_->setMargin(fontMetrics().height() / 6);

  auto* buttons = new ButtonRow(this);
  QPushButton* choose = buttons->Add("Command1", "&OK", [this] { Choose(); });
  buttons->Add("Command2", "&Close", [this] { reject(); });

  auto* rows = new QVBoxLayout(this);
  rows->addWidget(list1_, 1);
  rows->addWidget(new QLabel("Current Selection", this));
  rows->addWidget(label1_);
  rows->addLayout(buttons);

  connect(list1_, &QListWidget::currentRowChanged, this, [this] { ShowChoice(); });
  connect(list1_, &QListWidget::itemDoubleClicked, choose, &QPushButton::click);
  list1_->setCurrentRow(services.chartListNo - kFullList);
}

void ChtOptions::ShowChoice() {
  const QListWidgetItem* item = list1_->currentItem();
  label1_->setText(item ? item->text() : QString());
}

void ChtOptions::Choose() {
  const int row = list1_->currentRow();
  selection_.ChooseList(row < 0 ? nullptr : &entries_[size_t(row)]);
  accept();
}

}  // namespace kora
