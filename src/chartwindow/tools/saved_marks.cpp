#include "chartwindow/tools/saved_marks.h"

#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

// A file that can't be read must not keep the chart from showing.
template <typename Work>
auto OrNone(Work work) -> decltype(work()) {
  try {
    return work();
  } catch (const RunTimeError&) {
    return {};
  }
}

}  // namespace

SavedMarks ReadSavedMarks(const Files& files, const std::string& miscPath, std::string_view code) {
  return {OrNone([&] { return ReadTrendlines(files, TrendlinePath(miscPath, code)); }),
          OrNone([&] { return ReadNoteLines(files, ChartNotesPath(miscPath, code)); })};
}

void DrawSavedMarks(const ChartCanvas& canvas, const SavedMarks& marks,
                    std::vector<TrendlineRow>& rows) {
  rows.clear();
  const ChartPlace place = canvas.request.Place;
  if (IsSplit(place) || IsSuperimposed(place)) return;
  rows.resize(marks.lines.size());
  const Colour colour = canvas.colour(kTrendlines);
  for (size_t i = 0; i < marks.lines.size(); ++i) {
    const auto line = PlaceTrendline(canvas.chart, canvas.request, marks.lines[i]);
    if (!line) continue;
    canvas.pen.Line('H', {line->x1, line->y1, line->x2, line->y2, colour});
    rows[i] = {CInt(line->x1), CInt(line->y1), CInt(line->x2), CInt(line->y2)};
  }
  for (const NoteLine& note : marks.notes)
    if (const auto at = PlaceNote(canvas.chart, note))
      canvas.SmallText(at->x, at->y, note.Text, note.Colour);
}

std::function<void(const ChartCanvas&)> SavedMarksOverlay(const Files& files,
                                                          const std::string& miscPath) {
  return [&files, miscPath](const ChartCanvas& canvas) {
    std::vector<TrendlineRow> rows;
    DrawSavedMarks(canvas, ReadSavedMarks(files, miscPath, canvas.request.Name.Code.trimmed()),
                   rows);
  };
}

}  // namespace kora
