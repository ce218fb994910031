#pragma once

#include "adjust/forms/figure_form.h"

namespace kora {

// "Bonus Issue"
class AdjustB : public FigureForm {
 public:
  AdjustB(FigureFormServices services, QWidget* parent);
};

}  // namespace kora
