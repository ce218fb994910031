#include "chart/composer.h"

#include <algorithm>
#include <memory>
#include <new>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/chart_canvas.h"
#include "chart/chart_failure.h"
#include "chart/price_averages.h"
#include "chart/scale_drawing.h"
#include "chart/styles/price_plot.h"
#include "chart/styles/style_drawer.h"

namespace kora {
namespace {

constexpr std::string_view kStamp = "KORA";
constexpr double kEndTextX = 380;

class Composer {
 public:
  Composer(const ChartServices& services, const ChartRequest& request, Composition& chart)
      : services_(services),
        request_(request),
        chart_(chart),
        style_(StyleOf(request)),
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
  void LayOut(std::int16_t left);
  void DrawTitle();
  void OpenData();
  void ChooseRecords();
  void LoadBars();
  void MakeVolumeRoom();
  void MakeLabelRoom();
  void AlignSecondChart();
  void DrawEnd();
  void DrawEndTexts();
  void DrawAverages();

  const ChartServices& services_;
  const ChartRequest& request_;
  Composition& chart_;
  const ChartStyle& style_;
  ChartScript* script_;
  ChartPen pen_;
  ChartCanvas canvas_;
  std::string classText_;
  std::unique_ptr<PriceFile> file_;
  std::string barDate_;  // of the bar being drawn, for messages
};

void Composer::Run() {
  chart_.ChartDrawn = false;
  chart_.ScaleMissing = false;
  chart_.Bars.CurrentDataRec = 0;
  chart_.CloseY.clear();
  chart_.DataFile = std::string(request_.Name.Code.trimmed()) + ".WDT";
  if (script_) {
    script_->Open(IsSecond(request_.Place));
  }
  classText_ = IndustryClassText(services_.files, services_.paths.SystemPath,
                                 request_.Name.IndClass.trimmed());
  PrepareSurface();
  LayOut(request_.Place == ChartPlace::kLower ? std::max(kChartLeft, chart_.UpperLeft)
                                              : kChartLeft);
  DrawTitle();
  OpenData();
  ChooseRecords();
  LoadBars();
  MakeVolumeRoom();
  MakeLabelRoom();
  AlignSecondChart();
  std::function<float(float)> ask;
  if (services_.AskBoxValue)
    ask = [this](float computed) {
      services_.dialogs.SetBusy(false);
      const float value = services_.AskBoxValue(computed);
      services_.dialogs.SetBusy(true);
      return value;
    };
  style_.Draw({canvas_, *file_, barDate_, ask});
  DrawEnd();
  CloseFiles();
  chart_.SurfaceHeight = services_.price.ScaleHeight();
  chart_.ChartDrawn = true;
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
  if (!IsSecond(request_.Place)) surface.Cls();
}

void Composer::LayOut(std::int16_t left) {
  const Surface& surface = services_.price;
  const bool panelBelow = services_.panel && services_.panel->Visible();
  static_cast<ChartLayout&>(chart_) =
      LayOutChart(request_, surface.ScaleWidth(), surface.ScaleHeight(), panelBelow, left);
}

void Composer::DrawTitle() {
  const NameRec& name = request_.Name;
  const std::string code = FromAnsi(name.Code.trimmed());
  const double size = services_.fonts.TitleSize;
  const SurfaceFont font = canvas_.Font1(size);
  if (IsSplit(request_.Place)) {
    const double x = 4.0 * kChartLeft, y = chart_.ChartTop + 2.0;
    const Colour colour = canvas_.colour(kChartTitle);
    pen_.Text('T', font, {9.75, x, y, code, colour});
    return;
  }
  if (IsSuperimposed(request_.Place)) {
    const double x = request_.Place == ChartPlace::kOver ? 60 : 0;
    pen_.Text('T', font, {9.75, x, 2, code, canvas_.CodeColour()});
    return;
  }
  const std::string title =
      code + (request_.ScriptPrintMode ? "  " : "    ") + FromAnsi(name.Name.trimmed());
  pen_.Text('T', font, {size, 20, 2, title, canvas_.colour(kChartTitle)});
  chart_.TitleBottom = services_.price.CurrentY();
  if (const std::string other = FromAnsi(name.OtherDetails.trimmed()); !other.empty()) {
    const double y = services_.price.CurrentY();
    const std::string text = std::string(15, ' ') + other;
    canvas_.SmallText(20, y, text, canvas_.colour(kChartTitle));
  }
}

void Composer::OpenData() {
  const std::string fileName = CodeFileName(request_.Name.Code.trimmed(), ".WDT");
  file_ = std::make_unique<PriceFile>(services_.files, services_.paths.CurrentDataPath + fileName);
  ChartBars& bars = chart_.Bars;
  bars.FirstDataRec = 0;
  bars.LastDataRec = CInt(file_->count());
  if (bars.LastDataRec == 0) throw ChartRefusal{"No Data for " + chart_.DataFile, kChartDisplay};
}

void Composer::ChooseRecords() {
  ChartBars& bars = chart_.Bars;
  const RecordWindow window = ChooseWindow(*file_, request_, chart_, style_.readsWholeFile);
  bars.FirstDataRec = window.FirstDataRec;
  bars.LastDataRec = window.LastDataRec;
  if (request_.Place == ChartPlace::kWide && !style_.readsWholeFile)
    services_.price.SetWidth((bars.LastDataRec - bars.FirstDataRec) * double(chart_.BarSpacing) +
                             120 + (chart_.ChartLeft - kChartLeft));
}

void Composer::MakeVolumeRoom() {
  ChartBars& bars = chart_.Bars;
  const bool wanted = style_.hasVolumes && request_.VolumeOption;
  bars.VolumeShown = bars.VolumeShown && !IsSuperimposed(request_.Place);
  chart_.VolBottom = chart_.ChartBottom;
  if (wanted && bars.VolumeShown) chart_.ChartBottom = CInt(0.9 * chart_.ChartBottom);
  chart_.VolTop = chart_.ChartBottom;
  if (wanted) {
    const bool unit = bars.VolumeShown && services_.VolumeUnitText;
    SetVolumeLabel(chart_, unit ? services_.VolumeUnitText(request_.Name) : "");
  }
  chart_.CloseY.reserve(static_cast<size_t>(std::max(0.0, chart_.PlotWidth)) + 10);
}

// What a wider scale takes from the plot it takes from its oldest bars; fewer bars may have other
// labels.
void Composer::MakeLabelRoom() {
  if (!request_.Legible || style_.ownScale || IsSuperimposed(request_.Place)) return;
  constexpr int kTries = 3;
  for (int i = 0; i < kTries; ++i) {
    SetUpScale(canvas_, style_.lineScale);
    const std::int16_t left = LeftOfLabels(canvas_);
    if (left <= chart_.ChartLeft) return;
    LayOut(left);
    ChooseRecords();
    LoadBars();
    MakeVolumeRoom();
  }
}

// The last bars of two charts stand below each other.
void Composer::AlignSecondChart() {
  if (IsSecond(request_.Place)) {
    if (chart_.UpperBarCount > chart_.Bars.BarCount)
      chart_.FirstBarX =
          std::max(chart_.ChartLeft,
                   CInt(chart_.UpperLeft +
                        double(chart_.UpperBarCount - chart_.Bars.BarCount) * chart_.BarSpacing));
  } else if (IsSplit(request_.Place) || IsSuperimposed(request_.Place)) {
    chart_.UpperBarCount = chart_.Bars.BarCount;
    chart_.UpperLeft = chart_.ChartLeft;
  }
}

void Composer::DrawEnd() {
  if (!style_.ownScale) {
    if (chart_.Bars.VolumeShown) DrawVolumePanel(canvas_);
    DrawScale(canvas_, style_.lineScale, classText_);
    DrawFixedGrid(canvas_);
  }
  DrawEndTexts();
  if (!style_.takesOverlays || IsSuperimposed(request_.Place)) return;
  DrawAverages();
  for (const auto& overlay : services_.overlays) overlay(canvas_);
}

void Composer::DrawEndTexts() {
  const ChartBars& bars = chart_.Bars;
  const Colour colour = canvas_.colour(kScalesText);
  const double top = request_.Place == ChartPlace::kLower ? chart_.ChartTop : 0;
  const ChartBar& last = bars[static_cast<size_t>(bars.BarCount)];
  if (request_.Place != ChartPlace::kOver)
    canvas_.SmallText(kEndTextX, top + 2, "Last date processed " + DateToShort(last.date()),
                      colour);
  if (!IsSuperimposed(request_.Place)) {
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
  const bool daily = request_.ChartPeriod == Period::kDaily;
  const auto average = [&](std::int16_t period, int entry, int index) {
    const auto draw = request_.MaExp ? ExpAverageLine : SimpleAverageLine;
    draw(pen_, period, chart_.CloseY, canvas_.colour(entry), chart_.FirstBarX, chart_.BarSpacing,
         index);
  };
  if (request_.Ma1On) average(daily ? request_.Ma1Days : request_.Ma1Weeks, kAverage2, 1);
  if (request_.Ma2On) average(daily ? request_.Ma2Days : request_.Ma2Weeks, kAverage3, 2);
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
    } catch (const ChartRefusal& refusal) {
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
      if (dialogs.Ask("Disk Not ready. Close drive door", kChartDisplay, Buttons::kOkCancel) ==
          Answer::kOk) {
        composer.DropScript();  // the next try writes all of it
        continue;
      }
      composer.GiveUpFiles();
      return false;
    }
    composer.GiveUpFiles();
    dialogs.Message(composer.FailureText(number, detail), kChartDisplay);
    return false;
  }
}

}  // namespace kora
