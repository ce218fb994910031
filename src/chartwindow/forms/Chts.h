#pragma once

#include <QMainWindow>
#include <QSizeF>
#include <QTimer>
#include <array>
#include <functional>
#include <map>
#include <optional>
#include <string>

#include "chartwindow/chart_scroll.h"
#include "chartwindow/chart_window.h"
#include "platform/qt/picture_box.h"

class QFrame;
class QLabel;
class QPushButton;
class QToolBar;
class QWheelEvent;

namespace kora {

// Services of the window, less the surfaces, which are the form's own.
struct ChtsServices {
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  SettingsFile& ini;
  SettingsFile& user;
  const ChartColours& colours;
  CurrentName& current;
  ChartState& state;

  // The forms of others, by the entry that opens them: "cmChtDef", "cmColours", "cmfonts",
  // "cmBSpaces", "cmGLSpaces", "cmLineWidth", "cmVHeight", "cmMMASet", "cmuSwingsettings", "cmChtSpaces" (the tool
  // bar's "cspace" too), "cmSLInd"; "new" for chart selection, "Chart2" for the second chart of
  // a pair, "OscFrm" for the settings box. They run until the form is closed, but for Chart2
  // which may stand beside the window, and call Refresh(), ShowChosen() or, as OscFrm does,
  // window().ShowOscillator() as what they change asks for. An entry without one is greyed.
  std::map<std::string, std::function<void()>> forms = {};

  // Ask for a file: DOS paths, nothing when cancelled. Empty: the platform's own dialogs.
  std::function<std::optional<std::string>(const std::string& suggested)> pickSaved = {};
  std::function<std::optional<std::string>()> pickToShow = {};
  // The unit of a security's volumes; none while it is empty.
  std::function<std::string(const NameRec&)> VolumeUnitText = {};
  // The window was closed by its user.
  std::function<void()> closed = {};
  // What the zoom stands over; empty for this window.
  std::function<QWidget*()> zoomOver = {};
};

// The chart window, a child of the main window.
class Chts : public QMainWindow {
 public:
  explicit Chts(const ChtsServices& services, QWidget* parent = nullptr);
  ~Chts() override;

  ChartWindow& window() { return window_; }
  const ChartColours& colours() const { return s_.colours; }
  // Gives an entry its form, or takes it away.
  void SetForm(const std::string& entry, std::function<void()> open);

  // Shows the first chart. To be called once the form has its size.
  void Start();
  // The chart at ChartIndex, as chart selection has left it.
  void ShowChosen();
  // The current chart once more.
  void Refresh();
  // Chart selection was left without a choice.
  void BackToChart();
  // A saved chart by its DOS path.
  void ShowSavedFile(const std::string& path);
  // The second chart of a pair was not chosen: the first is drawn alone again.
  void DropSecondChart();
  // After the data folder changed.
  void RefreshTitle();
  // Size of the chart on show in its units, the oscillator below it included.
  QSizeF ChartSize() const;
  // The chart as a picture: both panes.
  QImage Picture();

 protected:
  bool event(QEvent* event) override;
  bool eventFilter(QObject* object, QEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void closeEvent(QCloseEvent* event) override;

 private:
  struct Area;

  void BuildMenus();
  void BuildToolBar();
  void BuildStatusBar();
  void BuildFrame();
  // What an entry does, if the window can do it by itself or by a form of others.
  std::function<void()> DeedOf(const std::string& entry);
  void EnableEntries();
  void Trigger(const std::string& entry);

  // Runs one thing that the user asked for and shows what came of it. While a message of it
  // stands nothing else starts.
  template <typename Deed>
  void Do(Deed deed);
  void ShowView();
  bool ShownOn(int button) const;
  void ShowStatus();
  void LayOut(bool twoPanes);
  void PlaceLegend();
  void SizeChanged();
  void OpenForm(const std::string& entry);
  void SaveAs();
  void ShowSaved();
  void CopyPicture();
  std::string MakePictureFile(const std::string& path);
  void CloseWindow();
  bool OpenMenuByKey(QKeyEvent* event, bool open);
  void TakeWheel(const QWheelEvent& wheel);
  void TurnWheel();
  bool PictureEvent(PictureBox* picture, QEvent* event);
  bool ToolKey(QKeyEvent* event);
  TrendChoice PopUpTrend();
  void OpenZoom(const ZoomBox& box);
  void OpenScroll();
  bool FrameEvent(QEvent* event);
  void TouchLine(const Surface& surface, double x1, double y1, double x2, double y2);

  ChtsServices s_;
  QWidget* area_;
  PictureBox* picture1_;
  PictureBox* picture2_;
  PictureBox* picture4_;
  QFrame* frame1_ = nullptr;
  QLabel* label1_ = nullptr;
  QToolBar* toolbar1_ = nullptr;
  std::array<QLabel*, ChartWindowView::kPanels> status_{};
  std::map<std::string, QAction*> entries_;
  ChartWindow window_;
  ChartScroll scroll_;
  QTimer resized_;
  QTimer timer1_;
  enum class WheelUse { kBar, kMonth, kSpacing };
  QTimer wheeled_;
  WheelUse wheelUse_ = WheelUse::kBar;
  int wheelAngle_ = 0;  // turned and not used yet
  bool twoPanes_ = false;
  bool busy_ = false;
  bool closed_ = false;
  bool sizeWaits_ = false;
  bool frameStood_ = false;  // it was shown where it is
  QPoint frameGrip_;
  bool frameDragged_ = false;
};

}  // namespace kora
