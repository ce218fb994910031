#include "chartwindow/tools/text_note.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chart/chart_canvas.h"

namespace kora {
namespace {

constexpr char32_t kBackspace = 8, kEnter = 13;

}  // namespace

void TextNoteTool::Print(int entry) const {
  if (TextBuffer_.empty()) return;
  Surface& surface = view_.price;
  const FontSettings& fonts = view_.settings.fonts;
  surface.SetFont({fonts.Font1Name, ChartCanvas::kSmallText, fonts.Font1Bold, false});
  surface.SetForeColour(view_.colours[size_t(entry)]);
  surface.SetCurrent(TextX_, TextY_);
  surface.Print(TextBuffer_);
  view_.Touched(surface, TextX_, TextY_, TextX_ + surface.TextWidth(TextBuffer_) + 1,
                TextY_ + surface.TextHeight());
}

ToolState TextNoteTool::Press(const ToolPoint& at, MouseButton button) {
  if (button != MouseButton::kLeft || at.pane != Pane::kPrice || !view_.Readable())
    return ToolState::kOn;
  Print(kBackground);
  TextPending_ = false;
  TextX_ = at.x;
  TextY_ = at.y;
  Print(kChartTitle);
  view_.title = "Text - Enter text required - Press ENTER to Save";
  return ToolState::kOn;
}

ToolState TextNoteTool::Type(char32_t character) {
  if (TextPending_) return ToolState::kOn;
  if (character == kEnter) return Save();
  if (character == kBackspace) {
    Print(kBackground);
    if (!TextBuffer_.empty()) TextBuffer_.pop_back();
    Print(kChartTitle);
    return ToolState::kOn;
  }
  // A comma would end the text's field in the file.
  if (character < 32 || character > 126 || character == ',') return ToolState::kOn;
  // Smoothed letters printed over themselves grow thick: the old ones go first.
  Print(kBackground);
  TextBuffer_ += char(character);
  Print(kChartTitle);
  return ToolState::kOn;
}

ToolState TextNoteTool::Save() {
  const std::string text = TextBuffer_;
  if (Trim(text).empty()) return ToolState::kDone;
  const Composition& chart = view_.chart;
  const std::int32_t column = ColumnOf(chart, TextX_);
  std::string place = Str(TextX_);
  if (column >= 0 && size_t(column) < chart.Bars.bars.size()) {
    const std::string_view date = chart.Bars[size_t(column)].date();
    if (!Trim(date).empty()) place = date;
  }
  try {
    AppendNoteLine(
        view_.files,
        ChartNotesPath(view_.settings.paths.ChartMiscPath, view_.request.Name.Code.trimmed()),
        MakeNoteLine(place, chart.Price.Price(TextY_), text, view_.colours[kScalesText]));
    TextBuffer_.clear();  // it stands
    view_.Keep({.letter = 'T',
                .x1 = TextX_,
                .y1 = TextY_,
                .colour = view_.colours[kScalesText],
                .text = text});
  } catch (const RunTimeError& e) {
    view_.dialogs.Message(e.what(), "Text");
  }
  return ToolState::kDone;
}

void TextNoteTool::Recomposed() {
  TextBuffer_.clear();
  TextPending_ = true;
}

void TextNoteTool::Leave() { Print(kBackground); }

}  // namespace kora
