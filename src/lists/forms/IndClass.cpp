#include "lists/forms/IndClass.h"

#include <QHeaderView>
#include <QTableWidget>
#include <QVBoxLayout>

#include "lists/forms/list_box.h"
#include "platform/qt/form_parts.h"

namespace kora {

IndClass::IndClass(const Files& files, Dialogs& dialogs, const std::string& systemPath,
                   QWidget* parent)
    : QDialog(parent) {
  setObjectName("IndClass");
  setWindowTitle("Industry Classification");
  std::vector<IndustryClass> classes;
  TellErrors(dialogs, "Industry Classification",
             [&] { classes = ReadIndustryClasses(files, systemPath); });

  grid_ = new QTableWidget(int(classes.size()), 2, this);
  grid_->setObjectName("SS1");
  grid_->setHorizontalHeaderLabels({"Class Id", "Industry Classification"});
  grid_->setEditTriggers(QAbstractItemView::NoEditTriggers);
  grid_->setSelectionBehavior(QAbstractItemView::SelectRows);
  grid_->setSelectionMode(QAbstractItemView::SingleSelection);
  grid_->setTabKeyNavigation(false);
  grid_->verticalHeader()->hide();
  grid_->horizontalHeader()->setHighlightSections(false);
  grid_->horizontalHeader()->setStretchLastSection(true);
  for (int row = 0; row < grid_->rowCount(); ++row) {
    const IndustryClass& one = classes[size_t(row)];
    grid_->setItem(row, 0, new QTableWidgetItem(QString::fromStdString(one.id)));
    grid_->setItem(row, 1, new QTableWidgetItem(QString::fromStdString(one.description)));
  }
  if (grid_->rowCount() > 0) grid_->selectRow(0);
  grid_->setMinimumSize(fontMetrics().averageCharWidth() * 55, fontMetrics().height() * 18);

  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Select", [this] { accept(); });
  buttons->Add("Command2", "&Close", [this] { reject(); });
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(grid_);
  rows->addLayout(buttons);

  connect(grid_, &QTableWidget::itemDoubleClicked, this, &QDialog::accept);
}

void IndClass::Select(const std::string& id) {
  for (int row = 0; row < grid_->rowCount(); ++row)
    if (grid_->item(row, 0)->text().toStdString() == id) grid_->selectRow(row);
}

std::string IndClass::chosen() const {
  const int row = grid_->currentRow();
  return row < 0 ? std::string() : grid_->item(row, 0)->text().toStdString();
}

}  // namespace kora
