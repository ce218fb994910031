#include "platform/qt/focus_mark.h"

#include <QAbstractSpinBox>
#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QFocusEvent>
#include <QLineEdit>
#include <QPainter>
#include <QPushButton>
#include <QRadioButton>
#include <QTabBar>

namespace kora {
namespace {

class Frame : public QWidget {
 public:
  explicit Frame(QWidget* marked) : QWidget(marked) {
    setObjectName("FocusMark");
    setAttribute(Qt::WA_TransparentForMouseEvents);
    setGeometry(marked->rect());
    raise();
    show();
  }

 protected:
  void paintEvent(QPaintEvent*) override {
    constexpr int kWidth = 2;
    QPainter painter(this);
    painter.setPen(QPen(palette().color(QPalette::Highlight), kWidth));
    painter.drawRect(QRectF(rect()).adjusted(1, 1, -1, -1));
  }
};

bool ShowsItself(const QObject* control) {
  return qobject_cast<const QLineEdit*>(control) || qobject_cast<const QPushButton*>(control) ||
         qobject_cast<const QCheckBox*>(control) || qobject_cast<const QRadioButton*>(control) ||
         qobject_cast<const QComboBox*>(control) || qobject_cast<const QTabBar*>(control) ||
         qobject_cast<const QAbstractSpinBox*>(control);
}

bool ByKeys(Qt::FocusReason reason) {
  return reason == Qt::TabFocusReason || reason == Qt::BacktabFocusReason ||
         reason == Qt::ShortcutFocusReason;
}

}  // namespace

FocusMark::FocusMark() { qApp->installEventFilter(this); }

FocusMark::~FocusMark() { delete frame_; }

bool FocusMark::eventFilter(QObject* object, QEvent* event) {
  QWidget* marked = frame_ ? frame_->parentWidget() : nullptr;
  if (event->type() == QEvent::Resize && object == marked) {
    frame_->setGeometry(marked->rect());
    frame_->raise();
  } else if (event->type() == QEvent::FocusOut && object == marked) {
    const auto reason = static_cast<QFocusEvent*>(event)->reason();
    if (reason != Qt::PopupFocusReason && reason != Qt::MenuBarFocusReason &&
        reason != Qt::ActiveWindowFocusReason)
      delete frame_;
  } else if (event->type() == QEvent::FocusIn && object != marked) {
    auto* control = qobject_cast<QWidget*>(object);
    if (!control || !ByKeys(static_cast<QFocusEvent*>(event)->reason()) || ShowsItself(control))
      return false;
    delete frame_;
    frame_ = new Frame(control);
  }
  return false;
}

}  // namespace kora
