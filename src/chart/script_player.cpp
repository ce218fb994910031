#include "chart/script_player.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <new>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/chart_script.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

// Far above any chart of ours; what is larger is not worth reading.
constexpr std::uint64_t kLargestSavedChart = 16u << 20;
constexpr double kLargestFont = 500;
constexpr size_t kMostFontSizes = 32;  // a chart has a handful

// What one play may draw, in units of a solid line's length, about ten nanoseconds each on a
// picture in memory: far more than a chart needs, where a hostile script would keep the window
// busy for minutes.
constexpr double kMostWork = 2e8;
constexpr double kWorkOfCommand = 10, kWorkOfText = 500, kWorkOfCharacter = 40;
constexpr double kDashedFactor = 4, kFilledUnitsPerWork = 40;

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

  void Play(const ScriptLine& line) {
    const char letter = line.letter();
    if (Holds(kTextLetters, letter)) {
      if (letter == 'T') Text(line);
      else if (letter == 'S') ScaleText(line);
      else Stamp(line);
    } else if (Holds(kLineLetters, letter)) {
      Segment(letter, line);
    } else if (letter == 'P') {
      Spend(kWorkOfCommand);
      surface_.PSet(Place(line, 2), Place(line, 3), line.whole(4));
    } else {
      return;
    }
    commandSeen_ = true;
  }

  bool CommandSeen() const { return commandSeen_; }

 private:
  double ChartFontSize() const { return fonts_.TitleSize >= 1 ? fonts_.TitleSize : 8; }

  void Spend(double work) {
    work_ += work;
    if (work_ > kMostWork) throw RunTimeError(kOutOfMemory);
  }

  double FontSize(const ScriptLine& line) {
    const double size = Place(line, 2);
    if (size < 1 || size > kLargestFont) throw RunTimeError(kInvalidValue);
    if (std::find(sizes_.begin(), sizes_.end(), size) == sizes_.end()) {
      if (sizes_.size() == kMostFontSizes) throw RunTimeError(kOutOfMemory);
      sizes_.push_back(size);
    }
    return size;
  }

  void Print(const ScriptLine& line, const SurfaceFont& font) {
    Spend(kWorkOfText + kWorkOfCharacter * double(line.text[4].size()));
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
    const double across = std::min(std::abs(double(x2) - x1), width_);
    const double down = std::min(std::abs(double(y2) - y1), height_);
    const bool filled = letter == 'C' || letter == 'F';
    const bool broken = letter == 'D' || letter == 'E' || letter == 'V';
    Spend(kWorkOfCommand + (filled ? across * down / kFilledUnitsPerWork
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
  double work_ = 0;
  std::vector<double> sizes_;  // of fonts seen so far
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
