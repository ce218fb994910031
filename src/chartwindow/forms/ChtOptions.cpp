#include "chartwindow/forms/ChtOptions.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QListWidget>
#include <QPushButton>

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

  auto* choose = new QPushButton("&OK", this);
  choose->setObjectName("Command1");
  choose->setDefault(true);
  auto* close = new QPushButton("&Close", this);
  close->setObjectName("Command2");
  close->setAutoDefault(false);
  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  buttons->addWidget(choose);
  buttons->addWidget(close);

  auto* rows = new QVBoxLayout(this);
  rows->addWidget(list1_, 1);
  rows->addWidget(new QLabel("Current Selection", this));
  rows->addWidget(label1_);
  rows->addLayout(buttons);

  connect(list1_, &QListWidget::currentRowChanged, this, [this] { ShowChoice(); });
  connect(list1_, &QListWidget::itemDoubleClicked, choose, &QPushButton::click);
  connect(choose, &QPushButton::clicked, this, [this] { Choose(); });
  connect(close, &QPushButton::clicked, this, &QDialog::reject);
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
