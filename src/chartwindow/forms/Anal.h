#pragma once

#include <QMainWindow>
#include <QTimer>
#include <array>
#include <functional>
#include <memory>
#include <vector>

#include "chart/chart_printing.h"
#include "chartwindow/multi_view.h"
#include "platform/qt/picture_box.h"

class QLabel;
class QPushButton;
class QScrollArea;

namespace kora {

struct AnalServices {
  MultiViewServices view;
  // Prints the script of the view; greyed while it is empty.
  std::function<void()> print = {};
  // The form that edits the sets: opened when the set on show has no oscillators, after this
  // form was closed.
  std::function<void()> openMultiOsc = {};
  // The form was left for the chart window.
  std::function<void()> returned = {};
};

// The multi-oscillator view: one price picture and the panels of a set below it.
class Anal : public QMainWindow {
 public:
  Anal(const AnalServices& services, int set, QWidget* parent = nullptr);
  ~Anal() override;

  MultiView& view() { return view_; }
  // The show button: draws the set on show, or asks for one where it has no oscillators.
  void Command2();
  void ShowSet(int set);
  void Leave();
  // Size of what is drawn, in chart units.
  ChartSize Size() const;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void closeEvent(QCloseEvent* event) override;

 private:
  void BuildMenu();
  void Draw();
  void ShowCaptions();
  void NamePictures();
  void Swap();
  void ToggleGrid();
  // Takes the lines of the grid from where they stand to a column; below 0 there are none.
  void MoveGrid(std::int32_t column);
  void FlipGrid();

  AnalServices s_;
  MultiView view_;
  QScrollArea* scroll_;
  QWidget* page_;
  PictureBox* picture1_;
  std::array<PictureBox*, kMultiOscSlots> picture2_{};
  std::vector<QLabel*> status_;
  QAction* amRet_ = nullptr;
  QAction* ampnt_ = nullptr;
  QAction* amSAn2_ = nullptr;
  QAction* amGrid_ = nullptr;
  QPushButton* command2_ = nullptr;
  QTimer resized_;
  int panels_ = 0;
  std::int32_t gridColumn_ = -1;
  bool busy_ = false;
};

}  // namespace kora
