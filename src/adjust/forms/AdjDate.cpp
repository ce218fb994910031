#include "adjust/forms/AdjDate.h"

#include <QComboBox>
#include <QFontDatabase>
#include <QGridLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QPushButton>

#include "platform/qt/form_parts.h"

namespace kora {

AdjDate::AdjDate(const AdjustmentDates& dates, std::function<void(int)> chosen, QWidget* parent)
    : QDialog(parent) {
  setObjectName("AdjDate");
  setWindowTitle("Exercise Date");
  auto* grid = new QGridLayout(this);
  auto* combo1 = new QComboBox(this);
  combo1->setObjectName("Combo1");
  combo1->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
  combo1->setMaxVisibleItems(12);
  for (const std::string& line : dates.Lines) combo1->addItem(ToQt(line));
  combo1->setCurrentIndex(int(dates.Selected));
  grid->addWidget(NewLabel(this, "If Date and Price  incorrect select date required", combo1), 0,
                  0);
  grid->addWidget(combo1, 1, 0);
  grid->setRowStretch(2, 1);
  connect(combo1, &QComboBox::currentIndexChanged, this, std::move(chosen));
}

// Enter is done with the list: what was chosen stays.
void AdjDate::keyPressEvent(QKeyEvent* event) {
  if (event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter)
    accept();
  else
    QDialog::keyPressEvent(event);
}

}  // namespace kora
