#pragma once

#include "chartwindow/forms/selection_form.h"

namespace kora {

// The second chart of a pair: which security, and how it is drawn. Not modal; leaving it leaves
// the first chart alone.
class Chart2 : public SelectionForm {
 public:
  Chart2(ChtSelServices services, QWidget* parent);

 protected:
  void Leave() override;
};

}  // namespace kora
