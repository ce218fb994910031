#include "chartwindow/forms/Chart2.h"

#include <QComboBox>
#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QScrollBar>

namespace kora {

Chart2::Chart2(ChtSelServices services, QWidget* parent)
    : SelectionForm("Chart2", "Second Chart", std::move(services), parent) {
  text2_->setReadOnly(true);
  text2_->setFocusPolicy(Qt::NoFocus);

  auto* grid = new QGridLayout;
  grid->addWidget(AddCaption("&Type of Chart", combo1_), 0, 0);
  grid->addWidget(combo1_, 0, 1);
  grid->addWidget(AddCaption("&Period", combo4_), 0, 3);
  grid->addWidget(combo4_, 0, 4);
  grid->addWidget(label4_, 1, 0);
  grid->addWidget(SpacingRow(), 1, 1);
  grid->setColumnStretch(1, 1);
  grid->setColumnStretch(4, 1);
  grid->setColumnMinimumWidth(2, fontMetrics().averageCharWidth() * 3);

  auto* buttons = new QHBoxLayout;
  buttons->addStretch();
  buttons->addWidget(ok_);
  buttons->addWidget(command2_);

  auto* rows = new QVBoxLayout(this);
  rows->addWidget(label8_);
  rows->addLayout(SecurityRow());
  rows->addLayout(grid);
  rows->addStretch();
  rows->addLayout(buttons);

  QWidget* order[] = {text1_, vScroll1_, combo1_, combo4_, text3_, ok_, command2_};
  for (size_t i = 1; i < std::size(order); ++i) setTabOrder(order[i - 1], order[i]);

  services_.selection.LoadSecond();
  Refresh();
}

void Chart2::Leave() {
  const auto dropped = services_.secondDropped;
  QDialog::reject();
  if (dropped) dropped();
}

}  // namespace kora
