#pragma once

#include <string_view>

#include "chart/chart_script.h"
#include "platform/surface.h"

namespace kora {

struct Segment {
  double x1, y1, x2, y2;
  Colour colour;
};

struct TextAt {
  double size;  // points, for the script
  double x, y;  // upper left corner
  std::string_view text;
  Colour colour;
};

// The one place that draws on the surface and writes the script, as a pair. Where the two
// differ on purpose the call takes both. With no script, or one that is not open, it only
// draws.
//
// Letters and how they look on the surface: H, L, M solid; D, E dashed; V dotted; B outline;
// C, F filled; T Font 1, S Font 2, Z Font 1 bold and italic.
class ChartPen {
 public:
  // Neither is owned. `script` may be null.
  ChartPen(Surface& surface, ChartScript* script);

  Surface& surface() { return surface_; }
  bool writes() const { return script_ && script_->IsOpen(); }

  // Coordinates on a panel go to the script as y / scale + offset. 1 and 0 at the start.
  void SetScriptY(double scale, double offset);

  void Line(char letter, const Segment& s) { Line(letter, s, s); }
  void Line(char letter, const Segment& screen, const Segment& script);
  // As Line, but with a pen on the surface that is not the letter's own.
  void LineStyled(DrawStyle style, const Segment& screen, char letter, const Segment& script);
  void Box(char letter, const Segment& s);
  // Filled on the surface, whatever the letter makes of it on paper.
  void FilledBox(char letter, const Segment& screen, const Segment& script);
  void Point(char letter, double x, double y, Colour colour);

  // Text in `font` on the surface. An empty text draws and writes nothing. Characters that
  // would break a line become blanks.
  void Text(char letter, const SurfaceFont& font, const TextAt& at) { Text(letter, font, at, at); }
  void Text(char letter, const SurfaceFont& font, const TextAt& screen, const TextAt& script);

  // One side alone.
  void ScriptText(char letter, const TextAt& at);
  void ScriptLineOnly(char letter, const Segment& s);
  void ScriptPoint(char letter, double x, double y, Colour colour);

  // Where the script stands, and back to there: what was written since is gone, as when the
  // surface was painted over.
  size_t ScriptMark() const { return writes() ? script_->text().size() : 0; }
  void CutScript(size_t mark) {
    if (writes()) script_->buffer().resize(mark);
  }

 private:
  void Write(char letter, const Segment& s);

  Surface& surface_;
  ChartScript* script_;
  double yScale_ = 1;
  double yOffset_ = 0;
};

}  // namespace kora
