#pragma once

#include <QDialog>

#include "chart/forms/print_services.h"
#include "chart/forms/sheet_view.h"
#include "platform/qt/qt_printer.h"

class QLabel;

namespace kora {

// Page set-up of charts: the sheet in small with the chart on it, to be dragged to its place.
class Page : public QDialog {
 public:
  // `script`: of the chart on show; one that can't be played shows as an empty box.
  Page(const PrintServices& services, ChartSize chart, std::string script, QWidget* parent);

  // Says so where there is no printer. To be called once the form shows.
  void CheckPrinter();
  const PrintSetup& setup() const { return setup_; }

  void reject() override;

 private:
  ChartFrame Frame() const { return FrameOnPage(services_.printer, setup_, chart_); }
  bool IsOnPage() const { return kora::IsOnPage(services_.printer, Frame()); }
  void SayEdges();
  void Step(bool larger);
  void Dropped(QPointF corner);
  void Centre();
  void Turned();
  void Save();
  void Show();
  void PaintChart(QPainter& painter) const;

  PrintServices services_;
  ChartSize chart_;
  std::string script_;
  PrintSetup setup_;
  std::int16_t orientationBefore_;
  SheetView* sheet_;
  QLabel* label1_;
};

}  // namespace kora
