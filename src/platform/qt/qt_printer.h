#pragma once

#include <QFont>
#include <QRgb>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "platform/printer.h"

class QPagedPaintDevice;
class QPainter;

namespace kora {

// Pages put together out of sight, to be painted wherever Qt paints. Texts of the standard face
// measure as on the screen.
//
// Needs a QGuiApplication.
class QtPaper : public Printer {
 public:
  QtPaper();

  void StartDoc(std::string_view title) override;
  void NewPage() override;
  void KillDoc() override;

  void SetScale(double left, double top) override;
  void SetDrawStyle(DrawStyle style) override { pen_.style = style; }
  void SetDrawWidth(double width) override { pen_.width = width > 1 ? width : 1; }
  void SetForeColour(Colour colour) override { fore_ = colour; }
  void Line(double x1, double y1, double x2, double y2, Colour colour) override;
  void Box(double x1, double y1, double x2, double y2, Colour colour) override;
  void FilledBox(double x1, double y1, double x2, double y2, Colour colour) override;
  void SetFont(const SurfaceFont& font) override;
  double TextWidth(std::string_view text) const override;
  double TextHeight() const override { return face().height; }
  void SetCurrent(double x, double y) override;
  double CurrentX() const override { return x_; }
  double CurrentY() const override { return y_; }
  void Print(std::string_view text) override;

  size_t PageCount() const { return pages_.size(); }
  // Paints a page (from 0): a unit of the painter is a twip, its origin the upper left corner
  // of the part that the printer reaches.
  void PaintPage(QPainter& painter, size_t page) const;

 protected:
  bool IsOpen() const { return open_; }
  // Ends the document and gives its title; the pages stay until the next one.
  std::string Close();

 private:
  struct Pen {
    double width = 1;  // dots
    DrawStyle style = DrawStyle::kSolid;
  };
  enum class Shape { kLine, kBox, kFilledBox, kText };
  struct Op {
    Shape shape;
    double x1, y1, x2, y2;  // twips from the origin of the page; of a text the start, base line
    Colour colour;
    Pen pen;
    size_t face;
    std::string text;
  };
  struct Face {
    SurfaceFont key;
    QFont font;  // a pixel is a twip
    bool standard;
    double ascent, height;
  };

  void Reset();
  void Add(Shape shape, double x1, double y1, double x2, double y2, Colour colour);
  const Face& face() const;

  bool open_ = false;
  std::string title_;
  std::vector<std::vector<Op>> pages_;
  mutable std::vector<Face> faces_;
  mutable std::optional<size_t> face_;  // of font_
  SurfaceFont font_;
  Pen pen_;
  Colour fore_ = 0;
  double left_ = 0, top_ = 0, x_ = 0, y_ = 0;
};

// The printers of the machine, and one that makes a PDF.
class QtPrinter : public QtPaper {
 public:
  // Stands last in the list of printers; it is there on every machine, but never the default.
  static constexpr std::string_view kPdfPrinter = "PDF file";

  // Takes the finished PDF; its errors are those of EndDoc.
  using PdfSink = std::function<void(const std::string& bytes)>;
  explicit QtPrinter(PdfSink pdf) : pdf_(std::move(pdf)) {}

  std::vector<std::string> DeviceNames() const override;
  std::string DeviceName() const override;
  void SetDevice(std::string_view name) override;
  std::int16_t Orientation() const override { return orientation_; }
  void SetOrientation(std::int16_t orientation) override;
  std::vector<std::string> PaperNames() const override;
  std::string PaperName() const override;
  void SetPaper(std::string_view name) override;
  Sheet Page() const override;
  void EndDoc() override;

 private:
  std::string Pdf(const std::string& title) const;
  void SendToQueue(const std::string& title) const;
  // False when the device takes no painter or no further page.
  bool Paint(QPagedPaintDevice& device) const;

  PdfSink pdf_;
  mutable std::optional<std::string> device_;  // empty: not asked for yet
  std::int16_t orientation_ = kPortrait;
  std::string paper_;  // empty: the printer's own
  mutable std::optional<Sheet> sheet_;
};

// The page of another printer, to be looked at: nothing is ever sent, and there is always a
// page, with a printer or without.
class QtPreview : public QtPaper {
 public:
  explicit QtPreview(const Printer& of) : of_(of) {}
  std::vector<std::string> DeviceNames() const override { return of_.DeviceNames(); }
  std::string DeviceName() const override { return "Preview"; }
  void SetDevice(std::string_view) override {}
  std::int16_t Orientation() const override { return of_.Orientation(); }
  void SetOrientation(std::int16_t) override {}
  std::vector<std::string> PaperNames() const override { return of_.PaperNames(); }
  std::string PaperName() const override { return of_.PaperName(); }
  void SetPaper(std::string_view) override {}
  Sheet Page() const override { return of_.Page(); }
  void EndDoc() override { Close(); }

 private:
  const Printer& of_;
};

}  // namespace kora
