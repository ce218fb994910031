#include "chart/chart_pen.h"

#include <algorithm>
#include <string>

#include "base/numbers.h"
#include "base/text.h"

namespace kora {
namespace {

DrawStyle StyleOf(char letter) {
  switch (letter) {
    case 'D':
    case 'E': return DrawStyle::kDash;
    case 'V': return DrawStyle::kDot;
    default: return DrawStyle::kSolid;
  }
}

// A place in the script is a 32-bit float: finer than any paper, and half as long.
void Field(std::string& out, double value) {
  out += ',';
  AppendStr(out, static_cast<float>(value));
}

void Field(std::string& out, Colour value) {
  out += ',';
  AppendStr(out, value);
}

// A line of the script ends where the text does: nothing in it may end it before.
void AppendPlain(std::string& out, std::string_view text) {
  const bool plain = std::all_of(text.begin(), text.end(), [](char c) {
    return static_cast<unsigned char>(c) >= 32 && static_cast<unsigned char>(c) < 127;
  });
  if (plain) {
    out += text;
    return;
  }
  for (const char c : ToAnsi(text)) out += static_cast<unsigned char>(c) < 32 ? ' ' : c;
}

}  // namespace

ChartPen::ChartPen(Surface& surface, ChartScript* script) : surface_(surface), script_(script) {}

void ChartPen::SetScriptY(double scale, double offset) {
  yScale_ = scale;
  yOffset_ = offset;
}

void ChartPen::Write(char letter, const Segment& s) {
  if (!writes()) return;
  std::string& out = script_->buffer();
  out += letter;
  Field(out, s.x1);
  Field(out, s.y1 / yScale_ + yOffset_);
  Field(out, s.x2);
  Field(out, s.y2 / yScale_ + yOffset_);
  Field(out, s.colour);
  out += "\r\n";
}

void ChartPen::Line(char letter, const Segment& screen, const Segment& script) {
  LineStyled(StyleOf(letter), screen, letter, script);
}

void ChartPen::LineStyled(DrawStyle style, const Segment& screen, char letter,
                          const Segment& script) {
  if (style != DrawStyle::kSolid) surface_.SetDrawStyle(style);
  surface_.Line(screen.x1, screen.y1, screen.x2, screen.y2, screen.colour);
  if (style != DrawStyle::kSolid) surface_.SetDrawStyle(DrawStyle::kSolid);
  Write(letter, script);
}

void ChartPen::Box(char letter, const Segment& s) {
  surface_.Box(s.x1, s.y1, s.x2, s.y2, s.colour);
  Write(letter, s);
}

void ChartPen::FilledBox(char letter, const Segment& screen, const Segment& script) {
  surface_.FilledBox(screen.x1, screen.y1, screen.x2, screen.y2, screen.colour);
  Write(letter, script);
}

void ChartPen::Point(char letter, double x, double y, Colour colour) {
  surface_.PSet(x, y, colour);
  ScriptPoint(letter, x, y, colour);
}

void ChartPen::Text(char letter, const SurfaceFont& font, const TextAt& screen,
                    const TextAt& script) {
  if (!screen.text.empty()) {
    surface_.SetFont(font);
    surface_.SetForeColour(screen.colour);
    surface_.SetCurrent(screen.x, screen.y);
    surface_.Print(screen.text);
  }
  ScriptText(letter, script);
}

void ChartPen::ScriptText(char letter, const TextAt& at) {
  if (!writes() || at.text.empty()) return;
  std::string& out = script_->buffer();
  out += letter;
  Field(out, at.size);
  Field(out, at.x);
  Field(out, at.y / yScale_ + yOffset_);
  out += ',';
  AppendPlain(out, at.text);
  Field(out, at.colour);
  out += "\r\n";
}

void ChartPen::ScriptLineOnly(char letter, const Segment& s) { Write(letter, s); }

void ChartPen::ScriptPoint(char letter, double x, double y, Colour colour) {
  if (!writes()) return;
  std::string& out = script_->buffer();
  out += letter;
  Field(out, x);
  Field(out, y / yScale_ + yOffset_);
  Field(out, colour);
  out += "\r\n";
}

}  // namespace kora
