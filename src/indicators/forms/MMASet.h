#pragma once

#include <QDialog>
#include <array>
#include <cstdint>

#include "looks/forms/look_services.h"

class QLineEdit;

namespace kora {

// The twelve periods of the multiple moving averages.
class MMASet : public QDialog {
 public:
  MMASet(LookServices services, QWidget* parent);

 private:
  void Fill(const std::array<std::int16_t, 12>& periods);
  void Save();

  LookServices services_;
  QLineEdit* text1_[12];
};

}  // namespace kora
