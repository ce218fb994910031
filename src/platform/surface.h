#pragma once

#include <cstdint>
#include <string>
#include <string_view>

namespace kora {

// A 32-bit colour, red in the low byte: 0x00BBGGRR.
using Colour = std::int32_t;

enum class DrawStyle { kSolid = 0, kDash = 1, kDot = 2 };
enum class DrawMode { kXor = 7, kCopy = 13 };

// A font as the chart knows it. An empty name is the surface's own sans serif.
struct SurfaceFont {
  std::string name;
  double size = 8.25;  // points; 1 point is 96/72 chart units
  bool bold = false;
  bool italic = false;
  friend bool operator==(const SurfaceFont&, const SurfaceFont&) = default;
};

// What a chart is drawn on. Chart units: the origin is the upper left corner, x to the right,
// y downward, and one unit is one pixel at 96 dots to the inch, whatever the screen's scale.
// A unit coordinate names a pixel: a line from (1, 1) to (1, 3) is one unit wide and covers
// the rows 1, 2 and 3.
//
// State (pen, font, colours, text position) stays until it is changed. Coordinates far outside
// the surface are allowed and clipped.
class Surface {
 public:
  virtual ~Surface() = default;

  // Size in chart units.
  virtual double Width() const = 0;
  virtual double Height() const = 0;

  // Sets the user scale; ScaleWidth and ScaleHeight are what the composer lays out in. The
  // picture is stretched when they differ from Width and Height.
  virtual void SetScale(double left, double top, double width, double height) = 0;
  virtual double ScaleWidth() const = 0;
  virtual double ScaleHeight() const = 0;
  // A surface that grows sideways for a long chart (the multi-oscillator page).
  virtual void SetWidth(double width) = 0;

  // Fills with the background colour and puts the text position to 0, 0.
  virtual void Cls() = 0;
  virtual void SetBackColour(Colour colour) = 0;
  virtual void SetForeColour(Colour colour) = 0;  // of text

  virtual void SetDrawStyle(DrawStyle style) = 0;
  virtual void SetDrawWidth(double width) = 0;  // chart units, at least 1
  virtual void SetDrawMode(DrawMode mode) = 0;

  virtual void Line(double x1, double y1, double x2, double y2, Colour colour) = 0;
  // Boxes between two opposite corners, both corners part of the box.
  virtual void Box(double x1, double y1, double x2, double y2, Colour colour) = 0;
  virtual void FilledBox(double x1, double y1, double x2, double y2, Colour colour) = 0;
  virtual void PSet(double x, double y, Colour colour) = 0;

  // Error 380 when the surface refuses the name.
  virtual void SetFont(const SurfaceFont& font) = 0;
  virtual const SurfaceFont& Font() const = 0;
  // Whole chart units, rounded half to even.
  virtual double TextWidth(std::string_view text) const = 0;
  virtual double TextHeight() const = 0;

  virtual void SetCurrent(double x, double y) = 0;  // upper left corner of the next text
  virtual double CurrentX() const = 0;
  virtual double CurrentY() const = 0;
  // Prints UTF-8 at the current position and moves to x 0 of the next line (y + TextHeight()).
  virtual void Print(std::string_view text) = 0;

  // True while the surface keeps its picture by itself across paints.
  virtual void SetAutoRedraw(bool keep) = 0;
  virtual void SetVisible(bool visible) = 0;
  virtual bool Visible() const = 0;
};

}  // namespace kora
