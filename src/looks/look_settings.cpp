#include "looks/look_settings.h"

#include <algorithm>
#include <cmath>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr const char* kCharts = "Charts";
constexpr const char* kFonts = "Chart Fonts";

void Put(SettingsFile& ini, std::string_view key, std::int16_t value) {
  ini.PutSetting(kCharts, key, Str(std::int32_t(value)));
}

void Put(SettingsFile& ini, std::string_view key, bool value) {
  ini.PutSetting(kCharts, key, value ? "True" : "False");
}

// A text that is a number from `least` to `most`, as a whole one.
std::optional<std::int16_t> WholeWithin(std::string_view text, int least, int most) {
  const std::optional<float> value = ParseFloat(Trim(text));
  if (!value || *value < float(least) || *value > float(most)) return std::nullopt;
  return CInt(double(*value));
}

}  // namespace

std::int16_t PrintedLineWidth(const Settings& settings) {
  const std::int16_t width = settings.charts.LineWidth;
  return width < kLeastLineWidth || width > kMostLineWidth ? std::int16_t(2) : width;
}

void SaveLineWidth(SettingsFile& ini, Settings& settings, std::int16_t width) {
  settings.charts.LineWidth = width;
  Put(ini, "Line Width", width);
}

void SaveVHeight(SettingsFile& ini, Settings& settings, std::int16_t height) {
  settings.charts.VolHeight = std::clamp<std::int16_t>(height, 1, 3);
  Put(ini, "VHeight", settings.charts.VolHeight);
}

bool SaveGridSpacing(SettingsFile& ini, Settings& settings, std::string_view space, bool midGrid) {
  const std::optional<std::int16_t> bars = WholeWithin(space, 0, 100);
  if (!bars) return false;
  ChartSettings& charts = settings.charts;
  charts.GridSpace = *bars;
  charts.MovingGrid = *bars == 0;
  charts.HalfGrid = midGrid;
  const SettingsFile::Batch batch(ini);
  Put(ini, "VGSpace", *bars);
  Put(ini, "MidGrid", midGrid);
  return true;
}

// In twentieths, so that step 25 is 5.2 and not a trifle more.
double WeekFactorOfStep(int step) { return double(79 + step) / 20; }

int StepOfWeekFactor(double weekFactor) {
  const double step = RoundHalfEven(weekFactor * 20) - 79;
  return int(std::clamp<double>(std::isfinite(step) ? step : 1, 1, kWeekSteps));
}

bool SaveBlankSpace(SettingsFile& ini, Settings& settings, std::string_view space, int weekStep) {
  const std::optional<std::int16_t> units = WholeWithin(space, 1, 150);
  if (!units) return false;
  settings.charts.BlankSpace = *units;
  settings.charts.WeekFactor = WeekFactorOfStep(weekStep);
  const SettingsFile::Batch batch(ini);
  Put(ini, "DBlank", *units);
  ini.PutSetting(kCharts, "WeekFactor", Str(settings.charts.WeekFactor));
  return true;
}

std::int16_t LeastSpacing(Style chartStyle) { return chartStyle == Style::kCandlestick ? 3 : 1; }

void SaveSpacing(SettingsFile& ini, Settings& settings, std::int16_t spacing) {
  settings.charts.Spacing = spacing;
  Put(ini, "Spacing", spacing);
}

namespace {

void WriteFonts(SettingsFile& ini, Settings& settings, const FontChoice& first,
                const FontChoice& second) {
  FontSettings& fonts = settings.fonts;
  fonts.Font1Name = first.name;
  fonts.TitleSize = first.points;
  fonts.Font2Name = second.name;
  fonts.Font2Size = second.points;
  const SettingsFile::Batch batch(ini);
  ini.PutSetting(kFonts, "CFont", first.name);
  ini.PutSetting(kFonts, "CFontSize", Str(first.points));
  ini.PutSetting(kFonts, "SFont", second.name);
  ini.PutSetting(kFonts, "SFontSize", Str(second.points));
}

}  // namespace

void SaveNoFonts(SettingsFile& ini, Settings& settings, double titlePoints, double labelPoints) {
  WriteFonts(ini, settings, {{}, titlePoints}, {{}, labelPoints});
}

bool SaveFonts(SettingsFile& ini, Settings& settings, const FontChoice& first,
               const FontChoice& second) {
  if (first.name.empty() || second.name.empty()) return false;
  WriteFonts(ini, settings, first, second);
  return true;
}

void SaveZoom(SettingsFile& ini, Settings& settings, std::int16_t percent) {
  settings.Zoom = std::clamp(percent, kLeastZoom, kMostZoom);
  ini.PutSetting("ChartForms", "Zoom", Str(std::int32_t(settings.Zoom)));
}

std::optional<std::string> ReadFinishDate(std::string_view typed) {
  const std::optional<CalendarDate> date = ParseUserDate(Trim(typed));
  if (!date) return std::nullopt;
  return FormatFileDate(*date);
}

std::string FinishDateText(std::string_view yyyymmdd) {
  const std::optional<CalendarDate> date = ParseFileDate(yyyymmdd);
  if (!date) return {};
  const std::string text = FormatUserDate(*date);
  return ParseUserDate(text) == date ? text : FormatDisplayDate(*date);
}

void SaveScales(const Files& files, const std::string& dataPath, CurrentName& current,
                std::string_view base, std::string_view top, std::string_view pfInc) {
  const float values[3] = {CSng(Val(base)), CSng(Val(top)), CSng(Val(pfInc))};
  RewriteCurrentName(files, dataPath, current, [&](NameRec& record) {
    record.Base = values[0];
    record.Top = values[1];
    record.PFInc = values[2];
    record.MinMove = 0.05f;
  });
}

std::string NotSavedText(const RunTimeError& error) {
  const bool held = dynamic_cast<const HomeIsHeld*>(&error) != nullptr;
  return held ? error.what() : std::string(kNotSavedMessage);
}

std::string ScaleText(float value) { return value == 0 ? std::string() : Str(value); }

}  // namespace kora
