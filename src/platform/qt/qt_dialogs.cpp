#include "platform/qt/qt_dialogs.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QGridLayout>
#include <QInputDialog>
#include <QMessageBox>
#include <QProgressDialog>
#include <QScreen>
#include <QSpacerItem>
#include <QStyle>
#include <algorithm>
#include <utility>

#include "platform/qt/modal.h"
#include "platform/qt/to_qt.h"

namespace kora {
namespace {

// What a dialog stands over, and gives the keyboard back to: the form that holds the others back,
// which has just opened and may not be active yet.
QWidget* Below() {
  QWidget* form = QApplication::activeModalWidget();
  if (!form) form = QApplication::activeWindow();
  // A menu goes before what is said over it.
  while (form && form->windowType() == Qt::Popup)
    form = form->parentWidget() ? form->parentWidget()->window() : nullptr;
  return form;
}

// A box that is answered, not kept: nothing to minimise or maximise.
constexpr Qt::WindowFlags kBoxFlags = Qt::Dialog | Qt::CustomizeWindowHint | Qt::WindowTitleHint |
                                      Qt::WindowSystemMenuHint | Qt::WindowCloseButtonHint;

// Widens a box that its title would not fit; the frame sets titles in bold, between an icon and up to
// three buttons.
void FitTitle(QMessageBox& box) {
  auto* grid = qobject_cast<QGridLayout*>(box.layout());
  if (!grid) return;
  QFont bold = box.font();
  bold.setBold(true);
  const int buttons = 5 * box.style()->pixelMetric(QStyle::PM_TitleBarHeight);
  const int width = QFontMetrics(bold).horizontalAdvance(box.windowTitle()) + buttons;
  grid->addItem(new QSpacerItem(width, 0), grid->rowCount(), 0, 1, grid->columnCount());
}

// A box of the start stands below the splash window, not over it.
void KeepOffSplash(QDialog& box) {
  for (const QWidget* window : QApplication::topLevelWidgets()) {
    if (window->windowType() != Qt::SplashScreen || !window->isVisible()) continue;
    box.adjustSize();
    const QRect room = window->screen()->availableGeometry();
    const QRect splash = window->geometry();
    const int gap = box.style()->pixelMetric(QStyle::PM_TitleBarHeight);
    const int top = std::min(splash.bottom() + gap, room.bottom() - box.height() - gap);
    box.move(splash.center().x() - box.width() / 2, top);
  }
}

// While a question stands the pointer is the normal one, whatever goes on behind it.
class NormalPointer {
 public:
  explicit NormalPointer(bool busy) : busy_(busy) {
    if (busy_) QApplication::setOverrideCursor(Qt::ArrowCursor);
  }
  ~NormalPointer() {
    if (busy_) QApplication::restoreOverrideCursor();
  }

 private:
  bool busy_;
};

int heldBack = 0;

// From a box's answer until whoever asked goes on. Keys and clicks that were made ahead would reach
// the form below, whose routine still waits, and could take it down: they are passed over.
class Hold : public QObject {
 public:
  explicit Hold(QDialog& box) {
    connect(&box, &QDialog::finished, this, [this] {
      if (std::exchange(on_, true)) return;
      ++heldBack;
      qApp->installEventFilter(this);
    });
  }
  ~Hold() override {
    if (on_) --heldBack;
  }

 protected:
  bool eventFilter(QObject*, QEvent* event) override {
    switch (event->type()) {
      case QEvent::KeyPress:
      case QEvent::ShortcutOverride:
      case QEvent::Shortcut:
      case QEvent::MouseButtonPress:
      case QEvent::MouseButtonDblClick:
      case QEvent::Wheel:
      case QEvent::ContextMenu: return true;
      default: return false;
    }
  }

 private:
  bool on_ = false;
};

class ProgressWindow : public Progress {
 public:
  explicit ProgressWindow(std::string_view title) {
    window_->setObjectName("Progress");
    window_->setWindowTitle(ToQt(title));
    window_->setLabelText(ToQt(title));
    window_->setRange(0, 1000);
    window_->setWindowModality(Qt::ApplicationModal);
    window_->setMinimumDuration(500);
    window_->setAutoClose(false);
    window_->setAutoReset(false);
    window_->setValue(0);
    sincePaint_.start();
  }

  void Show(ProgressLine line, std::string_view text) override {
    if (line == ProgressLine::kItem) item_ = text;
  }

  bool Step(int done, int total) override {
    // The event queue costs more than most steps: it has its turn some thirty times a second.
    if (window_.Gone()) return false;
    if (done < total && sincePaint_.elapsed() < 30) return !window_->wasCanceled();
    sincePaint_.restart();
    if (!item_.empty()) window_->setLabelText(ToQt(item_));
    window_->setValue(total > 0 ? int(1000.0 * done / total) : 1000);
    QCoreApplication::processEvents();
    return !window_.Gone() && !window_->wasCanceled();
  }

 private:
  Modal<QProgressDialog> window_{Below()};
  QElapsedTimer sincePaint_;
  std::string item_;
};

}  // namespace

bool InputIsHeldBack() { return heldBack > 0; }

QtDialogs::~QtDialogs() { SetBusy(false); }

void QtDialogs::Message(std::string_view text, std::string_view title) {
  Ask(text, title, Buttons::kOk);
}

Answer QtDialogs::Ask(std::string_view text, std::string_view title, Buttons buttons) {
  const NormalPointer pointer(busy_);
  Modal<QMessageBox> box(Below());
  box->setObjectName("MessageBox");
  box->setWindowFlags(kBoxFlags);
  box->setWindowTitle(ToQt(title));
  box->setTextFormat(Qt::PlainText);
  box->setText(ToQt(text));
  using B = QMessageBox;
  switch (buttons) {
    case Buttons::kOk: box->setStandardButtons(B::Ok); break;
    case Buttons::kOkCancel: box->setStandardButtons(B::Ok | B::Cancel); break;
    case Buttons::kYesNo: box->setStandardButtons(B::Yes | B::No); break;
    case Buttons::kNoYes:
      box->setStandardButtons(B::Yes | B::No);
      box->setDefaultButton(B::No);
      break;
    case Buttons::kYesNoCancel: box->setStandardButtons(B::Yes | B::No | B::Cancel); break;
    case Buttons::kRetryCancel: box->setStandardButtons(B::Retry | B::Cancel); break;
  }
  box->setIcon(buttons == Buttons::kOk ? B::Information : B::Question);
  const bool declines = buttons == Buttons::kYesNo || buttons == Buttons::kNoYes;
  if (declines) box->setEscapeButton(B::No);
  FitTitle(*box);
  KeepOffSplash(*box);
  const Hold hold(*box);
  // A box that went with its form was closed without a button.
  switch (box.Run().value_or(B::NoButton)) {
    case B::Ok: return Answer::kOk;
    case B::Yes: return Answer::kYes;
    case B::No: return Answer::kNo;
    case B::Retry: return Answer::kRetry;
    default: return declines ? Answer::kNo : Answer::kCancel;
  }
}

std::optional<std::string> QtDialogs::Prompt(std::string_view text, std::string_view title,
                                             std::string_view standing) {
  const NormalPointer pointer(busy_);
  Modal<QInputDialog> box(Below());
  box->setObjectName("Prompt");
  box->setWindowFlags(kBoxFlags);
  box->setWindowTitle(ToQt(title));
  box->setLabelText(ToQt(text));
  box->setTextValue(ToQt(standing));
  KeepOffSplash(*box);
  const Hold hold(*box);
  if (box.Run() != QDialog::Accepted) return std::nullopt;
  const std::string answer = box->textValue().toStdString();
  if (answer.empty()) return std::nullopt;
  return answer;
}

std::unique_ptr<Progress> QtDialogs::StartProgress(std::string_view title) {
  return std::make_unique<ProgressWindow>(title);
}

void QtDialogs::SetBusy(bool busy) {
  if (busy == busy_) return;
  busy_ = busy;
  if (busy)
    QApplication::setOverrideCursor(Qt::WaitCursor);
  else
    QApplication::restoreOverrideCursor();
}

void QtDialogs::Yield() { QCoreApplication::processEvents(); }

}  // namespace kora
