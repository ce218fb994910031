#pragma once

#include <QDialog>

#include "chart/forms/print_services.h"
#include "chart/forms/sheet_view.h"

class QDoubleSpinBox;
class QGridLayout;

namespace kora {

// Page set-up of text print-outs: their margins, shown on the sheet.
class CHTPage : public QDialog {
 public:
  CHTPage(const PrintServices& services, QWidget* parent);

  // Says so where there is no printer. To be called once the form shows.
  void CheckPrinter();
  void reject() override;

 private:
  QDoubleSpinBox* AddMargin(QGridLayout* grid, int row, const char* name, const char* caption,
                            double twips);
  void Show();
  void Save();

  PrintServices services_;
  std::int16_t orientationBefore_;
  SheetView* sheet_;
  QDoubleSpinBox *top_, *bottom_, *left_, *right_;  // millimetres
};

}  // namespace kora
