#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "base/runtime_error.h"
#include "chart/chart_script.h"

// What the two players of a chart script, that of the screen and that of the printer, share.

namespace kora {

enum class ScriptMedium { kScreen, kPaper };

// What a command's fields are. kNone: a line that the player passes over.
enum class ScriptShape { kNone, kText, kSegment, kPoint };
ScriptShape ShapeOf(char letter, ScriptMedium medium);

// The whole of a saved chart or of TCht.Tmp. Error 7 above 16 MB, which is no chart of ours.
std::string ReadChartScript(const Files& files, std::string_view path);

// A number of a text or a point, which stays fractional. Error 6 beyond 32-bit floats.
double ScriptPlace(const ScriptLine& line, int field);

// What one play may draw. A chart needs far less; a hostile script would keep the program busy
// for minutes.
class PlayBudget {
 public:
  explicit PlayBudget(double mostWork) : mostWork_(mostWork) {}
  // Error 7 when there is no more.
  void Spend(double work);
  // The size of a text's font. Error 380 for one that is none (outside 1 to 500 points), 7 for
  // more sizes than any chart has.
  double FontSize(const ScriptLine& line);

 private:
  double mostWork_, work_ = 0;
  std::vector<double> sizes_;
};

// A file that ends within a line was cut off: the line has no end and lacks fields. A last line
// that is whole needs no end.
bool IsCutOff(std::string_view line, const ScriptLine& fields, ScriptMedium medium);

// Splits `script` and hands each command that the medium knows to `play`. True when there was
// one. Errors of SplitScriptLine and of `play`, and error 5 for a last line that is cut off.
template <typename Play>
bool ForEachCommand(std::string_view script, ScriptMedium medium, Play play) {
  bool commandSeen = false;
  LineReader reader(script);
  std::string_view line;
  ScriptLine fields;
  while (reader.Next(line)) {
    SplitScriptLine(line, fields);
    const bool endsTheFile = line.data() + line.size() == script.data() + script.size();
    if (endsTheFile && IsCutOff(line, fields, medium)) throw RunTimeError(kBadCall);
    const ScriptShape shape = ShapeOf(fields.letter(), medium);
    if (shape == ScriptShape::kNone) continue;
    play(shape, fields);
    commandSeen = true;
  }
  return commandSeen;
}

}  // namespace kora
