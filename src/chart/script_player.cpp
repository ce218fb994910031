#include "chart/script_player.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <new>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/chart_script.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

// The longest a chart of all panels over 32,767 records gets, with room to spare.
constexpr std::uint64_t kLargestSavedChart = 16u << 20;
constexpr double kLargestFont = 500;

constexpr std::string_view kLineLetters = "BFHLMCDEV";
constexpr std::string_view kTextLetters = "TSZ";

bool Holds(std::string_view letters, char letter) {
  return letter != '\0' && letters.find(letter) != std::string_view::npos;
}

// A number of a text or a point, which stays fractional. Error 6 beyond 32-bit floats.
double Place(const ScriptLine& line, int field) {
  const double value = line.number(field);
  if (!(std::abs(value) <= std::numeric_limits<float>::max())) throw RunTimeError(kOverflow);
  return value;
}

double FontSize(const ScriptLine& line) {
  const double size = Place(line, 2);
  if (size < 1 || size > kLargestFont) throw RunTimeError(kInvalidValue);
  return size;
}

class Player {
 public:
  Player(Surface& surface, const FontSettings& fonts, const ChartColours& colours)
      : surface_(surface), fonts_(fonts), textColour_(colours[kScalesText]) {
    font_ = {fonts.Font1Name, ChartFontSize(), fonts.Font1Bold, false};
    surface_.SetFont(font_);
    surface_.SetDrawStyle(DrawStyle::kSolid);
  }

  void Play(const ScriptLine& line) {
    const char letter = line.letter();
    if (Holds(kTextLetters, letter)) {
      if (letter == 'T') Text(line);
      else if (letter == 'S') ScaleText(line);
      else Stamp(line);
    } else if (Holds(kLineLetters, letter)) {
      Segment(letter, line);
    } else if (letter == 'P') {
      surface_.PSet(Place(line, 2), Place(line, 3), line.whole(4));
    } else {
      return;
    }
    commandSeen_ = true;
  }

  bool CommandSeen() const { return commandSeen_; }

 private:
  double ChartFontSize() const { return fonts_.TitleSize >= 1 ? fonts_.TitleSize : 8; }

  void Print(const ScriptLine& line, const SurfaceFont& font) {
    const double x = Place(line, 3), y = Place(line, 4);
    const Colour colour = line.whole(6);
    surface_.SetFont(font);
    surface_.SetForeColour(colour);
    surface_.SetCurrent(x, y);
    surface_.Print(FromAnsi(line.text[4]));
  }

  void Text(const ScriptLine& line) {
    font_.size = FontSize(line);
    Print(line, font_);
    surface_.SetForeColour(textColour_);
  }

  void ScaleText(const ScriptLine& line) {
    if (!line.text[4].empty()) {
      font_.size = FontSize(line);
      Print(line, {fonts_.Font2Name, font_.size, false, font_.italic});
    }
    font_.bold = fonts_.Font1Bold;
    surface_.SetFont(font_);
    surface_.SetDrawStyle(DrawStyle::kSolid);
  }

  // Leaves the bold off, whatever Font 1 is set to: the next S brings it back.
  void Stamp(const ScriptLine& line) {
    font_.size = FontSize(line);
    Print(line, {font_.name, font_.size, true, true});
    font_.bold = font_.italic = false;
    surface_.SetFont(font_);
  }

  void Segment(char letter, const ScriptLine& line) {
    const std::int32_t x1 = line.whole(2), y1 = line.whole(3), x2 = line.whole(4),
                       y2 = line.whole(5);
    const Colour colour = line.whole(6);
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
  bool commandSeen_ = false;
};

// A file that ends within a line was cut off: the line has no end and lacks fields. A last line
// that is whole needs no end.
bool IsCutOff(std::string_view line, const ScriptLine& fields) {
  const char letter = fields.letter();
  const auto commas = std::count(line.begin(), line.end(), ',');
  if (Holds(kLineLetters, letter) || Holds(kTextLetters, letter)) return commas < 5;
  return letter == 'P' && commas < 3;
}

}  // namespace

bool PlayChartScript(std::string_view script, Surface& surface, const FontSettings& fonts,
                     const ChartColours& colours) {
  try {
    Player player(surface, fonts, colours);
    LineReader reader(script);
    std::string_view line;
    ScriptLine fields;
    while (reader.Next(line)) {
      SplitScriptLine(line, fields);
      const bool endsTheFile = line.data() + line.size() == script.data() + script.size();
      if (endsTheFile && IsCutOff(line, fields)) throw RunTimeError(kBadCall);
      player.Play(fields);
    }
    return player.CommandSeen();
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
    const std::string script = files.ReadAll(SavedChartFile, kLargestSavedChart);
    played = PlayChartScript(script, surface, fonts, colours);
  } catch (const RunTimeError&) {
    // A file that can't be read is told as one that can't be played.
  } catch (const std::bad_alloc&) {
  }
  dialogs.SetBusy(false);
  if (!played)
    dialogs.Message("There is problem displaying this chart - format invalid.",
                    "Show Saved Chart");
  return played;
}

}  // namespace kora
