#pragma once

#include <QElapsedTimer>
#include <QObject>
#include <QPoint>
#include <QPointer>
#include <QString>
#include <cstdio>
#include <map>
#include <set>
#include <string>
#include <vector>

#include "tests/monkey/driver/watchdog.h"
#include "tests/monkey/driver/words.h"

class QAction;
class QAbstractButton;
class QFileDialog;
class QMenu;
class QMessageBox;
class QWidget;
class QWindow;

namespace kora::monkey {

// Uses whatever windows stand, one event after the other, as its generator says. It lives in the
// loop of events: each round of a loop, nested ones of modal forms included, is one event, put in
// where the window system puts its own. Work that hands out rounds between its steps gets what was
// settled before it began, so that it does not depend on how long a step takes.
class Monkey : public QObject {
 public:
  struct Options {
    std::uint64_t seed = 1;
    long events = 2000;
    long longestRun = 4000;  // events after which the main window is closed
    double hangs = 60;       // seconds of the processor for one event
    std::set<int> numbers;   // of errors that the guide explains
    std::vector<std::string> codes;
    std::string log;  // host file: a line an event
  };
  explicit Monkey(Options options);
  ~Monkey() override;

  Generator& generator() { return generator_; }
  bool Done() const { return number_ >= options_.events; }

  // A run of the program: between these the events are made. `home`: where file dialogs open.
  void BeginRun(const std::string& home, std::function<QWidget*()> mainWindow);
  void EndRun();
  // Behind a run, when the program is gone.
  void CheckNothingIsLeft();

  // What should not have been; told at once, each once, with the events before it.
  void Fail(const std::string& what);
  void FailMessage(const std::string& text, const std::string& title, const std::string& why);
  void Note(const std::string& line);

  long number() const { return number_; }
  size_t failures() const { return failures_.size(); }
  std::uint64_t digest() const { return digest_; }

  // What was seen and what was done, by "Form.Entry".
  std::map<std::string, long> entries, forms, used, messages;
  long actions = 0;  // menu entries chosen

 protected:
  void timerEvent(QTimerEvent* event) override;
  void customEvent(QEvent* event) override;
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  struct Place {
    QPointer<QWidget> widget;
    QPoint at;
  };

  // One event.
  void Act();
  void InWork();
  bool ButtonGoesDown();
  void AnswerMessage(QMessageBox* box);
  void AnswerFile(QFileDialog* dialog);
  void UseMenu(QMenu* menu);
  void UsePopup(QWidget* popup);
  void UseWindow(QWidget* window);
  void UsePicture(QWidget* picture);
  void LeaveForm(QWidget* form);
  void CloseMain();

  // Steps of events.
  void Mouse(QWidget* widget, QPoint at, int type, Qt::MouseButton button,
             Qt::KeyboardModifiers keys);
  void Click(QWidget* widget, QPoint at, Qt::MouseButton button = Qt::LeftButton,
             Qt::KeyboardModifiers keys = {}, bool twice = false);
  void Drag(QWidget* widget, QPoint from, QPoint to, Qt::MouseButton button,
            Qt::KeyboardModifiers keys);
  void Wheel(QWidget* widget, QPoint at);
  void Key(int key, Qt::KeyboardModifiers keys, const QString& text = {});
  void SomeKey();
  void Type(const QString& text);
  void Resize(QWidget* window);
  void Choose(QAction* action);

  // What there is.
  std::vector<QWidget*> Windows() const;  // those that take input, in the order of their making
  std::vector<QWidget*> Controls(QWidget* window) const;
  std::vector<QAction*> Reachable(QWidget* window) const;
  QWidget* RareControl(const std::vector<QWidget*>& among);
  QAction* RareAction(const std::vector<QAction*>& among);
  QPoint PointIn(const QWidget* widget);
  Qt::KeyboardModifiers SomeModifiers();

  std::string FormOf(const QObject* object) const;
  std::string KeyOf(const QAction* action) const;
  std::string KeyOf(const QWidget* control) const;
  void Watch(QAction* action);
  void Look();  // takes note of the entries that stand

  Options options_;
  Generator generator_, inWork_;
  Watchdog watchdog_;
  std::FILE* log_;
  std::vector<std::string> last_;
  std::uint64_t digest_ = 14695981039346656037ull;
  std::set<std::string> failures_;

  std::string home_;
  std::function<QWidget*()> mainWindow_;
  bool running_ = false, ended_ = false;
  long number_ = 0, runBegan_ = 0;
  std::vector<int> levels_;  // of loops, of the events under way
  int workDeed_ = 0;         // what the work of this event is to suffer
  int chartDeeds_ = 0;       // events that the chart gets, after a tool was taken up
  Qt::MouseButtons buttons_;
  int timer_ = 0;  // of the next event
  bool keyed_ = false;
  QElapsedTimer pressed_;
  QPointer<QWidget> held_;  // where the button went down and was not let go
  unsigned long time_ = 1000;
};

}  // namespace kora::monkey
