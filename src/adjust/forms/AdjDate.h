#pragma once

#include <QDialog>
#include <functional>

#include "adjust/adjust_date.h"

namespace kora {

// "Exercise Date": the records around the date wanted, one of which is chosen. `chosen` is told
// the line, from 0.
class AdjDate : public QDialog {
 public:
  AdjDate(const AdjustmentDates& dates, std::function<void(int)> chosen, QWidget* parent);

 protected:
  void keyPressEvent(QKeyEvent* event) override;
};

}  // namespace kora
