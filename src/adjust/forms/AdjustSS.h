#pragma once

#include "adjust/forms/figure_form.h"

namespace kora {

// "Share Splits"
class AdjustSS : public FigureForm {
 public:
  AdjustSS(FigureFormServices services, QWidget* parent);
};

}  // namespace kora
