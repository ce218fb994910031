#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "base/numbers.h"
#include "chart/chart_pen.h"
#include "chart/chart_request.h"
#include "chart/composition.h"
#include "looks/colours.h"
#include "platform/dialogs.h"
#include "settings/settings.h"

namespace kora {

// Where RMX draws in its panel, in units of it.
struct RmxPlace {
  std::int16_t PanelTop = 0, PanelBottom = 0;  // of the frame
  double inset = 0;                            // from the frame to highest and lowest
  int middle = 0;                              // the y that the offsets are counted from
};

// What an oscillator is drawn from and onto. Every routine has the form Show<Name>(OscHost&):
// it computes from the bars on show, draws one panel and appends the same drawing to the
// script, in one pass, and keeps no result.
struct OscHost {
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  const ChartColours& colours;
  const ChartRequest& request;    // period, style and name record of the chart on show
  Composition& chart;             // its bars and scale
  Surface& price;                 // the price picture
  Surface& panel;                 // the oscillator picture
  ChartScript* script = nullptr;  // null or suppressed: drawn only

  std::string OscCode = {};        // "STO", "FX", "R/F", "ROC", ...
  std::string OscCaller = "CHTS";  // "ANAL" for the multi-oscillator view
  bool SlowStochastic = false;
  double PanelOffsetY = 0;  // y of the panel on the script page when not in the chart window
  double PrintScale = 1;    // panel y is divided by it on its way to the script
  bool SecondPass = false;  // over the panel that another oscillator drew

  std::int16_t PanelTop = 0, PanelBottom = 0;  // of the panel drawn last, for the pointer
  // What its first line ends at; of two oscillators on one panel that of each.
  std::vector<double> LastValues = {};

  bool InChartWindow() const { return OscCaller == "CHTS"; }
  // In the chart window the frame takes the panel, and title and values of RMX stand below it. In
  // the multi-oscillator view the panel has room for them, since the next one begins at its end.
  RmxPlace PlaceRmx(double units) const;
  // The one of the chart period on show.
  std::int16_t Period(const OscKey& key) const {
    return settings.osc[key].For(request.ChartPeriod);
  }
  Colour colour(int entry) const { return colours[static_cast<size_t>(entry)]; }
};

// Opens the script again behind the chart that it holds, unless it is suppressed.
void ResumeScript(OscHost& host);

// The panel: its limits, and the ways in which all oscillators draw on it.
class OscPanel {
 public:
  // Sets the panel up: font, background, and the script opened again for append. In a second
  // pass the panel is taken as it stands.
  //   PanelTop = CInt(0.02 * height)   PanelBottom = CInt(0.98 * height)
  // `units`: 0 keeps the panel's own height; otherwise its scale becomes that many units high
  // and as wide as the price picture, and top and bottom are (2 * height) \ 100 and
  // (98 * height) \ 100. `textsBelow`: on the screen the units are drawn small enough for two
  // lines of text below the frame; the script knows nothing of it.
  explicit OscPanel(OscHost& host, double units = 0, bool textsBelow = false);

  std::int16_t PanelTop, PanelBottom;
  std::int16_t PanelLeft;  // that of the prices, where their scale has its room
  std::int16_t PanelRight;
  double PlotX;  // of the bar being drawn; PanelLeft at the start

  OscHost& host;
  ChartPen pen;  // on the panel; script y carries scale and offset

  Colour colour(int entry) const { return host.colour(entry); }
  double TextWidth(std::string_view text);

  // x of a bar that stands under its like on the price chart: bar 0 at PanelLeft. Error 6 beyond
  // 16 bits.
  double BarX(int bar) const { return CInt(PanelLeft + double(bar) * host.chart.BarSpacing); }

  // Frame in the border colour; passed over in a second pass.
  void Frame();
  // Title in the text colour inside the upper left corner; in a second pass 290 units further
  // right on the screen, 250 in the script.
  void Title(std::string_view text);
  // A full-width guide line and its label left of the frame; passed over in a second pass.
  // An empty label writes none.
  void Guide(double y, std::string_view label, char letter = 'L');
  // A label alone, right-aligned to 5 left of the frame, 6 above y.
  void Label(double y, std::string_view label);
  // Text of size 8.25 at a place.
  void Text(double x, double y, std::string_view text);
  // The same at an x of its own in the script.
  void TextPair(double screenX, double scriptX, double y, std::string_view text);
  // A line of the data in a colour entry.
  void Line(char letter, double x1, double y1, double x2, double y2, int entry) {
    pen.Line(letter, {x1, y1, x2, y2, colour(entry)});
  }

 private:
  SurfaceFont Font() const;
};

// A line drawn from point to point as the points come. The point before is kept whether or not
// a line was drawn to it.
class OscTrace {
 public:
  OscTrace(ChartPen& pen, char letter) : pen_(pen), letter_(letter) {}
  // Moves to a point; from the second on with a line, unless `draw` is false.
  void To(double x, double y, Colour colour, bool draw = true) {
    if (begun_ && draw) pen_.Line(letter_, {x_, y_, x, y, colour});
    x_ = x;
    y_ = y;
    begun_ = true;
  }
  bool begun() const { return begun_; }
  double y() const { return y_; }  // of the point before; 0 when there is none

 private:
  ChartPen& pen_;
  char letter_;
  bool begun_ = false;
  double x_ = 0, y_ = 0;
};

// Runs the body of an oscillator with the busy pointer on. Whatever ends it, the script is
// closed, and a run-time error is told under `title`. `longForm` tells errors in the data, of
// files and of the disk apart; the short form knows "480" and "any other" only.
// `dateOf` gives the date of the record in hand for the message of the long form. `diskTitle`,
// where given, stands over the question about the disk in place of `title`.
// Returns true when the body ran to its end.
bool RunOscillator(OscHost& host, std::string_view title, bool longForm,
                   const std::function<void()>& body,
                   const std::function<std::string()>& dateOf = nullptr,
                   std::string_view diskTitle = {});

// A window of the last `size` values, as all averages of a series use it.
template <typename T, typename Sum>
class RollingWindow {
 public:
  RollingWindow(T* slots, int size) : slots_(slots), size_(size) {}
  // Takes a value; true once the window is full, and then at every value.
  bool Add(T value) {
    if (count_ == size_) {
      for (int i = 1; i < size_; ++i) slots_[i - 1] = slots_[i];
      --count_;
    }
    slots_[count_++] = value;
    return count_ == size_;
  }
  Sum Total() const {
    Sum sum = 0;
    for (int i = 0; i < count_; ++i) sum += slots_[i];
    return sum;
  }
  int size() const { return size_; }

 private:
  T* slots_;
  int size_;
  int count_ = 0;
};

}  // namespace kora
