#include "chart/chart_printing.h"

#include <algorithm>
#include <cmath>
#include <new>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/script_reading.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr double kFirstEnlargement = 1.5, kStep = 0.1;
constexpr double kLeast = 1.2, kLeastInPrintMode = 0.5;
// A large chart has some ten thousand commands.
constexpr double kMostCommands = 200000;
constexpr double kHeavyPoint = 3;

class PaperPlayer {
 public:
  PaperPlayer(Printer& printer, const ChartFrame& frame, const PrintSetup& setup,
              const FontSettings& fonts, const ChartColours& colours, std::string& fontLabel)
      : printer_(printer),
        frame_(frame),
        setup_(setup),
        fonts_(fonts),
        colours_(colours),
        fontLabel_(fontLabel),
        textFactor_(setup.ScriptPrintMode ? 1 : std::min(1.0, frame.SX / printer.TwipsPerPixelX())),
        weight_(setup.PrintLine >= 1 && setup.PrintLine <= 10 ? setup.PrintLine : 2) {
    font_ = {fonts.Font1Name, fonts.TitleSize >= 1 ? fonts.TitleSize : 8, fonts.Font1Bold, false};
    SetFont(font_, "Font 1");
    printer_.SetDrawStyle(DrawStyle::kSolid);
    printer_.SetDrawWidth(1);
  }

  void Play(ScriptShape shape, const ScriptLine& line) {
    budget_.Spend(1);
    switch (shape) {
      case ScriptShape::kText: return Text(line);
      case ScriptShape::kSegment: return Segment(line);
      case ScriptShape::kPoint: return Point(line);
      case ScriptShape::kNone: return;
    }
  }

 private:
  Colour OnPaper(Colour colour) const {
    if (setup_.PrintColourMode == 0) return colours_[0];
    const bool white = colour == colours_[15] || colour == colours_[7];
    if (white && setup_.PrintWhiteBlack == 1) return colours_[0];
    return setup_.DarkPaper ? ForWhitePaper(colour) : colour;
  }
  // Scaled before it is rounded, so that the halves of candles come to paper.
  double X(const ScriptLine& line, int field) const {
    return CLng(ScriptPlace(line, field) * frame_.SX);
  }
  double Y(const ScriptLine& line, int field) const {
    return CLng(ScriptPlace(line, field) * frame_.SY);
  }

  void SetFont(const SurfaceFont& font, const char* label) {
    fontLabel_ = label;
    printer_.SetFont(font);
  }

  void Print(const ScriptLine& line, const SurfaceFont& font, const char* label) {
    const double x = X(line, 3), y = Y(line, 4);
    SetFont(font, label);
    printer_.SetForeColour(OnPaper(line.whole(6)));
    printer_.SetCurrent(x, y);
    printer_.Print(FromAnsi(line.text[4]));
  }

  void Text(const ScriptLine& line) {
    const bool empty = Trim(line.text[4]).empty();
    switch (line.letter()) {
      case 'T':
        if (setup_.ScriptPrintMode) font_.bold = true;
        if (empty) return;
        font_.size = Size(line, "Font 1");
        return Print(line, font_, "Font 1");
      case 'S':
        if (!empty) {
          font_.size = Size(line, "Font 2");
          Print(line, {fonts_.Font2Name, font_.size, setup_.ScriptPrintMode && font_.bold, false},
                "Font 2");
        }
        font_.bold = fonts_.Font1Bold;
        SetFont(font_, "Font 1");
        printer_.SetDrawStyle(DrawStyle::kSolid);
        printer_.SetDrawWidth(1);
        return;
      default:
        font_.size = Size(line, "Font 1");
        Print(line, {font_.name, font_.size, true, true}, "Font 1");
        font_.bold = font_.italic = false;
    }
  }

  double Size(const ScriptLine& line, const char* label) {
    fontLabel_ = label;
    return std::max(1.0, budget_.FontSize(line) * textFactor_);
  }

  void Segment(const ScriptLine& line) {
    const double x1 = X(line, 2), y1 = Y(line, 3), x2 = X(line, 4), y2 = Y(line, 5);
    const Colour colour = OnPaper(line.whole(6));
    const char letter = line.letter();
    if (letter == 'F') return printer_.FilledBox(x1, y1, x2, y2, colour);
    if (letter == 'C') {
      printer_.FilledBox(x1, y1, x2, y2, colour);
      return printer_.SetDrawWidth(1);
    }
    printer_.SetDrawWidth(letter == 'H' ? weight_ : 1);
    switch (letter) {
      case 'B': return printer_.Box(x1, y1, x2, y2, colour);
      case 'X': return printer_.FilledBox(x1, y1, x2, y2, colour);
      case 'D':
      case 'E': printer_.SetDrawStyle(DrawStyle::kDash); break;
      case 'V': printer_.SetDrawStyle(DrawStyle::kDot); break;
      default: break;
    }
    printer_.Line(x1, y1, x2, y2, colour);
    printer_.SetDrawWidth(1);
    printer_.SetDrawStyle(DrawStyle::kSolid);
  }

  void Point(const ScriptLine& line) {
    const double x = X(line, 2), y = Y(line, 3);
    const Colour colour = OnPaper(line.whole(4));
    printer_.SetDrawWidth(line.letter() == 'K' ? kHeavyPoint : weight_);
    printer_.Line(x, y, x, y, colour);
    printer_.SetDrawWidth(1);
  }

  Printer& printer_;
  const ChartFrame& frame_;
  const PrintSetup& setup_;
  const FontSettings& fonts_;
  const ChartColours& colours_;
  std::string& fontLabel_;
  // Texts of a chart that is smaller than on the screen shrink with it, or they would run into
  // one another. The print mode has room for them at their size.
  double textFactor_;
  double weight_;
  SurfaceFont font_;  // Font 1 as the lines have left it
  PlayBudget budget_{kMostCommands};
};

bool Fits(const Printer& printer, ChartSize chart, PrintSetup setup, double enlargement) {
  setup.PrintEnlarge = float(enlargement);
  setup.PrintLeft = setup.PrintTop = 0;
  return IsOnPage(printer, FrameOnPage(printer, setup, chart));
}

// The least enlargement that reducing comes to.
double LeastEnlargement(const Printer& printer, ChartSize chart, const PrintSetup& setup) {
  double least = setup.ScriptPrintMode ? kLeastInPrintMode : kLeast;
  while (least > 1.5 * kStep && !Fits(printer, chart, setup, least))
    least = RoundHalfEven((least - kStep) * 10) / 10;
  return least;
}

std::int32_t Kept(double value) {
  return value >= -2147483648.0 && value <= 2147483647.0 ? CLng(value) : 0;
}

template <typename Script>
bool Print(const ChartPrintServices& services, PrintSetup setup, ChartSize chart, Script&& script) {
  Printer& printer = services.printer;
  Dialogs& dialogs = services.dialogs;
  if (!printer.Exists()) {
    dialogs.Message("There is no default printer.", "Printer Page");
    return false;
  }
  std::string caption, fontLabel, failure, title = "Chart Printing";
  if (services.swapCaption) caption = services.swapCaption("PRINTING - WAIT");
  dialogs.SetBusy(true);
  try {
    if (setup.PrintOrient == kPortrait || setup.PrintOrient == kLandscape)
      printer.SetOrientation(setup.PrintOrient);
    else if (setup.FitSide)
      printer.SetOrientation(BetterSide(chart));
    SetPageDefaults(printer, chart, setup);
    const ChartFrame frame = FrameOnPage(printer, setup, chart);
    const auto& text = script();
    printer.StartDoc("KORA Charting");
    if (!PlayOnPaper(text, printer, frame, setup, services.fonts, services.colours, fontLabel))
      throw RunTimeError(kBadCall);
    printer.EndDoc();
  } catch (const RunTimeError& e) {
    if (e.number() == kInvalidValue && !fontLabel.empty()) {
      failure = "Your printer will not accept font selected for " + fontLabel;
      title = "Printer Font";
    } else {
      failure =
          "There is an unexpected error No. " + Str(std::int32_t(e.number())) + "\n" + e.what();
    }
  } catch (const std::bad_alloc&) {
    failure = "There is an unexpected error No. 7\n" + std::string(ErrorText(kOutOfMemory));
  }
  printer.KillDoc();
  dialogs.SetBusy(false);
  if (services.swapCaption) services.swapCaption(caption);
  if (failure.empty()) return true;
  dialogs.Message(failure, title);
  return false;
}

}  // namespace

PrintSetup PrintSetupFrom(const Settings& settings, const PrinterColours& printer) {
  const ChartSettings& charts = settings.charts;
  PrintSetup setup;
  // What no page can have was not set.
  setup.PrintEnlarge = charts.EFact > 0 && charts.EFact <= 1000 ? float(charts.EFact) : 0;
  setup.PrintWidth = Kept(charts.Cw);
  setup.PrintHeight = Kept(charts.Ch);
  setup.PrintLeft = Kept(charts.SW);
  setup.PrintTop = Kept(charts.SH);
  setup.PrintLine = charts.LineWidth;
  setup.PrintOrient = settings.page.Orient;
  setup.PrintColourMode = printer.ColourPrinter;
  setup.PrintWhiteBlack = printer.WhiteAsBlack;
  setup.ScriptPrintMode = settings.words.ScriptPrintMode;
  setup.DarkPaper = settings.charts.DarkPaper;
  setup.FitSide = settings.charts.FitSide;
  return setup;
}

void SavePrintSetup(SettingsFile& file, Settings& settings, const PrintSetup& setup) {
  settings.charts.Cw = setup.PrintWidth;
  settings.charts.Ch = setup.PrintHeight;
  settings.charts.SW = setup.PrintLeft;
  settings.charts.SH = setup.PrintTop;
  settings.charts.EFact = Val(Str(setup.PrintEnlarge));
  settings.page.Orient = setup.PrintOrient;
  const SettingsFile::Batch batch(file);
  file.PutSetting("Charts", "Cw", Str(setup.PrintWidth));
  file.PutSetting("Charts", "Ch", Str(setup.PrintHeight));
  file.PutSetting("Charts", "Sw", Str(setup.PrintLeft));
  file.PutSetting("Charts", "Sh", Str(setup.PrintTop));
  file.PutSetting("Charts", "Efact", Str(setup.PrintEnlarge));
  file.PutSetting("ChtPage", "Orient", Str(std::int32_t(setup.PrintOrient)));
}

ChartFrame FrameOnPage(const Printer& printer, const PrintSetup& setup, ChartSize chart) {
  // The product is a 32-bit float as its factors are, so that 15 times 0.9 is the half that it
  // looks and rounds to even.
  const auto scaled = [&](double twips) { return CLng(double(float(twips) * setup.PrintEnlarge)); };
  ChartFrame frame;
  frame.SX = scaled(printer.TwipsPerPixelX());
  frame.SY = scaled(printer.TwipsPerPixelY());
  frame.width = CLng(chart.width * frame.SX);
  frame.height = CLng(chart.height * frame.SY);
  frame.PrintLeft = setup.PrintLeft;
  frame.PrintTop = setup.PrintTop;
  if (setup.PrintTop == 0 || setup.PrintLeft == 0) {
    frame.PrintTop = CLng(-(printer.ScaleHeight() - frame.height) / 2);
    frame.PrintLeft = CLng(-(printer.ScaleWidth() - frame.width) / 2);
  }
  return frame;
}

std::int16_t BetterSide(ChartSize chart) {
  return chart.width > chart.height ? kLandscape : kPortrait;
}

Colour ForWhitePaper(Colour colour) {
  constexpr double kReadable = 3;  // contrast with white that texts and thin lines need
  const auto light = [](double part) {
    part /= 255;
    return part <= 0.03928 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
  };
  double parts[3] = {double(colour & 0xFF), double(colour >> 8 & 0xFF),
                     double(colour >> 16 & 0xFF)};
  const auto contrast = [&] {
    return 1.05 /
           (0.2126 * light(parts[0]) + 0.7152 * light(parts[1]) + 0.0722 * light(parts[2]) + 0.05);
  };
  if (contrast() >= kReadable) return colour;
  while (contrast() < kReadable)
    for (double& part : parts) part *= 0.97;
  return CLng(parts[0]) | CLng(parts[1]) << 8 | CLng(parts[2]) << 16;
}

bool IsOnPage(const Printer& printer, const ChartFrame& frame) {
  const double left = -double(frame.PrintLeft), top = -double(frame.PrintTop);
  return left >= 0 && top >= 0 && left + frame.width <= printer.ScaleWidth() &&
         top + frame.height <= printer.ScaleHeight();
}

void SetPageDefaults(const Printer& printer, ChartSize chart, PrintSetup& setup) {
  const bool saved = setup.PrintWidth != 0 && setup.PrintHeight != 0;
  if (!(setup.PrintEnlarge > 0)) setup.PrintEnlarge = float(kFirstEnlargement);
  if (!saved) {
    const double least = LeastEnlargement(printer, chart, setup);
    while (double(setup.PrintEnlarge) > least + kStep / 2 &&
           !Fits(printer, chart, setup, double(setup.PrintEnlarge)))
      setup.PrintEnlarge = float(RoundHalfEven((double(setup.PrintEnlarge) - kStep) * 10) / 10);
    const ChartFrame frame = FrameOnPage(printer, setup, chart);
    setup.PrintWidth = frame.width;
    setup.PrintHeight = frame.height;
  }
}

void Enlarge(PrintSetup& setup) {
  setup.PrintEnlarge = float(RoundHalfEven((double(setup.PrintEnlarge) + kStep) * 10) / 10);
}

void EnlargeToPage(const Printer& printer, ChartSize chart, PrintSetup& setup) {
  constexpr double kMost = 100;
  setup.PrintLeft = setup.PrintTop = 0;
  setup.PrintEnlarge = float(LeastEnlargement(printer, chart, setup));
  for (;;) {
    PrintSetup next = setup;
    Enlarge(next);
    if (double(next.PrintEnlarge) > kMost || !IsOnPage(printer, FrameOnPage(printer, next, chart)))
      return;
    setup = next;
  }
}

void Reduce(const Printer& printer, ChartSize chart, PrintSetup& setup) {
  const double least = LeastEnlargement(printer, chart, setup);
  const double next = RoundHalfEven((double(setup.PrintEnlarge) - kStep) * 10) / 10;
  if (next >= least - kStep / 2) setup.PrintEnlarge = float(next);
}

bool PlayOnPaper(std::string_view script, Printer& printer, const ChartFrame& frame,
                 const PrintSetup& setup, const FontSettings& fonts, const ChartColours& colours,
                 std::string& fontLabel) {
  printer.SetScale(frame.PrintLeft, frame.PrintTop);
  PaperPlayer player(printer, frame, setup, fonts, colours, fontLabel);
  return ForEachCommand(
      script, ScriptMedium::kPaper,
      [&player](ScriptShape shape, const ScriptLine& line) { player.Play(shape, line); });
}

bool PrintChart(const ChartPrintServices& services, const PrintSetup& setup, ChartSize chart,
                std::string_view scriptPath) {
  return Print(services, setup, chart, [&] { return ReadChartScript(services.files, scriptPath); });
}

bool PrintChartScript(const ChartPrintServices& services, const PrintSetup& setup, ChartSize chart,
                      std::string_view script) {
  return Print(services, setup, chart, [script] { return script; });
}

}  // namespace kora
