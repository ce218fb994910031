#pragma once

#include "adjust/forms/figure_form.h"

namespace kora {

// "Calls on Contributing Shares"
class AdjustCC : public FigureForm {
 public:
  AdjustCC(FigureFormServices services, QWidget* parent);
};

}  // namespace kora
