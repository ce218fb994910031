#pragma once

#include "adjust/forms/figure_form.h"

namespace kora {

// "Dividends"
class AdjustD : public FigureForm {
 public:
  AdjustD(FigureFormServices services, QWidget* parent);
};

}  // namespace kora
