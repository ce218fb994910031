#include "platform/qt/qt_printer.h"

#include <QBuffer>
#include <QFontMetricsF>
#include <QHashFunctions>
#include <QLibrary>
#include <QPageLayout>
#include <QPageSize>
#include <QPainter>
#include <QPdfWriter>
#include <QPrinter>
#include <QPrinterInfo>
#include <QScopeGuard>
#include <algorithm>
#include <cmath>
#include <memory>

#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/qt/chart_font.h"
#include "platform/qt/line_cut.h"
#include "platform/qt/qt_surface.h"
#include "platform/qt/to_qt.h"
#include "platform/text_metrics.h"

namespace kora {
namespace {

constexpr double kTwipsPerUnit = 15;  // of text sizes, which are known in chart units
constexpr double kTwipsPerPoint = 20;
constexpr double kTwipsPerDot = kTwipsPerInch / 300;
constexpr double kPdfEdge = 170;  // 3 mm, as near to the edge as printers come
constexpr int kPdfResolution = 1440;

struct Paper {
  const char* name;
  QPageSize::PageSizeId id;
};
constexpr Paper kPapers[] = {{"A4", QPageSize::A4},       {"A3", QPageSize::A3},
                             {"A5", QPageSize::A5},       {"Letter", QPageSize::Letter},
                             {"Legal", QPageSize::Legal}, {"Tabloid", QPageSize::Tabloid}};

std::optional<QPageSize::PageSizeId> PaperId(std::string_view name) {
  for (const Paper& paper : kPapers)
    if (EqualNoCase(paper.name, name)) return paper.id;
  return std::nullopt;
}

QPageLayout::Orientation QtOrientation(std::int16_t orientation) {
  return orientation == kLandscape ? QPageLayout::Landscape : QPageLayout::Portrait;
}

// Lengths of dashes and gaps, twips: those of the screen.
struct Dashes {
  double on, off;
};
Dashes Pattern(DrawStyle style) {
  switch (style) {
    case DrawStyle::kSolid: break;
    case DrawStyle::kDash: return {90, 60};
    case DrawStyle::kDot: return {15, 30};
  }
  return {0, 0};
}

}  // namespace

// ---- paper

QtPaper::QtPaper() { Reset(); }

void QtPaper::Reset() {
  left_ = top_ = x_ = y_ = 0;
  pen_ = {};
  fore_ = 0;
  font_ = {};
  face_.reset();
}

void QtPaper::StartDoc(std::string_view title) {
  if (!Exists()) throw RunTimeError(kDeviceNotAvailable);
  Reset();
  faces_.clear();
  title_ = title;
  pages_.assign(1, {});
  open_ = true;
}

void QtPaper::NewPage() {
  if (!open_) throw RunTimeError(kBadCall);
  pages_.emplace_back();
  SetCurrent(left_, top_);
}

void QtPaper::KillDoc() {
  if (!open_) return;
  open_ = false;
  pages_.clear();
}

std::string QtPaper::Close() {
  if (!open_) throw RunTimeError(kBadCall);
  open_ = false;
  return title_;
}

void QtPaper::SetScale(double left, double top) {
  left_ = left;
  top_ = top;
}

void QtPaper::SetCurrent(double x, double y) {
  x_ = x;
  y_ = y;
}

void QtPaper::Add(Shape shape, double x1, double y1, double x2, double y2, Colour colour) {
  if (!open_) throw RunTimeError(kBadCall);
  x1 -= left_, x2 -= left_, y1 -= top_, y2 -= top_;
  if (!std::isfinite(x1) || !std::isfinite(y1) || !std::isfinite(x2) || !std::isfinite(y2)) return;
  pages_.back().push_back({shape, x1, y1, x2, y2, colour, pen_, 0, {}});
}

void QtPaper::Line(double x1, double y1, double x2, double y2, Colour colour) {
  Add(Shape::kLine, x1, y1, x2, y2, colour);
}

void QtPaper::Box(double x1, double y1, double x2, double y2, Colour colour) {
  Add(Shape::kBox, std::min(x1, x2), std::min(y1, y2), std::max(x1, x2), std::max(y1, y2), colour);
}

void QtPaper::FilledBox(double x1, double y1, double x2, double y2, Colour colour) {
  Add(Shape::kFilledBox, std::min(x1, x2), std::min(y1, y2), std::max(x1, x2), std::max(y1, y2),
      colour);
}

void QtPaper::SetFont(const SurfaceFont& font) {
  if (!CanBeFace(font)) throw RunTimeError(kInvalidValue);
  if (font == font_) return;
  font_ = font;
  face_.reset();
}

const QtPaper::Face& QtPaper::face() const {
  if (face_) return faces_[*face_];
  const auto known =
      std::find_if(faces_.begin(), faces_.end(), [this](const Face& f) { return f.key == font_; });
  face_ = size_t(known - faces_.begin());
  if (known != faces_.end()) return *known;

  ChartFont made = MakeChartFont(font_);
  made.font.setPixelSize(std::max(1, int(std::lround(font_.size * kTwipsPerPoint))));
  Face face{font_, made.font, made.standard, 0, 0};
  if (face.standard) {
    face.ascent = StandardAscent(font_) * kTwipsPerUnit;
    face.height = StandardTextHeight(font_) * kTwipsPerUnit;
  } else {
    const QFontMetricsF metrics(face.font);
    face.ascent = metrics.ascent();
    face.height = std::ceil(metrics.height());
  }
  faces_.push_back(std::move(face));
  return faces_.back();
}

double QtPaper::TextWidth(std::string_view text) const {
  const Face& f = face();
  if (f.standard) return StandardTextWidth(text, font_) * kTwipsPerUnit;
  return QFontMetricsF(f.font).horizontalAdvance(ToQt(text));
}

void QtPaper::Print(std::string_view text) {
  const Face& f = face();
  if (!text.empty()) {
    Add(Shape::kText, x_, y_ + f.ascent, x_, y_ + f.ascent, fore_);
    if (!pages_.back().empty()) {
      pages_.back().back().face = *face_;
      pages_.back().back().text = text;
    }
  }
  SetCurrent(left_, y_ + f.height);
}

void QtPaper::PaintPage(QPainter& painter, size_t page) const {
  const Sheet sheet = Page();
  const double width = sheet.reachWidth, height = sheet.reachHeight;
  const auto fill = [&](double x1, double y1, double x2, double y2, QColor colour) {
    const QRectF box = QRectF(QPointF(std::max(x1, 0.0), std::max(y1, 0.0)),
                              QPointF(std::min(x2, width), std::min(y2, height)));
    if (box.width() > 0 && box.height() > 0) painter.fillRect(box, colour);
  };
  const auto line = [&](double x1, double y1, double x2, double y2) {
    double from, to;
    if (!CutLine(x1, y1, x2 - x1, y2 - y1, width, height, from, to)) return;
    painter.drawLine(QPointF(x1 + (x2 - x1) * from, y1 + (y2 - y1) * from),
                     QPointF(x1 + (x2 - x1) * to, y1 + (y2 - y1) * to));
  };
  painter.save();
  painter.setClipRect(QRectF(0, 0, width, height));
  painter.setBrush(Qt::NoBrush);
  for (const Op& op : pages_.at(page)) {
    const QColor colour(QtSurface::Rgb(op.colour));
    const double thick = op.pen.width * kTwipsPerDot, half = thick / 2;
    if (op.shape == Shape::kFilledBox) {
      fill(op.x1 - half, op.y1 - half, op.x2 + half, op.y2 + half, colour);
      continue;
    }
    if (op.shape == Shape::kText) {
      // A text that can't touch the page is not laid out at all.
      const Face& f = faces_[op.face];
      const double longest = 2 * f.key.size * kTwipsPerPoint * double(op.text.size());
      if (op.x1 > width || op.y1 - f.ascent > height || op.y1 < -f.height || op.x1 < -longest)
        continue;
      painter.setPen(colour);
      painter.setFont(f.font);
      painter.drawText(QPointF(op.x1, op.y1), ToQt(op.text));
      continue;
    }
    if (op.shape == Shape::kLine && op.x1 == op.x2 && op.y1 == op.y2) {
      fill(op.x1 - half, op.y1 - half, op.x1 + half, op.y1 + half, colour);
      continue;
    }
    QPen pen(colour);
    pen.setWidthF(thick);
    const Dashes dashes = Pattern(op.pen.style);
    pen.setCapStyle(dashes.on == 0 ? Qt::SquareCap : Qt::FlatCap);
    if (dashes.on != 0) pen.setDashPattern({dashes.on / thick, dashes.off / thick});
    painter.setPen(pen);
    line(op.x1, op.y1, op.x2, op.shape == Shape::kLine ? op.y2 : op.y1);
    if (op.shape == Shape::kLine) continue;
    line(op.x2, op.y1, op.x2, op.y2);
    line(op.x1, op.y2, op.x2, op.y2);
    line(op.x1, op.y1, op.x1, op.y2);
  }
  painter.restore();
}

// ---- printers

std::vector<std::string> QtPrinter::DeviceNames() const {
  std::vector<std::string> names;
  for (const QString& name : QPrinterInfo::availablePrinterNames())
    names.push_back(name.toStdString());
  names.emplace_back(kPdfPrinter);
  return names;
}

std::string QtPrinter::DeviceName() const {
  if (!device_) device_ = QPrinterInfo::defaultPrinterName().toStdString();
  return *device_;
}

void QtPrinter::SetDevice(std::string_view name) {
  if (IsOpen()) throw RunTimeError(kBadCall);
  // The PDF is on every machine; its name needs no look at the queues.
  if (name != kPdfPrinter && QPrinterInfo::printerInfo(ToQt(name)).isNull())
    throw RunTimeError(kDeviceNotAvailable);
  device_ = std::string(name);
  sheet_.reset();
}

void QtPrinter::SetOrientation(std::int16_t orientation) {
  if (IsOpen() || (orientation != kPortrait && orientation != kLandscape))
    throw RunTimeError(kBadCall);
  orientation_ = orientation;
  sheet_.reset();
}

std::vector<std::string> QtPrinter::PaperNames() const {
  std::vector<std::string> names;
  for (const Paper& paper : kPapers) names.emplace_back(paper.name);
  return names;
}

std::string QtPrinter::PaperName() const {
  if (!paper_.empty()) return paper_;
  const std::string device = DeviceName();
  if (!device.empty() && device != kPdfPrinter) {
    const auto id = QPrinterInfo::printerInfo(ToQt(device)).defaultPageSize().id();
    for (const Paper& paper : kPapers)
      if (paper.id == id) return paper.name;
  }
  return kPapers[0].name;
}

void QtPrinter::SetPaper(std::string_view name) {
  if (IsOpen()) throw RunTimeError(kBadCall);
  if (!PaperId(name)) throw RunTimeError(kInvalidValue);
  paper_ = name;
  sheet_.reset();
}

namespace {

// A queue's own printer object, with the page as it is to be.
std::unique_ptr<QPrinter> OpenQueue(const std::string& device, const std::string& paper,
                                    std::int16_t orientation) {
  const QPrinterInfo info = QPrinterInfo::printerInfo(ToQt(device));
  if (info.isNull()) throw RunTimeError(kDeviceNotAvailable);
  auto printer = std::make_unique<QPrinter>(info, QPrinter::HighResolution);
  printer->setFullPage(true);
  if (!paper.empty()) printer->setPageSize(QPageSize(*PaperId(paper)));
  printer->setPageOrientation(QtOrientation(orientation));
  return printer;
}

// Whether CUPS refused the document that Qt has just handed to it, of which Qt says nothing: a
// queue that takes none, a service that is gone. Elsewhere there is nobody to ask.
bool QueueRefused() {
#ifdef Q_OS_UNIX
  constexpr int kFirstError = 0x100;  // of IPP; what is below is a success
  using LastError = int (*)();
  const auto lastError = LastError(QLibrary::resolve("cups", 2, "cupsLastError"));
  return lastError && lastError() >= kFirstError;
#else
  return false;
#endif
}

}  // namespace

Sheet QtPrinter::Page() const {
  if (sheet_) return *sheet_;
  QPageLayout layout(QPageSize(*PaperId(PaperName())), QtOrientation(orientation_), QMarginsF());
  QMarginsF edges(kPdfEdge, kPdfEdge, kPdfEdge, kPdfEdge);
  const std::string device = DeviceName();
  if (!device.empty() && device != kPdfPrinter) {
    layout = OpenQueue(device, paper_, orientation_)->pageLayout();
    layout.setUnits(QPageLayout::Point);
    edges = layout.minimumMargins() * kTwipsPerPoint;
  }
  const QRectF full = layout.fullRect(QPageLayout::Point);
  Sheet sheet;
  sheet.width = std::round(full.width() * kTwipsPerPoint);
  sheet.height = std::round(full.height() * kTwipsPerPoint);
  sheet.left = edges.left();
  sheet.top = edges.top();
  sheet.reachWidth = sheet.width - edges.left() - edges.right();
  sheet.reachHeight = sheet.height - edges.top() - edges.bottom();
  sheet_ = sheet;
  return sheet;
}

void QtPrinter::EndDoc() {
  const std::string title = Close();
  if (DeviceName() == kPdfPrinter) {
    pdf_(Pdf(title));
  } else {
    SendToQueue(title);
  }
}

bool QtPrinter::Paint(QPagedPaintDevice& device) const {
  const Sheet sheet = Page();
  QPainter painter;
  if (!painter.begin(&device)) return false;
  painter.scale(device.logicalDpiX() / kTwipsPerInch, device.logicalDpiY() / kTwipsPerInch);
  painter.translate(sheet.left, sheet.top);
  for (size_t page = 0; page < PageCount(); ++page) {
    if (page > 0 && !device.newPage()) return false;
    PaintPage(painter, page);
  }
  return painter.end();
}

std::string QtPrinter::Pdf(const std::string& title) const {
  // The fonts stand in the file in the order of a hash: the same chart is to be the same file.
  QHashSeed::setDeterministicGlobalSeed();
  const auto randomAgain = qScopeGuard([] { QHashSeed::resetRandomGlobalSeed(); });
  QByteArray bytes;
  QBuffer out(&bytes);
  out.open(QIODevice::WriteOnly);
  QPdfWriter pdf(&out);
  pdf.setResolution(kPdfResolution);
  pdf.setCreator("KORA Charting");
  pdf.setTitle(ToQt(title));
  pdf.setPageLayout(
      QPageLayout(QPageSize(*PaperId(PaperName())), QtOrientation(orientation_), QMarginsF()));
  if (!Paint(pdf)) throw RunTimeError(kDeviceError);
  return bytes.toStdString();
}

void QtPrinter::SendToQueue(const std::string& title) const {
  const std::string device = DeviceName();
  // What is sent to a queue that has stopped would lie there unseen.
  if (QPrinterInfo::printerInfo(ToQt(device)).state() == QPrinter::Error)
    throw RunTimeError(kDeviceNotAvailable);
  const auto printer = OpenQueue(device, paper_, orientation_);
  printer->setDocName(ToQt(title));
  printer->setCreator("KORA Charting");
  if (!Paint(*printer) || printer->printerState() == QPrinter::Error || QueueRefused())
    throw RunTimeError(kDeviceNotAvailable);
}

}  // namespace kora
