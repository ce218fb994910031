#pragma once

#include <QDialog>

#include "adjust/forms/figure_form.h"

namespace kora {

// Takes the latest adjustment of the security on show out again.
class AdjustR : public QDialog {
 public:
  AdjustR(FigureFormServices services, QWidget* parent);

 private:
  void Proceed();

  FigureFormServices services_;
};

}  // namespace kora
