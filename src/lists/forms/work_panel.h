#pragma once

#include <QElapsedTimer>
#include <QPointer>
#include <QString>
#include <QWidget>
#include <functional>
#include <initializer_list>
#include <vector>

#include "platform/progress.h"

class QLabel;
class QProgressBar;
class QPushButton;

namespace kora {

// Long work within a form: a line of text, a bar and "Stop". The form stands it under its list or
// grid, which fills while the work goes on.
//
//   panel_ = new WorkPanel(this);
//   panel_->Hold({command1_, menuBar()});          // can't be used meanwhile
//   ...
//   panel_->Run("Checking Data - WAIT", [this](Progress& progress) {
//     for (int i = 1; i <= count; ++i) {
//       ...                                        // grid_->Refresh() as rows come
//       if (!progress.Step(i, count)) return;      // the user stopped it
//     }
//   });
//   ...
//   void reject() override { if (!panel_->StopFirst()) QDialog::reject(); }
//
// The line of text follows what the work tells as its state and what it has in hand. The window is
// painted and takes clicks and keys between the steps.
class WorkPanel : public QWidget {
 public:
  explicit WorkPanel(QWidget* parent);

  // Widgets that are disabled while work goes on, and enabled again behind it if they were.
  void Hold(std::initializer_list<QWidget*> widgets);

  // Does the work, showing `text`; false, and nothing is done, while other work is going on. What
  // the work throws goes on to the caller, with the form as it was.
  bool Run(const QString& text, const std::function<void(Progress&)>& work);

  bool running() const { return running_; }
  // Whether the last work was asked to stop.
  bool stopped() const { return stopAsked_; }
  void Stop();
  // For a form that is being closed: asks the work to stop; false when none is going on.
  bool StopFirst();
  // The line of text, also between the works.
  void Show(const QString& text);

 private:
  class Steps;
  void SetRunning(bool running);

  QLabel* text_;
  QProgressBar* bar_;
  QPushButton* stop_;
  std::vector<QPointer<QWidget>> held_;
  std::vector<QPointer<QWidget>> disabled_;
  QElapsedTimer shown_;
  bool running_ = false;
  bool stopAsked_ = false;
};

}  // namespace kora
