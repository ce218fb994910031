#include "chart/composer.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <memory>
#include <new>
#include <optional>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/bar_marks.h"
#include "chart/chart_canvas.h"
#include "chart/chart_failure.h"
#include "chart/price_averages.h"
#include "chart/scale_drawing.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Chart Display";
constexpr std::string_view kStamp = "KORA";
constexpr double kEndTextX = 380;

// Ends the composition with a message of its own; nothing went wrong with the machine.
struct Refusal {
  std::string text;
  std::string_view title;
};

// `percent` of `height`: rounded to a whole product, then truncated.
std::int16_t PercentOf(double height, int percent) {
  return CInt(CLng(height * percent) / 100);
}

class Composer {
 public:
  Composer(const ChartServices& services, const ChartRequest& request, Composition& chart)
      : services_(services),
        request_(request),
        chart_(chart),
        script_(request.SuppressScript ? nullptr : services.script),
        pen_(services.price, script_),
        canvas_{pen_, request, services.fonts, services.colours, chart} {}

  void Run();
  std::string FailureText(int number, const std::string& detail) const;
  // Leaves no file behind in use. The script keeps what was drawn until then.
  void CloseFiles();
  // The same after a failure, which is the one to tell.
  void GiveUpFiles();
  void DropScript();

 private:
  void PrepareSurface();
  void LayOut();
  void DrawTitle();
  void OpenData();
  void ChooseWindow();
  void ApplyFinishDate();
  void LoadBars();
  void MakeVolumeRoom();
  void AlignSecondChart();
  void SetUpScale(bool line);
  std::optional<std::int16_t> VolumeY(const ChartBar& bar) const;
  void DrawVolumeBar(double x, std::optional<std::int16_t> y);
  void DrawBars();
  void DrawLine();
  void DrawBar(const BarY& y, double x, Colour colour);
  void DrawStop(const StopLossTracker& stop);
  void DrawAdjustment(const ChartBar& bar, double x);
  void Smooth(std::int16_t closeY, double x);
  void DrawEnd();
  void DrawEndTexts();
  void DrawAverages();
  void AdvanceSlot();

  const ChartServices& services_;
  const ChartRequest& request_;
  Composition& chart_;
  ChartScript* script_;
  ChartPen pen_;
  ChartCanvas canvas_;
  std::string classText_;
  std::unique_ptr<PriceFile> file_;
  bool lineChart_ = false;
  std::string barDate_;  // of the bar being drawn, for messages
  std::optional<CloseSmoother> smoother_;
  int smoothed_ = 0;
};

void Composer::Run() {
  chart_.ChartDrawn = false;
  chart_.ScaleMissing = false;
  chart_.Bars.CurrentDataRec = 0;
  chart_.CloseY.clear();
  chart_.DataFile = std::string(request_.Name.Code.trimmed()) + ".WDT";
  if (script_) {
    const bool goesOn = chart_.ChartSlot == 2 || chart_.OscPanel >= 2;
    script_->Open(goesOn);
  }
  classText_ = IndustryClassText(services_.files, services_.paths.SystemPath,
                                 request_.Name.IndClass.trimmed());
  PrepareSurface();
  LayOut();
  DrawTitle();
  OpenData();
  ChooseWindow();
  LoadBars();
  MakeVolumeRoom();
  AlignSecondChart();
  lineChart_ = request_.ChartStyle == 'L' || request_.Name.RecType < kShare;
  if (request_.ChartStyle != 'P') {
    if (lineChart_) DrawLine();
    else DrawBars();
  }
  DrawEnd();
  CloseFiles();
  chart_.SurfaceHeight = services_.price.ScaleHeight();
  chart_.ChartDrawn = true;
  AdvanceSlot();
}

void Composer::LoadBars() {
  try {
    LoadChartBars(*file_, request_.ChartPeriod, request_.VolumeOption, request_.Name.RecType,
                  chart_.Bars);
  } catch (const RunTimeError&) {
    barDate_ = DateForMessage(*file_, chart_.Bars.CurrentDataRec);
    throw;
  }
  chart_.Bars.CurrentDataRec = 0;
}

void Composer::CloseFiles() {
  file_.reset();
  if (script_) script_->Close();
}

void Composer::GiveUpFiles() {
  try {
    CloseFiles();
  } catch (const RunTimeError&) {
    // The script that can't be written is the failure being told, or a lesser one.
  }
}

void Composer::DropScript() {
  if (script_) script_->Abandon();
}

void Composer::PrepareSurface() {
  Surface& surface = services_.price;
  surface.SetScale(0, 0, surface.Width(), surface.Height());
  if (Surface* panel = services_.panel; panel && panel->Visible())
    panel->SetScale(0, 0, panel->Width(), panel->Height());
  surface.SetBackColour(canvas_.colour(kBackground));
  surface.SetDrawMode(DrawMode::kCopy);
  surface.SetDrawStyle(DrawStyle::kSolid);
  surface.SetDrawWidth(1);
  // What opens a script anew also begins a picture.
  if (chart_.ChartSlot != 2 && chart_.OscPanel < 2) surface.Cls();
}

void Composer::LayOut() {
  const double height = services_.price.ScaleHeight();
  const double width = services_.price.ScaleWidth();
  if (chart_.TwoCharts && chart_.ChartSlot == 1) {
    chart_.ChartTop = 2;
    chart_.ChartBottom = PercentOf(height, 46);
  } else if (chart_.TwoCharts && chart_.ChartSlot == 2) {
    chart_.ChartTop = PercentOf(height, 51);
    chart_.ChartBottom = PercentOf(height, 95);
  } else {
    const bool panelBelow = services_.panel && services_.panel->Visible();
    chart_.ChartTop = PercentOf(height, panelBelow ? 13 : 10);
    chart_.ChartBottom = PercentOf(height, 95);
  }
  chart_.ChartLeft = 42;  // room for the scale
  chart_.FirstBarX = chart_.ChartLeft;
  chart_.ChartRight = PercentOf(width, 99);
  chart_.ChartMiddle = CInt((chart_.ChartRight - chart_.ChartLeft) / 2.0 + 36);
}

void Composer::DrawTitle() {
  const NameRec& name = request_.Name;
  const std::string code = FromAnsi(name.Code.trimmed());
  const double size = services_.fonts.TitleSize;
  const SurfaceFont font = canvas_.Font1(size);
  if (chart_.TwoCharts) {
    const double x = 4.0 * chart_.ChartLeft, y = chart_.ChartTop + 2.0;
    const Colour colour = canvas_.colour(kChartTitle);
    pen_.Text('T', font, {9.75, x, y, code, colour});
    return;
  }
  if (chart_.OscPanel > 0) {
    const Colour colour = canvas_.colour(chart_.OscPanel + 20);
    pen_.Text('T', font, {9.75, (chart_.OscPanel - 1) * 60.0, 2, code, colour});
    return;
  }
  const std::string title =
      code + (request_.ScriptPrintMode ? "  " : "    ") + FromAnsi(name.Name.trimmed());
  pen_.Text('T', font, {size, 20, 2, title, canvas_.colour(kChartTitle)});
  if (const std::string other = FromAnsi(name.OtherDetails.trimmed()); !other.empty()) {
    const double y = services_.price.CurrentY();
    const std::string text = std::string(15, ' ') + other;
    canvas_.SmallText(20, y, text, canvas_.colour(kChartTitle));
  }
}

void Composer::OpenData() {
  const std::string fileName = CodeFileName(request_.Name.Code.trimmed(), ".WDT");
  file_ = std::make_unique<PriceFile>(services_.files,
                                      services_.paths.CurrentDataPath + fileName);
  chart_.Bars.FirstDataRec = 0;
  chart_.Bars.CurrentDataRec = 0;
  chart_.Bars.LastDataRec = CInt(file_->count());
  if (chart_.Bars.LastDataRec == 0) throw Refusal{"No Data for " + chart_.DataFile, kTitle};
}

void Composer::ChooseWindow() {
  chart_.BarSpacing = request_.BarSpacing > 0 ? request_.BarSpacing : std::int16_t{2};
  ChartBars& bars = chart_.Bars;
  // The multi-oscillator view scrolls over a surface as wide as its bars.
  const bool wide = request_.MultiOscOn == -1;
  chart_.PlotWidth =
      wide ? 2100.0 : double(chart_.ChartRight) - chart_.ChartLeft - request_.BlankSpace;
  if (request_.ChartStyle == 'P') {
    bars.FirstDataRec = 1;  // a point-and-figure chart reads the whole file
    return;
  }
  double days = 1;
  if (request_.ChartPeriod == "M") days = 20;
  if (request_.ChartPeriod == "W")
    days = request_.WeekFactor >= 4 && request_.WeekFactor <= 5.25 ? request_.WeekFactor : 4.75;
  const std::int32_t wanted = CLng(chart_.PlotWidth / chart_.BarSpacing * days);
  if (request_.FinishDateOn) ApplyFinishDate();
  bars.FirstDataRec = CInt(std::clamp<double>(double(bars.LastDataRec) - wanted, 1, bars.LastDataRec));
  if (wide)
    services_.price.SetWidth((bars.LastDataRec - bars.FirstDataRec) * double(chart_.BarSpacing) +
                             120);
}

void Composer::ApplyFinishDate() {
  constexpr std::int32_t kRun = 512;
  std::array<PriceRec, kRun> run;
  for (std::int32_t first = 1; first <= file_->count(); first += kRun) {
    const auto n = static_cast<size_t>(std::min(kRun, file_->count() - first + 1));
    file_->ReadRun(first, std::span(run.data(), n));
    for (size_t i = 0; i < n; ++i) {
      if (run[i].RecDate.raw() < request_.FinishDate) continue;
      chart_.Bars.LastDataRec = CInt(double(first) + double(i));
      return;
    }
  }
}

void Composer::MakeVolumeRoom() {
  if (request_.ChartStyle != 'P' && request_.VolumeOption && chart_.Bars.VolumeShown &&
      chart_.OscPanel == 0) {
    chart_.VolBottom = chart_.ChartBottom;
    chart_.ChartBottom = CInt(0.9 * chart_.ChartBottom);
    chart_.VolTop = chart_.ChartBottom;
  } else {
    chart_.VolBottom = chart_.ChartBottom;
    chart_.VolTop = chart_.ChartBottom;
    chart_.Bars.VolumeShown = chart_.Bars.VolumeShown && chart_.OscPanel == 0;
  }
  if (request_.ChartStyle != 'P' && request_.VolumeOption) {
    const bool unit = chart_.Bars.VolumeShown && services_.VolumeUnitText;
    SetVolumeLabel(chart_, unit ? services_.VolumeUnitText(request_.Name) : "");
  }
  chart_.CloseY.reserve(static_cast<size_t>(std::max(0.0, chart_.PlotWidth)) + 10);
}

// The last bars of two charts stand below each other.
void Composer::AlignSecondChart() {
  if (chart_.OscPanel == 2 || chart_.ChartSlot == 2) {
    if (chart_.UpperBarCount > chart_.Bars.BarCount)
      chart_.FirstBarX = CInt(chart_.ChartLeft + double(chart_.UpperBarCount - chart_.Bars.BarCount) *
                                                     chart_.BarSpacing);
  } else if (chart_.OscPanel == 1 || chart_.ChartSlot == 1) {
    chart_.UpperBarCount = chart_.Bars.BarCount;
  }
}

void Composer::SetUpScale(bool line) {
  ChartScale& scale = chart_.Scale;
  if (request_.AutoScale)
    SetChartScaleAutomatic(chart_.Bars.ChartHigh, chart_.Bars.ChartLow, scale);
  else
    SetChartScaleManual(request_.Name.Base, request_.Name.Top, scale);
  if (scale.ScaleLow == 0 && scale.ScaleHigh == 0) {
    chart_.ScaleMissing = true;
    throw Refusal{" MANUAL SCALING has been selected but there are no chart scale definitions in "
                  "the Name File for " +
                      FromAnsi(request_.Name.Code.trimmed()) +
                      "\nUse <Change Scales> in the Set Defaults window or add these scales "
                      "directly to the Name File\nDo not use 0(zero) as chart base or ceiling\n"
                      "OTHERWISE USE AUTOMATIC SCALING",
                  kTitle};
  }
  PriceMap& map = chart_.Price;
  map.Logarithmic = line ? request_.LogLines : request_.LogBars;
  map.ScaleLow = scale.ScaleLow;
  map.ChartBottom = chart_.ChartBottom;
  if (map.Logarithmic) {
    // With one end at 0 the chart goes on with the logarithms it has.
    if (scale.ScaleLow == 0 || scale.ScaleHigh == 0) return;
    if (scale.ScaleLow < 0)
      throw Refusal{"You cannot display a Logarithmic chart when there are NEGATIVE values. "
                    "Display the chart as an Arithmetic chart.",
                    "Negative Values"};
    map.LogBase = static_cast<float>(std::log(double(scale.ScaleLow)));
    double logHigh;
    if (scale.ScaleHigh > 0) logHigh = std::log(double(scale.ScaleHigh));
    else if (line) logHigh = Divide(std::log(10.0), std::log(-double(scale.ScaleHigh)));
    else throw RunTimeError(kBadCall);
    map.LogFactor = static_cast<float>(
        Divide(double(chart_.ChartTop) - chart_.ChartBottom, logHigh - double(map.LogBase)));
  } else {
    map.PricePerY = static_cast<float>(Divide(double(scale.ScaleHigh) - double(scale.ScaleLow),
                                              double(chart_.ChartBottom) - chart_.ChartTop));
    scale.ScaleHigh = map.PricePerY;
  }
}

std::optional<std::int16_t> Composer::VolumeY(const ChartBar& bar) const {
  if (!chart_.Bars.VolumeShown || bar.Volume <= 0) return std::nullopt;
  const double y = chart_.Volume.RawY(bar.Volume);
  if (request_.CutVols && y < chart_.VolTop) return chart_.VolTop;
  return CInt(y);
}

void Composer::DrawVolumeBar(double x, std::optional<std::int16_t> y) {
  if (!y || *y > chart_.VolBottom) return;
  pen_.Line('H', {x, double(chart_.VolBottom), x, double(*y), canvas_.colour(kVolumeBars)});
}

void Composer::Smooth(std::int16_t closeY, double x) {
  if (!smoother_) smoother_.emplace(request_.MaExp);
  const auto y = smoother_->Add(closeY);
  if (!y) return;
  ++smoothed_;
  if (chart_.OscPanel == 0 && request_.OscName != "MACD" && (request_.Ma1On || request_.Ma2On) &&
      smoothed_ >= 2)
    pen_.Point('P', x, *y, canvas_.colour(kAverage1));
}

void Composer::DrawAdjustment(const ChartBar& bar, double x) {
  if (bar.SourceRec == 0 || chart_.OscPanel != 0) return;
  const PriceRec record = file_->Read(bar.SourceRec);
  const Colour colour = canvas_.colour(kAdjustments);
  const Segment line{x, double(chart_.ChartTop), x, double(chart_.ChartBottom), colour};
  pen_.LineStyled(DrawStyle::kDash, line, 'V', line);
  canvas_.SmallText(x, chart_.ChartTop + 2.0, FromAnsi(record.AdjDesc.trimmed()), colour);
}

void Composer::DrawBar(const BarY& y, double x, Colour colour) {
  const Segment range{x, double(y.High), x, double(y.Low), colour};
  if (request_.ChartStyle == 'C') {
    const Colour lines = canvas_.colour(kChartLines);
    pen_.Line('H', {x, double(y.High), x, double(y.Low), lines});
    const bool fall = y.Close > y.Open;
    const Colour body = fall ? canvas_.colour(kCandleDown) : lines;
    // A rising body is an outline in the script: hollow on paper.
    pen_.FilledBox(fall ? 'C' : 'B', {x - 1, double(y.Open), x + 1, double(y.Close), body},
                   {x - 1.5, double(y.Open), x + 1.5, double(y.Close), body});
    return;
  }
  pen_.Line('H', range);
  if (chart_.BarSpacing > 2) {
    pen_.Line('H', {x - 2, double(y.Open), x, double(y.Open), colour},
              {x - 1.5, double(y.Open), x, double(y.Open), colour});
    pen_.Line('H', {x, double(y.Close), x + 2, double(y.Close), colour},
              {x, double(y.Close), x + 1.5, double(y.Close), colour});
  } else if (chart_.BarSpacing == 2) {
    pen_.Point('P', x - 1, y.Open, colour);
    pen_.Point('P', x + 1, y.Close, colour);
  }
}

void Composer::DrawStop(const StopLossTracker& stop) {
  const auto right = [&](std::string_view text, int entry) {
    const SurfaceFont font = canvas_.Font1(ChartCanvas::kSmallText);
    canvas_.SmallText(chart_.ChartRight - canvas_.TextWidth(font, text), 30, text,
                      canvas_.colour(entry));
  };
  if (stop.broken()) right("PREVIOUS STOP BROKEN", 13);
  if (stop.stop() > 0) {
    const double y = chart_.Price.Y(stop.stop());
    pen_.Line('L', {double(stop.stopX()), y, double(chart_.ChartRight), y, canvas_.colour(10)});
    right("Current Stop Loss : " + Format(stop.stop(), "0.00#"), 10);
  }
}

void Composer::DrawBars() {
  SetUpScale(false);
  if (chart_.Bars.VolumeShown) SetVolumeMap(request_, false, chart_.Price.Logarithmic, chart_);
  DateAxis axis(canvas_);
  StopLossTracker stop(request_.StopLossShown, request_.StopLossPct);
  const bool bars = request_.ChartStyle == 'B';
  const bool smooths =
      request_.OscName != "MACD" && request_.OscName != "PARA" && request_.OscName != "PARAV";
  const bool outside = bars && request_.OutsideMarks;
  BarY previous, beforePrevious;
  const ChartBar* previousBar = nullptr;  // the last one that was drawn
  int seen = 0;
  std::int16_t x = chart_.FirstBarX;
  for (int i = 0; i <= chart_.Bars.BarCount; ++i, x = CInt(double(x) + chart_.BarSpacing)) {
    const ChartBar& bar = chart_.Bars[static_cast<size_t>(i)];
    barDate_ = bar.date();
    if (bar.High == 0) {
      chart_.CloseY.push_back(chart_.CloseY.empty() ? std::int16_t{0} : chart_.CloseY.back());
      continue;
    }
    BarY y;
    y.High = chart_.Price.Y(bar.High);
    y.Open = chart_.Price.Y(bar.Open);
    y.Low = chart_.Price.Y(bar.Low);
    y.Close = chart_.Price.Y(bar.Close);
    chart_.CloseY.push_back(y.Close);
    const auto volumeY = VolumeY(bar);
    int entry = kChartLines;
    if (outside && previousBar) entry = stop.Next(bar, *previousBar, x);
    if (outside && i == chart_.Bars.BarCount && request_.StopLossShown) DrawStop(stop);
    DrawAdjustment(bar, x);
    axis.Bar(bar.date(), x);
    DrawVolumeBar(x, volumeY);
    if (bars && request_.ColourMarks)
      entry = ReversalMark(y, seen > 0 ? &previous : nullptr, seen > 1 ? &beforePrevious : nullptr);
    DrawBar(y, x, canvas_.colour(entry));
    if (smooths) Smooth(y.Close, x);
    beforePrevious = previous;
    previous = y;
    previousBar = &bar;
    ++seen;
  }
  chart_.LastBarX = x;
}

void Composer::DrawLine() {
  SetUpScale(true);
  if (chart_.Bars.VolumeShown) SetVolumeMap(request_, true, chart_.Price.Logarithmic, chart_);
  DateAxis axis(canvas_);
  const bool smooths = request_.OscName != "MACD";
  std::int16_t x = chart_.FirstBarX;
  for (int i = 0; i <= chart_.Bars.BarCount; ++i, x = CInt(double(x) + chart_.BarSpacing)) {
    const ChartBar& bar = chart_.Bars[static_cast<size_t>(i)];
    barDate_ = bar.date();
    const bool hasClose = bar.Close != 0;
    const std::int16_t lastY = i == 0 ? std::int16_t{0} : chart_.CloseY.back();
    const std::int16_t y = hasClose ? chart_.Price.Y(bar.Close) : lastY;
    chart_.CloseY.push_back(y);
    const auto volumeY = VolumeY(bar);
    DrawAdjustment(bar, x);
    axis.Bar(bar.date(), x);
    if (i > 0 && hasClose)
      pen_.Line('H', {double(x) - chart_.BarSpacing, double(lastY), double(x), double(y),
                      canvas_.colour(kChartLines)});
    if (smooths) Smooth(y, x);
    DrawVolumeBar(x, volumeY);
  }
  chart_.LastBarX = x;
}

void Composer::DrawEnd() {
  const bool whole = request_.ChartStyle != 'P' && chart_.OscPanel == 0;
  if (request_.ChartStyle != 'P') {
    if (chart_.Bars.VolumeShown) DrawVolumePanel(canvas_);
    DrawScale(canvas_, lineChart_, classText_);
    DrawFixedGrid(canvas_);
  }
  DrawEndTexts();
  if (!whole) return;
  DrawAverages();
  for (const auto& overlay : services_.overlays) overlay(canvas_);
}

void Composer::DrawEndTexts() {
  const ChartBars& bars = chart_.Bars;
  const Colour colour = canvas_.colour(kScalesText);
  const double top = chart_.ChartSlot == 2 ? chart_.ChartTop : 0;
  const ChartBar& last = bars[static_cast<size_t>(bars.BarCount)];
  if (chart_.OscPanel < 2)
    canvas_.SmallText(kEndTextX, top + 2, "Last date processed " + DateToShort(last.date()), colour);
  if (chart_.OscPanel == 0) {
    const ChartBar& before = bars[static_cast<size_t>(std::max(bars.BarCount - 1, 0))];
    const std::int16_t type = request_.Name.RecType;
    const char* format = type == 1 || type == 2 || type == 4 ? "#####.00#" : "#####";
    canvas_.SmallText(kEndTextX, top + 20,
                      "Closing Price : " + Format(last.Close, format) + "  (" +
                          Format(before.Close, format) + ")",
                      colour);
  }
  chart_.LastClose = last.Close;
  // The stamp is for paper and saved charts; the window carries the name already.
  if (request_.ScriptPrintMode)
    pen_.ScriptText('Z', {services_.fonts.TitleSize, chart_.ChartRight - 50.0,
                          chart_.ChartTop - 20.0, kStamp, colour});
  else
    pen_.ScriptText('Z', {7, chart_.ChartRight - 30.0, chart_.ChartTop - 10.0, kStamp, colour});
}

void Composer::DrawAverages() {
  if (request_.OscName == "MACD" || request_.OscName == "PARA") return;
  const bool daily = request_.ChartPeriod == "A";
  const auto average = [&](std::int16_t period, int entry, int index) {
    const auto draw = request_.MaExp ? ExpAverageLine : SimpleAverageLine;
    draw(pen_, period, chart_.CloseY, canvas_.colour(entry), chart_.FirstBarX, chart_.BarSpacing,
         index);
  };
  if (request_.Ma1On) average(daily ? request_.Ma1Days : request_.Ma1Weeks, kAverage2, 1);
  if (request_.Ma2On) average(daily ? request_.Ma2Days : request_.Ma2Weeks, kAverage3, 2);
}

void Composer::AdvanceSlot() {
  if (!chart_.TwoCharts) return;
  if (chart_.ChartSlot == 1) {
    chart_.ChartSlot = 2;
  } else if (chart_.ChartSlot == 2) {
    chart_.TwoCharts = false;
    chart_.ChartSlot = 0;
  }
}

std::string Composer::FailureText(int number, const std::string& detail) const {
  return ChartFailureText(number, detail,
                          {.file = chart_.DataFile,
                           .RecType = request_.Name.RecType,
                           .record = chart_.Bars.CurrentDataRec,
                           .date = barDate_,
                           .font = services_.price.Font().name});
}

}  // namespace

std::string IndustryClassText(const Files& files, const std::string& systemPath,
                              std::string_view indClass) {
  constexpr std::uint64_t kLargestFile = 1u << 20;
  if (Trim(indClass).empty()) return std::string(kUnknown);
  const std::string id = Format(Val(indClass), "000");
  std::string text;
  try {
    text = files.ReadAll(systemPath + "IndClass.dat", kLargestFile);
  } catch (const RunTimeError&) {
    return std::string(kUnknown);  // a chart needs no class
  }
  LineReader reader(text);
  std::string_view line;
  while (reader.Next(line)) {
    const size_t comma = line.find(',');
    if (comma == std::string_view::npos || Trim(line.substr(0, comma)) != id) continue;
    const std::string_view description = Trim(line.substr(comma + 1));
    return description.empty() ? std::string(kUnknown) : FromAnsi(description);
  }
  return std::string(kUnknown);
}

bool ComposeChart(const ChartServices& services, const ChartRequest& request, Composition& chart) {
  Dialogs& dialogs = services.dialogs;
  for (;;) {
    dialogs.SetBusy(true);
    Composer composer(services, request, chart);
    int number = 0;
    std::string detail;
    try {
      composer.Run();
      dialogs.SetBusy(false);
      return true;
    } catch (const Refusal& refusal) {
      composer.GiveUpFiles();
      dialogs.SetBusy(false);
      dialogs.Message(refusal.text, refusal.title);
      return false;
    } catch (const RunTimeError& e) {
      number = e.number();
      detail = e.what();
    } catch (const std::bad_alloc&) {
      number = kOutOfMemory;
    }
    dialogs.SetBusy(false);
    if (number == kDiskNotReady) {
      if (dialogs.Ask("Disk Not ready. Close drive door", kTitle, Buttons::kOkCancel) ==
          Answer::kOk) {
        composer.DropScript();  // the next try writes all of it
        continue;
      }
      composer.GiveUpFiles();
      return false;
    }
    composer.GiveUpFiles();
    dialogs.Message(composer.FailureText(number, detail), kTitle);
    return false;
  }
}

}  // namespace kora
