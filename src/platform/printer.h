#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "platform/surface.h"

namespace kora {

inline constexpr double kTwipsPerInch = 1440;
inline constexpr std::int16_t kPortrait = 1, kLandscape = 2;

// The sheet that a printer prints on, as it lies, in twips (1/1440 inch): the whole sheet and,
// within it, the part that the printer reaches.
struct Sheet {
  double width = 0, height = 0;
  double left = 0, top = 0;  // of the part that is reached
  double reachWidth = 0, reachHeight = 0;
};

// What prints. A document is put together out of sight and sent as it ends, so that one that
// fails or is dropped leaves no page.
//
// Coordinates are twips. The upper left corner of the part that the printer reaches has the
// coordinates (ScaleLeft, ScaleTop), so that a negative origin is a margin. What lies outside
// that part is cut off. State (scale, pen, font, colours, text position) is the printer's own,
// stays across pages and starts anew with each document.
class Printer {
 public:
  virtual ~Printer() = default;

  // The printers of the machine, and the one in use: the default one until another was chosen,
  // empty where there is none. Error 68 for a name that no printer has.
  virtual std::vector<std::string> DeviceNames() const = 0;
  virtual std::string DeviceName() const = 0;
  virtual void SetDevice(std::string_view name) = 0;
  bool Exists() const { return !DeviceName().empty(); }

  // 1 portrait, 2 landscape. Neither can be changed within a document: error 5.
  virtual std::int16_t Orientation() const = 0;
  virtual void SetOrientation(std::int16_t orientation) = 0;
  // "A4", "Letter", ...: names of the paper sizes, and the one in use. Error 380 for others.
  virtual std::vector<std::string> PaperNames() const = 0;
  virtual std::string PaperName() const = 0;
  virtual void SetPaper(std::string_view name) = 0;

  // Without a printer, the sheet of the paper.
  virtual Sheet Page() const = 0;
  double ScaleWidth() const { return Page().reachWidth; }
  double ScaleHeight() const { return Page().reachHeight; }
  // A chart unit that is not enlarged: 1/96 inch, as on the screen.
  virtual double TwipsPerPixelX() const { return 15; }
  virtual double TwipsPerPixelY() const { return 15; }

  // Begins a document on its first page. Error 68 without a printer.
  virtual void StartDoc(std::string_view title) = 0;
  virtual void NewPage() = 0;
  // Sends the document. The document is over then, also when that fails: error 61 disk full,
  // 68 printer not available, and those of a file.
  virtual void EndDoc() = 0;
  // Drops the document; nothing is sent. Without a document nothing happens.
  virtual void KillDoc() = 0;

  virtual void SetScale(double left, double top) = 0;
  virtual void SetDrawStyle(DrawStyle style) = 0;
  // In dots of 1/300 inch, at least 1.
  virtual void SetDrawWidth(double width) = 0;
  virtual void SetForeColour(Colour colour) = 0;
  // A line of no length is a point of the pen's width.
  virtual void Line(double x1, double y1, double x2, double y2, Colour colour) = 0;
  virtual void Box(double x1, double y1, double x2, double y2, Colour colour) = 0;
  virtual void FilledBox(double x1, double y1, double x2, double y2, Colour colour) = 0;

  // Error 380 when the printer refuses the font.
  virtual void SetFont(const SurfaceFont& font) = 0;
  virtual double TextWidth(std::string_view text) const = 0;
  virtual double TextHeight() const = 0;
  virtual void SetCurrent(double x, double y) = 0;  // upper left corner of the next text
  virtual double CurrentX() const = 0;
  virtual double CurrentY() const = 0;
  // UTF-8. Moves to the scale's left edge of the next line.
  virtual void Print(std::string_view text) = 0;
};

}  // namespace kora
