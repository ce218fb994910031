#include "chartwindow/forms/ZoomKora.h"

#include <QVBoxLayout>
#include <new>

#include "base/runtime_error.h"

namespace kora {

ZoomKora::ZoomKora(const ZoomKoraServices& services, const ZoomBox& box, QWidget* over,
                   QWidget* parent)
    : QDialog(parent), s_(services), box_(box), picture1_(new PictureBox(this)) {
  setObjectName("ZoomKora");
  setWindowTitle("Zoom");
  picture1_->setObjectName("Picture1");
  picture1_->setAccessibleName("Enlarged part of the chart");
  auto* layout = new QVBoxLayout(this);
  layout->setContentsMargins(0, 0, 0, 0);
  layout->addWidget(picture1_);
  picture1_->Resized = [this] { Draw(); };
  if (over) setGeometry(QRect(over->mapToGlobal(QPoint(0, 0)), over->size()));
}

void ZoomKora::Draw() {
  try {
    ZoomChart(picture1_->surface(), s_.chart, s_.request, s_.colours, s_.fonts, box_);
  } catch (const std::bad_alloc&) {
    s_.dialogs.Message(
        "There appears to be a memory problem\nOut of memory\nExit Windows then retry", "Zoom");
  } catch (const RunTimeError& e) {
    s_.dialogs.Message(e.what(), "Zoom");
  }
  picture1_->update();
}

}  // namespace kora
