#include "platform/qt/qt_dialogs.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QInputDialog>
#include <QMessageBox>
#include <QProgressDialog>

namespace kora {
namespace {

QString ToQt(std::string_view text) {
  return QString::fromUtf8(text.data(), qsizetype(text.size()));
}

// What a dialog stands over, and gives the keyboard back to: the form that holds the others back,
// which has just opened and may not be active yet.
QWidget* Below() {
  QWidget* modal = QApplication::activeModalWidget();
  return modal ? modal : QApplication::activeWindow();
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

class ProgressWindow : public Progress {
 public:
  explicit ProgressWindow(std::string_view title) {
    window_.setObjectName("Progress");
    window_.setWindowTitle(ToQt(title));
    window_.setLabelText(ToQt(title));
    window_.setRange(0, 1000);
    window_.setWindowModality(Qt::ApplicationModal);
    window_.setMinimumDuration(500);
    window_.setAutoClose(false);
    window_.setAutoReset(false);
    window_.setValue(0);
    sincePaint_.start();
  }

  bool Step(int done, int total) override {
    // The event queue costs more than most steps: it has its turn some thirty times a second.
    if (done < total && sincePaint_.elapsed() < 30) return !window_.wasCanceled();
    sincePaint_.restart();
    window_.setValue(total > 0 ? int(1000.0 * done / total) : 1000);
    QCoreApplication::processEvents();
    return !window_.wasCanceled();
  }

 private:
  QProgressDialog window_{Below()};
  QElapsedTimer sincePaint_;
};

}  // namespace

QtDialogs::~QtDialogs() { SetBusy(false); }

void QtDialogs::Message(std::string_view text, std::string_view title) {
  Ask(text, title, Buttons::kOk);
}

Answer QtDialogs::Ask(std::string_view text, std::string_view title, Buttons buttons) {
  const NormalPointer pointer(busy_);
  QMessageBox box(Below());
  box.setObjectName("MessageBox");
  box.setWindowTitle(ToQt(title));
  box.setTextFormat(Qt::PlainText);
  box.setText(ToQt(text));
  using B = QMessageBox;
  switch (buttons) {
    case Buttons::kOk: box.setStandardButtons(B::Ok); break;
    case Buttons::kOkCancel: box.setStandardButtons(B::Ok | B::Cancel); break;
    case Buttons::kYesNo: box.setStandardButtons(B::Yes | B::No); break;
    case Buttons::kYesNoCancel: box.setStandardButtons(B::Yes | B::No | B::Cancel); break;
    case Buttons::kRetryCancel: box.setStandardButtons(B::Retry | B::Cancel); break;
  }
  box.setIcon(buttons == Buttons::kOk ? B::Information : B::Question);
  if (buttons == Buttons::kYesNo) box.setEscapeButton(B::No);
  switch (box.exec()) {
    case B::Ok: return Answer::kOk;
    case B::Yes: return Answer::kYes;
    case B::No: return Answer::kNo;
    case B::Retry: return Answer::kRetry;
    default: return buttons == Buttons::kYesNo ? Answer::kNo : Answer::kCancel;
  }
}

std::optional<std::string> QtDialogs::Prompt(std::string_view text, std::string_view title,
                                             std::string_view standing) {
  const NormalPointer pointer(busy_);
  QInputDialog box(Below());
  box.setObjectName("Prompt");
  box.setWindowTitle(ToQt(title));
  box.setLabelText(ToQt(text));
  box.setTextValue(ToQt(standing));
  if (box.exec() != QDialog::Accepted) return std::nullopt;
  const std::string answer = box.textValue().toStdString();
  if (answer.empty()) return std::nullopt;
  return answer;
}

std::unique_ptr<Progress> QtDialogs::StartProgress(std::string_view title) {
  return std::make_unique<ProgressWindow>(title);
}

void QtDialogs::SetBusy(bool busy) {
  if (busy == busy_) return;
  busy_ = busy;
  if (busy) QApplication::setOverrideCursor(Qt::WaitCursor);
  else QApplication::restoreOverrideCursor();
}

void QtDialogs::Yield() { QCoreApplication::processEvents(); }

}  // namespace kora
