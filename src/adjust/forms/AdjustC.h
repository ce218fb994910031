#pragma once

#include "adjust/forms/figure_form.h"

namespace kora {

// "Cash Issues"
class AdjustC : public FigureForm {
 public:
  AdjustC(FigureFormServices services, QWidget* parent);
};

}  // namespace kora
