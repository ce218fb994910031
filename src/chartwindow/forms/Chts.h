#pragma once

#include <QMainWindow>
#include <QTimer>

#include "chartwindow/chart_window.h"
#include "platform/qt/picture_box.h"

namespace kora {

// Services of the window, less the surfaces, which are the form's own.
struct ChtsServices {
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  const ChartColours& colours;
  CurrentName& current;
};

// The chart window, a child of the main window.
class Chts : public QMainWindow {
 public:
  explicit Chts(const ChtsServices& services, QWidget* parent = nullptr);

  ChartWindow& window() { return window_; }
  // Shows the first chart. To be called once the form has its size.
  void Start();
  // After the data folder changed.
  void RefreshTitle();

 protected:
  void keyPressEvent(QKeyEvent* event) override;
  void closeEvent(QCloseEvent* event) override;

 private:
  void Step(int direction);
  void SurfaceResized();

  PictureBox* picture_;
  ChartWindow window_;
  const ChartColours& colours_;
  QTimer redraw_;
  bool composing_ = false;
};

}  // namespace kora
