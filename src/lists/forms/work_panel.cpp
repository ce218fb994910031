#include "lists/forms/work_panel.h"

#include <QApplication>
#include <QHBoxLayout>
#include <QLabel>
#include <QProgressBar>
#include <QPushButton>

#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr int kRefreshMs = 40;

}  // namespace

// The work's view of the panel, which may be gone by the next step.
class WorkPanel::Steps : public Progress {
 public:
  Steps(WorkPanel& panel, const QString& text) : panel_(&panel), text_(text) {}

  void Show(ProgressLine line, std::string_view text) override {
    if (line == ProgressLine::kState) text_ = ToQt(text);
    if (line == ProgressLine::kItem) item_ = text;
  }
  bool Step(int done, int total) override {
    if (!panel_) return false;
    // The event queue costs more than most steps: it has its turn some times a second.
    if (!panel_->shown_.isValid() || panel_->shown_.elapsed() >= kRefreshMs) {
      panel_->bar_->setRange(0, total > 0 ? total : 1);
      panel_->bar_->setValue(done);
      panel_->Show(item_.empty() ? text_ : text_ + "   " + ToQt(item_));
      QApplication::processEvents();
      if (!panel_) return false;
      panel_->shown_.start();
    }
    return !panel_->stopAsked_;
  }

 private:
  QPointer<WorkPanel> panel_;
  QString text_;
  std::string item_;
};

WorkPanel::WorkPanel(QWidget* parent) : QWidget(parent) {
  setObjectName("WorkPanel");
  text_ = new QLabel(this);
  text_->setObjectName("WorkText");
  text_->setTextFormat(Qt::PlainText);
  bar_ = new QProgressBar(this);
  bar_->setObjectName("ProgressBar1");
  bar_->setAccessibleName("Progress");
  stop_ = new QPushButton("S&top", this);
  stop_->setObjectName("StopWork");
  stop_->setAutoDefault(false);
  auto* row = new QHBoxLayout(this);
  row->setContentsMargins(0, 0, 0, 0);
  row->addWidget(text_, 1);
  row->addWidget(bar_);
  row->addWidget(stop_);
  // Nothing moves as work begins and ends.
  for (QWidget* widget : std::initializer_list<QWidget*>{bar_, stop_}) {
    QSizePolicy place = widget->sizePolicy();
    place.setRetainSizeWhenHidden(true);
    widget->setSizePolicy(place);
    widget->hide();
  }
  connect(stop_, &QPushButton::clicked, this, [this] { Stop(); });
}

void WorkPanel::Hold(std::initializer_list<QWidget*> widgets) {
  for (QWidget* widget : widgets) held_.emplace_back(widget);
}

void WorkPanel::Show(const QString& text) { text_->setText(text); }

void WorkPanel::SetRunning(bool running) {
  running_ = running;
  bar_->setValue(0);
  bar_->setVisible(running);
  stop_->setVisible(running);
  if (!running) {
    for (const auto& widget : disabled_)
      if (widget) widget->setEnabled(true);
    disabled_.clear();
    return;
  }
  stop_->setFocus();  // before what has it is disabled, which would hand it on
  for (const auto& widget : held_)
    if (widget && widget->isEnabled()) {
      widget->setEnabled(false);
      disabled_.push_back(widget);
    }
}

bool WorkPanel::Run(const QString& text, const std::function<void(Progress&)>& work) {
  if (running_) return false;
  stopAsked_ = false;
  const QPointer<QWidget> before = window()->focusWidget();
  Show(text);
  SetRunning(true);
  shown_.invalidate();  // the first step shows, however short the work
  struct End {
    QPointer<WorkPanel> panel;
    QPointer<QWidget> before;
    ~End() {
      if (!panel) return;
      panel->SetRunning(false);
      panel->Show({});
      if (before) before->setFocus();
    }
  } const end{this, before};
  Steps steps(*this, text);
  work(steps);
  return true;
}

void WorkPanel::Stop() {
  if (running_) stopAsked_ = true;
}

bool WorkPanel::StopFirst() {
  Stop();
  return running_;
}

}  // namespace kora
