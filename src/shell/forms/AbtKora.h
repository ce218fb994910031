#pragma once

#include <QDialog>

namespace kora {

// "About KORA".
class AbtKora : public QDialog {
 public:
  explicit AbtKora(QWidget* parent);
};

}  // namespace kora
