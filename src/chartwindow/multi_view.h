#pragma once

#include <functional>
#include <span>
#include <string>

#include "chart/chart_state.h"
#include "indicators/multi_osc.h"
#include "platform/settings_file.h"
#include "store/name_file.h"

namespace kora {

// What the multi-oscillator view works with. Nothing is owned.
struct MultiViewServices {
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  const SettingsFile& user;  // the per-user store: the sets
  const ChartColours& colours;
  const CurrentName& current;
  ChartState& state;
  std::function<std::string(const NameRec&)> VolumeUnitText = {};
};

// The rules of the multi-oscillator view: the security in hand with the oscillators of the set on
// show. Its script takes the place of the chart window's, so that it is what is printed.
class MultiView {
 public:
  MultiView(const MultiViewServices& services, int set);

  int MultiOscSet() const { return set_; }
  kora::MultiOscSet Names() const { return ReadMOSet(services_.user, set_); }
  // The set on show as a caption, and what the menu calls the other one.
  std::string Caption() const;
  std::string SwapCaption() const;
  void Swap() { set_ = 3 - set_; }

  // Draws all afresh; `panels` has one surface for each oscillator of the set. False when the
  // price chart could not be drawn, which was told.
  bool Draw(Surface& price, std::span<Surface* const> panels);
  bool Drawn() const { return Chart.ChartDrawn; }
  std::string ScriptPath() const;

  ChartRequest Request;  // of the last drawing
  Composition Chart;

 private:
  MultiViewServices services_;
  int set_;
};

// The page on which the view stands, for a window of `width` x `height`: the price picture above
// and the panels below it, which share as much again. It is as high as the window, and higher only
// where a panel would be too low to be read.
struct MultiPage {
  double width = 0, price = 0, panel = 0;
  double Height(int panels) const { return price + panels * panel; }
};
MultiPage LayOutMultiPage(double width, double height, int panels);

}  // namespace kora
