#pragma once

#include <QDialog>

#include "chartwindow/chart_scroll.h"

class QLabel;
class QSlider;

namespace kora {

// "Scroll Forwards / Backwards": where the chart ends. `scroll` is ready and not owned.
class KoraScroll : public QDialog {
 public:
  KoraScroll(ChartScroll& scroll, QWidget* parent = nullptr);

 private:
  void Show();

  ChartScroll& scroll_;
  QSlider* hScroll1_;
  QLabel* label1_;
};

}  // namespace kora
