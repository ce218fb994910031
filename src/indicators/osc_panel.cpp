#include "indicators/osc_panel.h"

#include <algorithm>
#include <new>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

constexpr double kSmallText = 8.25;

std::string DataErrorText(const OscHost& host, const std::string& date) {
  return "There is a problem with the data for " + host.chart.DataFile + "\n at date (" + date +
         ") " + (date.size() == 8 ? DateToDisplay(date) : std::string()) +
         "\nUse View/Modify Data procedure to correct.";
}

std::string FailureText(const OscHost& host, int number, const std::string& detail, bool longForm,
                        const std::string& date) {
  if (longForm) {
    switch (number) {
      case 0:
      case kBadCall:
      case kOverflow: return DataErrorText(host, date);
      case kOutOfMemory:
      case kOutOfTextSpace:
      case kOutOfStack:
        return "Out of memory\nThere appears to be a memory problem\nExit Windows then retry";
      case kBadFileName:
      case kFileNotFound:
      case kBadRecordNumber:
      case kPathAccess:
      case kPathNotFound:
        return "There is a problem with " + host.chart.DataFile + " Cannot find or open";
      default: break;
    }
  }
  if (number == kNoPicture)
    return "There is not enough memory to complete all pages display. Please ring KORA if this "
           "message appears often.";
  return "There is an unexpected error No. " + Str(std::int32_t(number)) + "\n" + detail;
}

void CloseScript(OscHost& host) {
  if (!host.script) return;
  try {
    host.script->Close();
  } catch (const RunTimeError&) {
    // The failure that ended the drawing is the one to tell.
  }
}

}  // namespace

void ResumeScript(OscHost& host) {
  if (!host.script || host.request.SuppressScript) return;
  host.script->Close();
  host.script->Open(true);
}

RmxPlace OscHost::PlaceRmx(double units) const {
  if (InChartWindow()) return {CInt(0.02 * units), CInt(0.98 * units), 20, int(Fix(units / 2))};
  units = panel.ScaleHeight();
  constexpr double kTextRoom = 28;
  const std::int16_t top = CInt(0.02 * units), bottom = CInt(0.98 * units - kTextRoom);
  return {top, bottom, 0, (top + bottom) / 2};
}

// The units of a picture in which the frame of a panel of `units`, the second line of text that
// begins 14 below it, and that line's own height in chart units stand.
static double UnitsWithTexts(double units, double height) {
  constexpr double kSecondLine = 14, kLineHeight = 14;
  const double place = 0.98 * units + kSecondLine;
  return height > kLineHeight ? place * height / (height - kLineHeight) : units;
}

OscPanel::OscPanel(OscHost& hostIn, double units, bool textsBelow)
    : host(hostIn), pen(hostIn.panel, hostIn.request.SuppressScript ? nullptr : hostIn.script) {
  Surface& panel = host.panel;
  ResumeScript(host);
  if (!host.SecondPass) {
    host.LastValues.clear();
    if (units > 0 && host.InChartWindow())
      panel.SetScale(0, 0, host.price.ScaleWidth(),
                     textsBelow ? UnitsWithTexts(units, panel.Height()) : units);
    panel.SetFont(Font());
    panel.SetBackColour(colour(kBackground));
    panel.SetDrawMode(DrawMode::kCopy);
    panel.SetDrawStyle(DrawStyle::kSolid);
    panel.SetDrawWidth(1);
    panel.Cls();
  }
  const double height = textsBelow && host.InChartWindow() ? units : panel.ScaleHeight();
  if (units > 0) {
    PanelTop = CInt(Fix(2 * height / 100));
    PanelBottom = CInt(Fix(98 * height / 100));
  } else {
    PanelTop = CInt(0.02 * height);
    PanelBottom = CInt(0.98 * height);
  }
  host.PanelTop = PanelTop;
  host.PanelBottom = PanelBottom;
  PanelLeft = std::max(kChartLeft, host.chart.ChartLeft);
  PanelRight = host.chart.ChartRight;
  PlotX = PanelLeft;
  pen.SetScriptY(host.PrintScale,
                 host.InChartWindow() ? host.price.ScaleHeight() : host.PanelOffsetY);
}

SurfaceFont OscPanel::Font() const {
  return {host.settings.fonts.Font1Name, kSmallText, false, false};
}

double OscPanel::TextWidth(std::string_view text) {
  pen.surface().SetFont(Font());
  return pen.surface().TextWidth(text);
}

void OscPanel::Frame() {
  if (host.SecondPass) return;
  pen.Box('B', {double(PanelLeft), double(PanelTop), double(PanelRight), double(PanelBottom),
                colour(kBorder)});
}

void OscPanel::Title(std::string_view text) {
  const double y = PanelTop + 2.0;
  const double screenX = PanelLeft + (host.SecondPass ? 290.0 : 2.0);
  const double scriptX = PanelLeft + (host.SecondPass ? 250.0 : 2.0);
  TextPair(screenX, scriptX, y, text);
}

void OscPanel::Guide(double y, std::string_view label, char letter) {
  if (host.SecondPass) return;
  Line(letter, PanelLeft, y, PanelRight, y, kBorder);
  Label(y, label);
}

void OscPanel::Label(double y, std::string_view label) {
  if (!label.empty()) Text(PanelLeft - 5 - TextWidth(label), y - 6, label);
}

void OscPanel::Text(double x, double y, std::string_view text) { TextPair(x, x, y, text); }

void OscPanel::TextPair(double screenX, double scriptX, double y, std::string_view text) {
  pen.Text('T', Font(), {kSmallText, screenX, y, text, colour(kScalesText)},
           {kSmallText, scriptX, y, text, colour(kScalesText)});
}

bool RunOscillator(OscHost& host, std::string_view title, bool longForm,
                   const std::function<void()>& body, const std::function<std::string()>& dateOf,
                   std::string_view diskTitle) {
  for (;;) {
    host.dialogs.SetBusy(true);
    int number = 0;
    std::string detail;
    try {
      body();
      if (host.script) host.script->Close();
      host.dialogs.SetBusy(false);
      return true;
    } catch (const RunTimeError& e) {
      number = e.number();
      detail = e.what();
    } catch (const std::bad_alloc&) {
      number = kOutOfMemory;
      detail = ErrorText(number);
    }
    CloseScript(host);
    host.dialogs.SetBusy(false);
    if (longForm && number == kDiskNotReady) {
      if (host.dialogs.Ask("Disk Not ready. Close drive door",
                           diskTitle.empty() ? title : diskTitle,
                           Buttons::kOkCancel) == Answer::kOk)
        continue;
      return false;
    }
    host.dialogs.Message(
        FailureText(host, number, detail, longForm, dateOf ? dateOf() : std::string()), title);
    return false;
  }
}

}  // namespace kora
