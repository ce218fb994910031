#pragma once

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

#include "base/files.h"
#include "looks/colours.h"
#include "platform/printer.h"
#include "settings/settings.h"

namespace kora {

class Dialogs;

// How charts are printed: the settings under the names that printing has for them.
struct PrintSetup {
  float PrintEnlarge = 0;            // paper units to the chart unit, 1 as on the screen
  std::int32_t PrintWidth = 0;       // of the chart on paper, twips; 0 not set: the page
  std::int32_t PrintHeight = 0;      // set-up was never saved
  std::int32_t PrintLeft = 0;        // origin of the scale, twips: a margin is negative;
  std::int32_t PrintTop = 0;         // 0 in either: centred
  std::int16_t PrintLine = 0;        // weight of H and P in dots; 1 to 10, otherwise 2
  std::int16_t PrintOrient = 0;      // 1 portrait, 2 landscape; otherwise the printer's
  std::int16_t PrintColourMode = 0;  // 1 colour, 0 black and white
  std::int16_t PrintWhiteBlack = 1;  // 1: white in black
  bool ScriptPrintMode = false;      // texts in bold
  bool DarkPaper = false;            // light colours are darkened
  bool FitSide = false;              // where PrintOrient is neither: as the chart fits better
};
PrintSetup PrintSetupFrom(const Settings& settings, const PrinterColours& printer);
// Keeps enlargement, size, origin and orientation, in the settings and in their file.
void SavePrintSetup(SettingsFile& file, Settings& settings, const PrintSetup& setup);

// Size of the chart, chart units: the price picture, and the panel below it where it shows.
struct ChartSize {
  double width = 0, height = 0;
};

// Where the chart comes to lie on the part of the page that is reached, twips.
struct ChartFrame {
  std::int32_t SX = 0, SY = 0;  // twips to the chart unit
  std::int32_t width = 0, height = 0;
  std::int32_t PrintLeft = 0, PrintTop = 0;  // origin of the scale
};
// Error 6 for what 32 bits don't hold.
ChartFrame FrameOnPage(const Printer& printer, const PrintSetup& setup, ChartSize chart);
// The side on which a chart of that shape is printed larger.
std::int16_t BetterSide(ChartSize chart);

// A colour as it reads on white: the darkest of its hue that is still told apart, where it is too
// light.
Colour ForWhitePaper(Colour colour);

// True when no edge of the chart leaves the page.
bool IsOnPage(const Printer& printer, const ChartFrame& frame);

// The first time, before the page set-up was ever saved: the enlargement is 1.5 where none is
// kept, and reduced in steps until the chart is on the page; the size is that of the frame.
// A set-up that was saved stays as it is.
void SetPageDefaults(const Printer& printer, ChartSize chart, PrintSetup& setup);

// A step of 0.1 up, and down. Reducing stops at 1.2, or at 0.5 in ScriptPrintMode; for a chart
// that is too large for the page even so, where it fits.
void Enlarge(PrintSetup& setup);
// To the largest step at which the chart is on the page, in its middle.
void EnlargeToPage(const Printer& printer, ChartSize chart, PrintSetup& setup);
void Reduce(const Printer& printer, ChartSize chart, PrintSetup& setup);

// Plays a chart script on a page of `printer`. True when it held a command. Error 5 for a last
// line cut off, 6, 9 and 14 as splitting and converting have them, 7 for more commands than any
// chart has, 380 for a font that is refused; `fontLabel` then names it. Part of the page may
// have been drawn by then.
bool PlayOnPaper(std::string_view script, Printer& printer, const ChartFrame& frame,
                 const PrintSetup& setup, const FontSettings& fonts, const ChartColours& colours,
                 std::string& fontLabel);

struct ChartPrintServices {
  const Files& files;
  Dialogs& dialogs;
  Printer& printer;
  const FontSettings& fonts;
  const ChartColours& colours;
  // Shows a caption on the caller's form and gives the one that stood there. May be empty.
  std::function<std::string(const std::string&)> swapCaption;
};

// Prints a chart once: the script in the file `scriptPath` (TCht.Tmp, or the saved chart on
// show), or `script` itself. The caption shows "PRINTING - WAIT" meanwhile. False when it
// failed, which was told; then no page was sent.
bool PrintChart(const ChartPrintServices& services, const PrintSetup& setup, ChartSize chart,
                std::string_view scriptPath);
bool PrintChartScript(const ChartPrintServices& services, const PrintSetup& setup, ChartSize chart,
                      std::string_view script);

}  // namespace kora
