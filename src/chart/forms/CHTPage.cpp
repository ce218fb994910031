#include "chart/forms/CHTPage.h"

#include <QDoubleSpinBox>
#include <QGridLayout>
#include <QLabel>
#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "chart/forms/orientation_choice.h"
#include "lists/text_print_out.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr double kTwipsPerMm = kTwipsPerInch / 25.4;
constexpr double kLeastText = kTwipsPerInch;  // what the margins leave free at least

}  // namespace

CHTPage::CHTPage(const PrintServices& services, QWidget* parent)
    : QDialog(parent),
      services_(services),
      orientationBefore_(services.printer.Orientation()),
      sheet_(new SheetView(this)) {
  setObjectName("CHTPage");
  const PageSettings& page = services_.settings.page;
  if (page.Orient == kPortrait || page.Orient == kLandscape)
    services_.printer.SetOrientation(page.Orient);
  sheet_->setObjectName("Sheet");
  sheet_->setAccessibleName("The sheet with its margins");

  auto* grid = new QGridLayout;
  top_ = AddMargin(grid, 0, "PPTop", "To&p margin", page.PPTop);
  bottom_ = AddMargin(grid, 1, "PPBot", "&Bottom margin", double(page.PPBot));
  left_ = AddMargin(grid, 2, "PPLft", "Le&ft margin", page.PPLft);
  right_ = AddMargin(grid, 3, "PPRht", "&Right margin", double(page.PPRht));
  auto* side = new QVBoxLayout;
  side->addWidget(
      new OrientationChoice(this, services_.printer, services_.dialogs, [this] { Show(); }));
  side->addLayout(grid);
  side->addStretch();
  LayOutPageForm(this, sheet_, side, [this] { Save(); });
  for (QDoubleSpinBox* margin : {top_, bottom_, left_, right_})
    connect(margin, &QDoubleSpinBox::valueChanged, this, [this] { Show(); });
  Show();
}

QDoubleSpinBox* CHTPage::AddMargin(QGridLayout* grid, int row, const char* name,
                                   const char* caption, double twips) {
  auto* box = new QDoubleSpinBox(this);
  box->setObjectName(name);
  box->setDecimals(1);
  box->setSuffix(" mm");
  box->setMaximum(1000);
  box->setValue(twips / kTwipsPerMm);
  grid->addWidget(NewLabel(this, caption, box), row, 0);
  grid->addWidget(box, row, 1);
  return box;
}

void CHTPage::CheckPrinter() {
  if (!services_.printer.Exists()) services_.dialogs.Message(kNoPrinter, kPrinterPage);
}

void CHTPage::Show() {
  const Sheet sheet = services_.printer.Page();
  setWindowTitle(sheet.width > sheet.height ? "Printer Page (Landscape)"
                                            : "Printer Page (Portrait)");
  // Two margins that face each other leave room for some text.
  const auto limit = [](QDoubleSpinBox* margin, QDoubleSpinBox* other, double room) {
    const QSignalBlocker quiet(margin);
    margin->setMaximum(std::max(0.0, (room - kLeastText) / kTwipsPerMm - other->value()));
  };
  limit(top_, bottom_, sheet.reachHeight);
  limit(bottom_, top_, sheet.reachHeight);
  limit(left_, right_, sheet.reachWidth);
  limit(right_, left_, sheet.reachWidth);
  sheet_->SetSheet(sheet);
  sheet_->SetBox(QRectF(QPointF(left_->value(), top_->value()) * kTwipsPerMm,
                        QPointF(sheet.reachWidth, sheet.reachHeight) -
                            QPointF(right_->value(), bottom_->value()) * kTwipsPerMm));
}

void CHTPage::Save() {
  try {
    PageSettings page = services_.settings.page;
    page.PPTop = CLng(top_->value() * kTwipsPerMm);
    page.PPLft = CLng(left_->value() * kTwipsPerMm);
    page.PPBot = float(CLng(bottom_->value() * kTwipsPerMm));
    page.PPRht = float(CLng(right_->value() * kTwipsPerMm));
    page.Orient = services_.printer.Orientation();
    services_.settings.page = page;
    SaveTextPage(services_.ini, page);
  } catch (const RunTimeError& e) {
    services_.dialogs.Message(std::string("There is an unexpected error - ") + e.what(), "Error");
    return;
  }
  accept();
}

void CHTPage::reject() {
  services_.printer.SetOrientation(orientationBefore_);
  QDialog::reject();
}

}  // namespace kora
