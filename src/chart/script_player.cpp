#include "chart/script_player.h"

#include <algorithm>
#include <cmath>
#include <new>

#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/script_reading.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

// In units of a solid line's length, about ten nanoseconds each on a picture in memory.
constexpr double kMostWork = 2e8;
constexpr double kWorkOfCommand = 10, kWorkOfText = 500, kWorkOfCharacter = 40;
constexpr double kDashedFactor = 4, kFilledUnitsPerWork = 40;

class Player {
 public:
  Player(Surface& surface, const FontSettings& fonts, const ChartColours& colours)
      : surface_(surface),
        fonts_(fonts),
        textColour_(colours[kScalesText]),
        width_(surface.ScaleWidth()),
        height_(surface.ScaleHeight()) {
    font_ = {fonts.Font1Name, ChartFontSize(), fonts.Font1Bold, false};
    surface_.SetFont(font_);
    surface_.SetDrawStyle(DrawStyle::kSolid);
  }

  void Play(ScriptShape shape, const ScriptLine& line) {
    const char letter = line.letter();
    if (shape == ScriptShape::kSegment) return Segment(letter, line);
    if (shape == ScriptShape::kPoint) return Point(line);
    if (letter == 'T')
      Text(line);
    else if (letter == 'S')
      ScaleText(line);
    else
      Stamp(line);
  }

 private:
  double ChartFontSize() const { return fonts_.TitleSize >= 1 ? fonts_.TitleSize : 8; }

  void Point(const ScriptLine& line) {
    budget_.Spend(kWorkOfCommand);
    surface_.PSet(ScriptPlace(line, 2), ScriptPlace(line, 3), line.whole(4));
  }

  void Print(const ScriptLine& line, const SurfaceFont& font) {
    budget_.Spend(kWorkOfText + kWorkOfCharacter * double(line.text[4].size()));
    const double x = ScriptPlace(line, 3), y = ScriptPlace(line, 4);
    const Colour colour = line.whole(6);
    surface_.SetFont(font);
    surface_.SetForeColour(colour);
    surface_.SetCurrent(x, y);
    surface_.Print(FromAnsi(line.text[4]));
  }

  void Text(const ScriptLine& line) {
    font_.size = budget_.FontSize(line);
    Print(line, font_);
    surface_.SetForeColour(textColour_);
  }

  void ScaleText(const ScriptLine& line) {
    if (!line.text[4].empty()) {
      font_.size = budget_.FontSize(line);
      Print(line, {fonts_.Font2Name, font_.size, false, font_.italic});
    }
    font_.bold = fonts_.Font1Bold;
    surface_.SetFont(font_);
    surface_.SetDrawStyle(DrawStyle::kSolid);
  }

  // Leaves the bold off, whatever Font 1 is set to: the next S brings it back.
  void Stamp(const ScriptLine& line) {
    font_.size = budget_.FontSize(line);
    Print(line, {font_.name, font_.size, true, true});
    font_.bold = font_.italic = false;
    surface_.SetFont(font_);
  }

  void Segment(char letter, const ScriptLine& line) {
    const std::int32_t x1 = line.whole(2), y1 = line.whole(3), x2 = line.whole(4),
                       y2 = line.whole(5);
    const Colour colour = line.whole(6);
    const double across = std::min(std::abs(double(x2) - x1), width_);
    const double down = std::min(std::abs(double(y2) - y1), height_);
    const bool filled = letter == 'C' || letter == 'F';
    const bool broken = letter == 'D' || letter == 'E' || letter == 'V';
    budget_.Spend(kWorkOfCommand + (filled ? across * down / kFilledUnitsPerWork
                                           : (across + down) * (broken ? kDashedFactor : 2)));
    switch (letter) {
      case 'B': surface_.Box(x1, y1, x2, y2, colour); return;
      case 'C':
      case 'F': surface_.FilledBox(x1, y1, x2, y2, colour); return;
      case 'D':
      case 'E': surface_.SetDrawStyle(DrawStyle::kDash); break;
      case 'V':
        surface_.SetDrawWidth(1);
        surface_.SetDrawStyle(DrawStyle::kDot);
        break;
      default: surface_.Line(x1, y1, x2, y2, colour); return;
    }
    surface_.Line(x1, y1, x2, y2, colour);
    surface_.SetDrawStyle(DrawStyle::kSolid);
  }

  Surface& surface_;
  const FontSettings& fonts_;
  Colour textColour_;
  SurfaceFont font_;  // Font 1 as the lines have left it
  double width_, height_;
  PlayBudget budget_{kMostWork};
};

}  // namespace

bool PlayChartScript(std::string_view script, Surface& surface, const FontSettings& fonts,
                     const ChartColours& colours) {
  try {
    Player player(surface, fonts, colours);
    return ForEachCommand(
        script, ScriptMedium::kScreen,
        [&player](ScriptShape shape, const ScriptLine& line) { player.Play(shape, line); });
  } catch (const RunTimeError&) {
    return false;
  } catch (const std::bad_alloc&) {
    return false;
  }
}

bool ShowSavedChart(const Files& files, Dialogs& dialogs, Surface& surface,
                    const FontSettings& fonts, const ChartColours& colours,
                    std::string_view SavedChartFile) {
  dialogs.SetBusy(true);
  bool played = false;
  try {
    surface.SetScale(0, 0, surface.Width(), surface.Height());
    surface.SetBackColour(colours[kBackground]);
    surface.SetDrawMode(DrawMode::kCopy);
    surface.SetDrawWidth(1);
    surface.Cls();
    const std::string script = ReadChartScript(files, SavedChartFile);
    played = PlayChartScript(script, surface, fonts, colours);
  } catch (const RunTimeError&) {
    // A file that can't be read is told as one that can't be played.
  } catch (const std::bad_alloc&) {
  }
  dialogs.SetBusy(false);
  if (!played)
    dialogs.Message("There is problem displaying this chart - format invalid.", "Show Saved Chart");
  return played;
}

}  // namespace kora
