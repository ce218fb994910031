#include "chart/forms/Page.h"

#include <QHBoxLayout>
#include <QLabel>
#include <QPainter>
#include <QPushButton>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chart/forms/orientation_choice.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

QPushButton* NewButton(QDialog* form, const char* name, const char* caption) {
  auto* button = new QPushButton(caption, form);
  button->setObjectName(name);
  button->setAutoDefault(false);
  return button;
}

// An origin of 0 would mean a chart that is centred; one at the very edge is a twip off it.
std::int32_t Origin(double margin) {
  const std::int32_t twips = CLng(margin);
  return twips == 0 ? -1 : -twips;
}

}  // namespace

Page::Page(const PrintServices& services, ChartSize chart, std::string script, QWidget* parent)
    : QDialog(parent),
      services_(services),
      chart_(chart),
      script_(std::move(script)),
      setup_(PrintSetupFrom(services.settings, services.printerColours)),
      orientationBefore_(services.printer.Orientation()) {
  setObjectName("Page");
  if (setup_.PrintOrient == kPortrait || setup_.PrintOrient == kLandscape)
    services_.printer.SetOrientation(setup_.PrintOrient);
  SetPageDefaults(services_.printer, chart_, setup_);

  sheet_ = new SheetView(this);
  sheet_->setObjectName("Sheet");
  sheet_->setAccessibleName("The chart on its sheet");
  sheet_->setToolTip("Drag the chart to its place, or move it with the arrow keys");
  sheet_->SetDropped([this](QPointF corner) { Dropped(corner); });
  label1_ = new QLabel(this);
  label1_->setObjectName("Label1");

  auto* increase = NewButton(this, "cmInc", "&Enlarge");
  auto* decrease = NewButton(this, "cmDec", "&Reduce");
  auto* centre = NewButton(this, "Command3", "Ce&ntre");
  connect(increase, &QPushButton::clicked, this, [this] { Step(true); });
  connect(decrease, &QPushButton::clicked, this, [this] { Step(false); });
  connect(centre, &QPushButton::clicked, this, [this] { Centre(); });

  auto* side = new QVBoxLayout;
  side->addWidget(
      new OrientationChoice(this, services_.printer, services_.dialogs, [this] { Turned(); }));
  side->addWidget(label1_);
  side->addWidget(increase);
  side->addWidget(decrease);
  side->addWidget(centre);
  side->addStretch();
  LayOutPageForm(this, sheet_, side, [this] { Save(); });
  Show();
}

void Page::CheckPrinter() {
  if (!services_.printer.Exists()) services_.dialogs.Message(kNoPrinter, kPrinterPage);
}

void Page::Show() {
  const Sheet sheet = services_.printer.Page();
  setWindowTitle(sheet.width > sheet.height ? "Printer Page (Landscape)"
                                            : "Printer Page (Portrait)");
  const ChartFrame frame = Frame();
  sheet_->SetSheet(sheet);
  sheet_->SetBox(
      QRectF(-double(frame.PrintLeft), -double(frame.PrintTop), frame.width, frame.height));
  sheet_->SetContent([this](QPainter& painter) { PaintChart(painter); });
  label1_->setText("Size " + ToQt(Format(double(setup_.PrintEnlarge), "0.0")));
}

void Page::PaintChart(QPainter& painter) const {
  try {
    QtPreview paper(services_.printer);
    ChartFrame frame = Frame();
    frame.PrintLeft = frame.PrintTop = 0;
    paper.StartDoc({});
    std::string refused;
    PlayOnPaper(script_, paper, frame, setup_, services_.settings.fonts, services_.colours,
                refused);
    paper.EndDoc();
    paper.PaintPage(painter, 0);
  } catch (const RunTimeError&) {
    // Printing it will tell.
  }
}

void Page::SayEdges() {
  services_.dialogs.Message("All edges of chart MUST be on page", "Page Setup");
}

void Page::Step(bool larger) {
  const PrintSetup before = setup_;
  const bool wasOnPage = IsOnPage();
  if (larger)
    Enlarge(setup_);
  else
    Reduce(services_.printer, chart_, setup_);
  const bool leaves = larger && wasOnPage && !IsOnPage();
  if (leaves) setup_ = before;
  Show();
  if (leaves) SayEdges();
}

void Page::Dropped(QPointF corner) {
  const PrintSetup before = setup_;
  setup_.PrintLeft = Origin(corner.x());
  setup_.PrintTop = Origin(corner.y());
  const bool leaves = !IsOnPage();
  if (leaves) setup_ = before;
  Show();
  if (leaves) SayEdges();
}

void Page::Centre() {
  setup_.PrintLeft = setup_.PrintTop = 0;
  Show();
}

// Turned to landscape the chart takes the sheet. One that the turned page has no room for at its place
// goes to the middle, as large as fits.
void Page::Turned() {
  setup_.PrintOrient = services_.printer.Orientation();
  if (setup_.PrintOrient == kLandscape) {
    EnlargeToPage(services_.printer, chart_, setup_);
  } else if (!IsOnPage()) {
    setup_.PrintLeft = setup_.PrintTop = 0;
    setup_.PrintWidth = setup_.PrintHeight = 0;
    SetPageDefaults(services_.printer, chart_, setup_);
  }
  Show();
}

void Page::Save() {
  if (!IsOnPage()) return SayEdges();
  const ChartFrame frame = Frame();
  setup_.PrintWidth = frame.width;
  setup_.PrintHeight = frame.height;
  setup_.PrintOrient = services_.printer.Orientation();
  SavePrintSetup(services_.ini, services_.settings, setup_);
  accept();
}

void Page::reject() {
  services_.printer.SetOrientation(orientationBefore_);
  QDialog::reject();
}

}  // namespace kora
