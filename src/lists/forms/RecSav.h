#pragma once

#include <QDialog>

namespace kora {

// "Saved", closed by its timer. It takes neither the focus nor a place among the windows, and
// deletes itself.
class RecSav : public QDialog {
 public:
  explicit RecSav(QWidget* parent);
};

}  // namespace kora
