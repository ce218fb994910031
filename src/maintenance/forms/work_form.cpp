#include "maintenance/forms/work_form.h"

#include <QBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPointer>
#include <QToolButton>
#include <utility>

#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr int kRefreshMs = 40;

}  // namespace

// The form may be gone, with its services, once the events of a step were handled.
class WorkForm::Shown : public Progress {
 public:
  Shown(WorkForm* form, Progress& panel) : form_(form), panel_(panel) {}

  void Show(ProgressLine line, std::string_view text) override {
    if (!form_) return;
    if (line == ProgressLine::kState) {
      state_ = text;
      // What is told between two steps is seen at the next, but for the last.
      if (!stepped_.isValid() || done_) ShowState();
    } else {
      form_->Told(line, std::string(text));
    }
  }
  bool Step(int done, int total) override {
    if (!form_) return false;
    done_ = done >= total;
    if (done_ || !stepped_.isValid() || stepped_.elapsed() >= kRefreshMs) {
      ShowState();
      form_->Stepped(done, total);
      stepped_.start();
    }
    return panel_.Step(done, total) && form_;
  }
  void ShowState() {
    if (form_ && form_->state_) form_->state_->setText(ToQt(state_));
  }

 private:
  QPointer<WorkForm> form_;
  Progress& panel_;
  std::string state_;
  QElapsedTimer stepped_;
  bool done_ = false;
};

WorkForm::WorkForm(MaintenanceServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {}

QLabel* WorkForm::AddState(QBoxLayout* rows, const char* name) {
  state_ = new QLabel(this);
  state_->setObjectName(name);
  state_->setTextFormat(Qt::PlainText);
  state_->setTextInteractionFlags(Qt::TextSelectableByMouse);
  rows->addWidget(state_);
  return state_;
}

void WorkForm::AddPanel(QBoxLayout* rows) {
  panel_ = new WorkPanel(this);
  rows->addWidget(panel_);
}

void WorkForm::Run(const std::function<void(Progress&)>& work) {
  struct Busy {
    Dialogs& dialogs;
    explicit Busy(Dialogs& d) : dialogs(d) { dialogs.SetBusy(true); }
    ~Busy() { dialogs.SetBusy(false); }
  } const busy(services_.dialogs);
  const auto run = [&](Progress& inner) {
    Shown shown(this, inner);
    work(shown);
    shown.ShowState();
  };
  if (panel_) {
    panel_->Run({}, run);
  } else {
    NoProgress none;
    run(none);
  }
}

WorkForm::~WorkForm() { ForgetBoxes(this); }

void WorkForm::reject() {
  if (panel_ && panel_->StopFirst()) return;
  QDialog::reject();
}

void WorkForm::done(int result) {
  QDialog::done(result);
  if (std::exchange(changed_, false) && services_.changed) services_.changed();
}

QLineEdit* NewShown(QWidget* form, const char* name, int columns) {
  QLineEdit* box = NewField(form, name, columns, 80);
  box->setReadOnly(true);
  box->setFocusPolicy(Qt::ClickFocus);
  return box;
}

QWidget* NewStepper(QWidget* form, const QString& name, std::function<void(int by)> step) {
  auto* both = new QWidget(form);
  auto* arrows = new QVBoxLayout(both);
  arrows->setSpacing(0);
  arrows->setContentsMargins(0, 0, 0, 0);
  for (const bool up : {true, false}) {
    auto* arrow = new QToolButton(both);
    arrow->setObjectName(name + (up ? "(1)" : "(0)"));
    arrow->setArrowType(up ? Qt::UpArrow : Qt::DownArrow);
    arrow->setAccessibleName(up ? "Next security" : "Previous security");
    arrow->setToolTip(arrow->accessibleName());
    arrow->setFocusPolicy(Qt::StrongFocus);
    arrow->setAutoRepeat(true);
    QObject::connect(arrow, &QToolButton::clicked, form, [step, up] { step(up ? 1 : -1); });
    arrows->addWidget(arrow);
  }
  return both;
}

}  // namespace kora
