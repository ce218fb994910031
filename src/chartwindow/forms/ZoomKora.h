#pragma once

#include <QDialog>

#include "chartwindow/tools/zoom_chart.h"
#include "platform/dialogs.h"
#include "platform/qt/picture_box.h"

namespace kora {

// "Zoom": a part of a chart over the whole form. What it is drawn from is not owned.
struct ZoomKoraServices {
  Dialogs& dialogs;
  const Composition& chart;
  const ChartRequest& request;
  const ChartColours& colours;
  const FontSettings& fonts;
};

class ZoomKora : public QDialog {
 public:
  // Stands exactly over `over`, where there is one.
  ZoomKora(const ZoomKoraServices& services, const ZoomBox& box, QWidget* over,
           QWidget* parent = nullptr);

 private:
  void Draw();

  ZoomKoraServices s_;
  ZoomBox box_;
  PictureBox* picture1_;
};

}  // namespace kora
