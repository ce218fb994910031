#pragma once

#include <QDialog>

#include "looks/forms/look_services.h"

class QLabel;
class QLineEdit;
class QSlider;

namespace kora {

// "Blank Spaces": the room behind the last bar, and the days that make a week.
class BlankSpc : public QDialog {
 public:
  // `pixelsPerUnit`: of the chart on the screen, in the screen's own scale.
  BlankSpc(LookServices services, QWidget* parent, double pixelsPerUnit = 1);

 private:
  void ShowWeek();
  void Save();

  LookServices services_;
  QLineEdit* text1_;
  QSlider* slider1_;
  QLabel* label4_;
};

}  // namespace kora
