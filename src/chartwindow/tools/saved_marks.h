#pragma once

#include <functional>
#include <string>
#include <vector>

#include "chart/chart_canvas.h"
#include "chartwindow/tools/trendline_places.h"

namespace kora {

// What is kept with a security and shows on every chart of it.
struct SavedMarks {
  std::vector<TrendlineRec> lines;
  std::vector<NoteLine> notes;
};
// Reads both files. One that is missing or can't be read shows nothing.
SavedMarks ReadSavedMarks(const Files& files, const std::string& miscPath, std::string_view code);

// Draws the lines, colour 23, and the texts, each in its own, of a chart that stands alone, and
// writes them to its script: "H" and "T". Row i of `rows` is where record i + 1 was drawn.
void DrawSavedMarks(const ChartCanvas& canvas, const SavedMarks& marks,
                    std::vector<TrendlineRow>& rows);

// The overlay for a composition that only shows them.
std::function<void(const ChartCanvas&)> SavedMarksOverlay(const Files& files,
                                                          const std::string& miscPath);

}  // namespace kora
