#include "lists/forms/RecSav.h"

#include <QFrame>
#include <QLabel>
#include <QTimer>
#include <QVBoxLayout>

namespace kora {
namespace {

constexpr int kSavedMs = 900;

}  // namespace

RecSav::RecSav(QWidget* parent) : QDialog(parent, Qt::ToolTip) {
  setObjectName("RecSav");
  auto* frame = new QFrame(this);
  frame->setFrameStyle(QFrame::Box | QFrame::Raised);
  auto* around = new QVBoxLayout(this);
  around->setContentsMargins(0, 0, 0, 0);
  around->addWidget(frame);
  auto* box = new QVBoxLayout(frame);
  const int margin = fontMetrics().height() * 2;
  box->setContentsMargins(margin, margin / 2, margin, margin / 2);
  box->addWidget(new QLabel("Saved", frame), 0, Qt::AlignCenter);
  setAttribute(Qt::WA_DeleteOnClose);
  QTimer::singleShot(kSavedMs, this, [this] { close(); });
}

}  // namespace kora
