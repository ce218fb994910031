#include "tests/monkey/driver/monkey.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAction>
#include <QActionEvent>
#include <QApplication>
#include <QClipboard>
#include <QColorDialog>
#include <QComboBox>
#include <QDialog>
#include <QDir>
#include <QFileDialog>
#include <QFontDialog>
#include <QInputMethodEvent>
#include <QLineEdit>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QMessageBox>
#include <QStyleHints>
#include <QTest>
#include <QThread>
#include <QTimerEvent>
#include <QToolBar>
#include <QWheelEvent>
#include <QWindow>
#include <algorithm>
#include <array>

#include "platform/qt/qt_dialogs.h"
#include "tests/monkey/driver/messages.h"

namespace kora::monkey {
namespace {

constexpr size_t kRemembered = 30;  // events told with a failure
constexpr int kDeepest = 10;        // loops within loops, from which on forms are only left
constexpr int kWindowsOfAName = 40;

std::string Text(const QString& text) { return text.toStdString(); }

std::string Shown(const QString& text) {
  QString out;
  for (const QChar c : text.left(40)) out += c.unicode() < ' ' ? QChar('?') : c;
  if (text.size() > 40) out += QString("... (%1)").arg(text.size());
  return Text(out);
}

std::string Shown(QPoint at) { return std::to_string(at.x()) + "," + std::to_string(at.y()); }

bool IsPicture(const QWidget* widget) { return widget->objectName().startsWith("Picture"); }

}  // namespace

Monkey::Monkey(Options options)
    : options_(std::move(options)),
      generator_(options_.seed),
      inWork_(options_.seed ^ 0x9E3779B97F4A7C15ull),
      watchdog_(options_.hangs),
      log_(std::fopen(options_.log.c_str(), "w")) {
  qApp->installEventFilter(this);
  // What depends on how fast one is.
  QApplication::setCursorFlashTime(0);
  QApplication::setKeyboardInputInterval(0);
  for (const Qt::UIEffect effect : {Qt::UI_AnimateMenu, Qt::UI_FadeMenu, Qt::UI_AnimateCombo,
                                    Qt::UI_AnimateTooltip, Qt::UI_FadeTooltip})
    QApplication::setEffectEnabled(effect, false);
}

Monkey::~Monkey() {
  qApp->removeEventFilter(this);
  if (log_) std::fclose(log_);
}

// ---- What is kept and told

void Monkey::Note(const std::string& line) {
  std::string all = "#" + std::to_string(number_) + " " + line;
  // The folder of a run has another name each time.
  if (const size_t at = home_.empty() ? all.npos : all.find(home_.substr(0, 12)); at != all.npos)
    all.resize(at);
  if (log_) {
    std::fprintf(log_, "%s\n", all.c_str());
    std::fflush(log_);
  }
  for (const char c : all) digest_ = (digest_ ^ static_cast<unsigned char>(c)) * 1099511628211ull;
  last_.push_back(all);
  if (last_.size() > kRemembered) last_.erase(last_.begin());
}

void Monkey::Fail(const std::string& what) {
  if (!failures_.insert(what).second) return;
  std::fprintf(stderr, "FAILURE at event %ld of seed %llu: %s\n", number_,
               static_cast<unsigned long long>(options_.seed), what.c_str());
  for (const std::string& line : last_) std::fprintf(stderr, "    %s\n", line.c_str());
  std::fflush(stderr);
}

void Monkey::FailMessage(const std::string& text, const std::string& title,
                         const std::string& why) {
  Fail(why + ": \"" + text + "\" (" + title + ")");
}

void Monkey::BeginRun(const std::string& home, std::function<QWidget*()> mainWindow) {
  home_ = home;
  mainWindow_ = std::move(mainWindow);
  running_ = true;
  ended_ = false;
  runBegan_ = number_;
  held_ = nullptr;
  chartDeeds_ = 0;
  Note("a run begins");
  timer_ = startTimer(0);
}

void Monkey::EndRun() {
  running_ = false;
  QCoreApplication::removePostedEvents(this);
  if (timer_) killTimer(std::exchange(timer_, 0));
  if (QWidget* main = mainWindow_()) {
    // Forms that were left stay with the main window until it goes: some are kept on purpose.
    std::map<std::string, int> kept;
    for (QWidget* w : main->findChildren<QWidget*>())
      if (w->isWindow() && !w->isVisible() && !qobject_cast<QMenu*>(w) &&
          !w->objectName().isEmpty())
        ++kept[Text(w->objectName())];
    for (const auto& [name, count] : kept)
      if (count > kWindowsOfAName)
        Fail(name + " is kept again and again when it was left: " + std::to_string(count));
  }
  Note("the run ends");
}

void Monkey::CheckNothingIsLeft() {
  QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  for (QWidget* w : QApplication::topLevelWidgets()) {
    const std::string type = w->metaObject()->className();
    if (type == "QTipLabel") continue;  // Qt's own, hidden by a timer
    Fail("a window is left behind the program: " + type + " " + Text(w->objectName()));
  }
  for (int i = 0; QApplication::overrideCursor() && i < 100; ++i) {
    if (i == 0) Fail("the pointer is still the one of a program at work");
    QApplication::restoreOverrideCursor();
  }
}

std::string Monkey::FormOf(const QObject* object) const {
  for (const QObject* o = object; o; o = o->parent()) {
    const auto* widget = qobject_cast<const QWidget*>(o);
    if (!widget || qobject_cast<const QMenu*>(widget)) continue;
    const bool framed = qobject_cast<const QMdiSubWindow*>(widget->parentWidget()) != nullptr;
    if (widget->isWindow() || framed)
      return Text(widget->objectName().isEmpty() ? widget->metaObject()->className()
                                                 : widget->objectName());
  }
  return "?";
}

std::string Monkey::KeyOf(const QAction* action) const {
  return FormOf(action->parent()) + "." + Text(action->objectName());
}

std::string Monkey::KeyOf(const QWidget* control) const {
  return FormOf(control) + "." +
         Text(control->objectName().isEmpty() ? control->metaObject()->className()
                                              : control->objectName());
}

void Monkey::Watch(QAction* action) {
  if (action->property("monkey").toBool()) return;
  action->setProperty("monkey", true);
  connect(action, &QAction::triggered, this, [this, action] {
    if (action->objectName().isEmpty()) return;
    ++entries[KeyOf(action)];
    ++actions;
  });
}

void Monkey::Look() {
  for (QWidget* window : QApplication::topLevelWidgets())
    for (QAction* action : window->findChildren<QAction*>())
      if (!action->objectName().isEmpty() && !action->isSeparator() && !action->menu() &&
          !action->objectName().startsWith("qt_") && action->isVisible() &&
          action->property("monkey").toBool())
        entries.try_emplace(KeyOf(action), 0);
}

bool Monkey::eventFilter(QObject* object, QEvent* event) {
  switch (event->type()) {
    case QEvent::ActionAdded: Watch(static_cast<QActionEvent*>(event)->action()); break;
    case QEvent::Show:
      if (auto* box = qobject_cast<QMessageBox*>(object)) {
        const std::string text = Text(box->text()), title = Text(box->windowTitle());
        ++messages[text];
        Note("told: " + Shown(box->text()));
        if (const std::string why = FaultOfMessage(text, options_.numbers); !why.empty())
          FailMessage(text, title, why);
      }
      if (auto* widget = qobject_cast<QWidget*>(object))
        if ((widget->isWindow() || qobject_cast<QMdiSubWindow*>(widget->parentWidget())) &&
            !qobject_cast<QMenu*>(widget) && !widget->objectName().isEmpty())
          ++forms[Text(widget->objectName())];
      break;
    default: break;
  }
  return false;
}

// ---- One event after the other

// A timer does not run within its own event: each event has one of its own, so that modal forms go
// on getting theirs. It begins a round later, when what the windows do to one another by the event
// before is done: this platform makes menus active, which others do not.
void Monkey::customEvent(QEvent*) {
  if (running_) timer_ = startTimer(0);
}

void Monkey::timerEvent(QTimerEvent* event) {
  killTimer(event->timerId());
  timer_ = 0;
  if (!running_) return;
  QCoreApplication::postEvent(this, new QEvent(QEvent::User));
  if (ended_) return;
  const int level = QThread::currentThread()->loopLevel();
  if (!levels_.empty() && levels_.back() >= level) {
    InWork();
    return;
  }
  if (Done()) {
    ended_ = true;
    Note("enough");
    QCoreApplication::exit(0);
    return;
  }
  if (Windows().empty()) return;  // the splash
  if (ButtonGoesDown() || InputIsHeldBack()) return;
  // What no form caught passes through here.
  struct Under {
    std::vector<int>& levels;
    ~Under() { levels.pop_back(); }
  } under{levels_};
  levels_.push_back(level);
  watchdog_.NextEvent();
  ++number_;
  workDeed_ = Chance(generator_, 0.3) ? 1 + Below(generator_, 8) : 0;
  if (number_ % 25 == 0) Look();
  Act();
}

// A button that was pressed by its letter comes up again a tenth of a second later, and does its
// work then. Another that stays down is one that holds a menu open.
bool Monkey::ButtonGoesDown() {
  if (!keyed_) return false;
  if (!QApplication::activePopupWidget() && pressed_.elapsed() < 300)
    for (QWidget* window : QApplication::topLevelWidgets())
      for (auto* button : window->findChildren<QAbstractButton*>())
        if (button->isDown() && button->isVisible() && !button->inherits("QToolButton"))
          return true;
  keyed_ = false;
  return false;
}

std::vector<QWidget*> Monkey::Windows() const {
  std::vector<QWidget*> out;
  QWidget* modal = QApplication::activeModalWidget();
  for (QWidget* w : QApplication::topLevelWidgets()) {
    if (!w->isVisible() || !w->isEnabled() || !w->windowHandle()) continue;
    if (w->windowType() == Qt::SplashScreen || w->windowType() == Qt::ToolTip ||
        w->windowType() == Qt::Popup)
      continue;
    // A modal form holds back what does not belong to it.
    if (modal && w != modal && !modal->isAncestorOf(w)) continue;
    out.push_back(w);
  }
  std::sort(out.begin(), out.end(), [](QWidget* a, QWidget* b) {
    return a->windowHandle()->winId() < b->windowHandle()->winId();
  });
  return out;
}

void Monkey::Act() {
  if (held_ && Chance(generator_, 0.5)) {
    const QPointer<QWidget> at = held_;
    held_ = nullptr;
    Note("lets the button go");
    Mouse(at, PointIn(at), QEvent::MouseButtonRelease, Qt::LeftButton, {});
    return;
  }
  if (QWidget* popup = QApplication::activePopupWidget()) {
    if (auto* menu = qobject_cast<QMenu*>(popup)) return UseMenu(menu);
    return UsePopup(popup);
  }
  QWidget* modal = QApplication::activeModalWidget();
  if (auto* box = qobject_cast<QMessageBox*>(modal)) return AnswerMessage(box);
  if (auto* dialog = qobject_cast<QFileDialog*>(modal)) return AnswerFile(dialog);
  const auto windows = Windows();
  if (int(levels_.size()) > kDeepest) return LeaveForm(windows.back());
  // The one that came last is the one in hand.
  QWidget* window = Chance(generator_, 0.75)
                        ? windows.back()
                        : windows[size_t(Below(generator_, int(windows.size())))];
  const long inRun = number_ - runBegan_;
  if (window == mainWindow_() &&
      (inRun > options_.longestRun || (inRun > 1000 && Chance(generator_, 0.0008))))
    return CloseMain();
  UseWindow(window);
}

// What a user does while a progress bar moves: he waits, mostly. Takes nothing from the generator
// of events, whose numbers must not depend on how long a step takes.
void Monkey::InWork() {
  if (workDeed_ == 0) return;
  const int deed = workDeed_;
  workDeed_ = 0;
  QWidget* window = QApplication::activeModalWidget();
  if (!window) window = QApplication::activeWindow();
  if (!window || !window->isVisible()) return;
  levels_.push_back(QThread::currentThread()->loopLevel());
  if (deed <= 4) {
    for (auto* button : window->findChildren<QAbstractButton*>()) {
      const QString caption = button->text().remove('&');
      if (!button->isVisible() || !button->isEnabled() ||
          (caption != "Stop" && caption != "Cancel" && caption != "Close"))
        continue;
      Note("while it works: " + KeyOf(button));
      Click(button, button->rect().center());
      break;
    }
  } else if (deed == 5) {
    Note("while it works: Escape");
    Key(Qt::Key_Escape, {});
  } else if (deed == 6) {
    Note("while it works: closes " + FormOf(window));
    window->close();
  } else {
    const auto controls = Controls(window);
    if (!controls.empty()) {
      QWidget* control = controls[size_t(Below(inWork_, int(controls.size())))];
      Note("while it works: " + KeyOf(control));
      Click(control, control->rect().center());
    }
  }
  levels_.pop_back();
}

void Monkey::AnswerMessage(QMessageBox* box) {
  const auto buttons = box->buttons();
  const double how = double(Below(generator_, 1000)) / 1000;
  if (how < 0.85 && !buttons.isEmpty()) {
    QAbstractButton* button = buttons[Below(generator_, int(buttons.size()))];
    Note("answers " + Shown(button->text()));
    Click(button, button->rect().center());
  } else if (how < 0.92) {
    Note("answers by Escape");
    Key(Qt::Key_Escape, {});
  } else if (how < 0.97) {
    Note("answers by Enter");
    Key(Qt::Key_Return, {}, "\r");
  } else {
    SomeKey();
  }
}

// Below the home only: a dialog for files could remove what is none of the program's.
void Monkey::AnswerFile(QFileDialog* dialog) {
  dialog->setOption(QFileDialog::ReadOnly);
  if (Chance(generator_, 0.35)) {
    Note("no file");
    dialog->reject();
    return;
  }
  static constexpr std::array kFolders{"drive_c/korawin", "drive_c/korawin/data",
                                       "drive_c/korawin/chtsave", "drive_c"};
  dialog->setDirectory(QString::fromStdString(home_) + "/" +
                       kFolders[size_t(Below(generator_, int(kFolders.size())))]);
  const auto filters = dialog->nameFilters();
  if (filters.size() > 1) {
    auto* types = dialog->findChild<QComboBox*>("fileTypeCombo");
    if (types) types->setCurrentIndex(Below(generator_, types->count()));
  }
  auto* edit = dialog->findChild<QLineEdit*>("fileNameEdit");
  const QString name = FileNameToType(generator_);
  if (edit && dialog->fileMode() != QFileDialog::Directory && Chance(generator_, 0.8)) {
    edit->setFocus();
    edit->setText(name);
  }
  Note("takes the file " + Shown(name));
  edit ? edit->setFocus() : dialog->setFocus();
  Key(Qt::Key_Return, {}, "\r");
}

void Monkey::UseMenu(QMenu* menu) {
  if (Chance(generator_, 0.12)) {
    Note("Escape in a menu");
    return Key(Qt::Key_Escape, {});
  }
  if (Chance(generator_, 0.15)) return SomeKey();
  std::vector<QAction*> can;
  for (QAction* action : menu->actions())
    if (action->isVisible() && action->isEnabled() && !action->isSeparator() &&
        action->objectName() != "mnuExit")
      can.push_back(action);
  if (can.empty()) return Key(Qt::Key_Escape, {});
  QAction* action = RareAction(can);
  Note("menu " + KeyOf(action));
  Click(menu, menu->actionGeometry(action).center());
}

void Monkey::UsePopup(QWidget* popup) {
  const int how = Below(generator_, 10);
  if (how < 2) {
    Note("Escape in a list");
    return Key(Qt::Key_Escape, {});
  }
  if (how < 5) return SomeKey();
  QWidget* target = popup;
  if (auto* view = qobject_cast<QAbstractItemView*>(popup))
    target = view->viewport();
  else if (auto* inner = popup->findChild<QAbstractItemView*>())
    target = inner->viewport();
  const QPoint at = PointIn(target);
  Note("click in a list " + Shown(at));
  Click(target, at);
}

void Monkey::CloseMain() {
  QWidget* main = mainWindow_();
  if (!main) return;
  QAction* exit = main->findChild<QAction*>("mnuExit");
  if (exit && Chance(generator_, 0.5)) {
    Note("exit");
    exit->trigger();
  } else {
    Note("closes the main window");
    main->close();
  }
}

void Monkey::LeaveForm(QWidget* form) {
  if (form == mainWindow_()) return SomeKey();
  const int how = Below(generator_, 4);
  if (how == 0) {
    Note("closes " + FormOf(form));
    form->close();
    return;
  }
  std::vector<QAbstractButton*> buttons;
  for (auto* button : form->findChildren<QAbstractButton*>())
    if (button->isVisible() && button->isEnabled() && button->window() == form &&
        button->inherits("QPushButton"))
      buttons.push_back(button);
  if (how == 1 || buttons.empty()) {
    Note("Escape in " + FormOf(form));
    form->activateWindow();
    Key(Qt::Key_Escape, {});
    return;
  }
  QAbstractButton* button = buttons[size_t(Below(generator_, int(buttons.size())))];
  Note("leaves by " + KeyOf(button));
  Click(button, button->rect().center());
}

void Monkey::UseWindow(QWidget* window) {
  const QPointer<QWidget> alive(window);
  const bool isMain = window == mainWindow_();
  const auto controls = Controls(window);
  if (!isMain) {
    const int stay = window->property("monkeyEvents").toInt();
    window->setProperty("monkeyEvents", stay + 1);
    if (Chance(generator_, stay > 60 ? 0.3 : 0.07)) return LeaveForm(window);
  }
  if (isMain && chartDeeds_ > 0) {
    --chartDeeds_;
    for (QWidget* control : controls)
      if (IsPicture(control) && Chance(generator_, 0.6)) return UsePicture(control);
  }
  const int how = Below(generator_, 100);
  if (how < 28) {
    if (const auto can = Reachable(window); !can.empty()) return Choose(RareAction(can));
  }
  if (how < 31) return Resize(window);
  if (how < 40) return SomeKey();
  if (controls.empty()) return SomeKey();
  QWidget* control = RareControl(controls);
  ++used[KeyOf(control)];
  if (IsPicture(control)) return UsePicture(control);
  if (how < 57) {
    // A text, into a box.
    std::vector<QWidget*> boxes;
    for (QWidget* c : controls)
      if (qobject_cast<QLineEdit*>(c) || c->inherits("QAbstractSpinBox") ||
          (c->inherits("QAbstractScrollArea") && Chance(generator_, 0.3)))
        boxes.push_back(c);
    if (QWidget* box = RareControl(boxes)) {
      const QString text = TextToType(generator_, options_.codes);
      Note("types \"" + Shown(text) + "\" into " + KeyOf(box));
      ++used[KeyOf(box)];
      const QPointer<QWidget> there(box);
      QPoint at = box->rect().center();
      if (box->inherits("QAbstractScrollArea")) at = PointIn(box);
      Click(box, at);
      if (!there) return;
      if (Chance(generator_, 0.7)) Key(Qt::Key_A, Qt::ControlModifier);
      Type(text);
      if (Chance(generator_, 0.4))
        Key(Chance(generator_, 0.6) ? Qt::Key_Return : Qt::Key_Tab, {}, "\r");
      return;
    }
  }
  if (auto* view = qobject_cast<QAbstractItemView*>(control)) control = view->viewport();
  const QPoint at = control->inherits("QAbstractButton") && Chance(generator_, 0.8)
                        ? QPoint(std::min(8, control->width() / 2), control->height() / 2)
                        : PointIn(control);
  if (how < 85) {
    Note("click " + KeyOf(control) + " " + Shown(at));
    return Click(control, at, Qt::LeftButton,
                 Chance(generator_, 0.1) ? SomeModifiers() : Qt::NoModifier);
  }
  if (how < 89) {
    Note("double click " + KeyOf(control) + " " + Shown(at));
    return Click(control, at, Qt::LeftButton, {}, true);
  }
  if (how < 94) {
    Note("right click " + KeyOf(control) + " " + Shown(at));
    return Click(control, at, Qt::RightButton);
  }
  if (how < 97) {
    const QPoint to = PointIn(control);
    Note("drag " + KeyOf(control) + " " + Shown(at) + " to " + Shown(to));
    return Drag(control, at, to, Qt::LeftButton, SomeModifiers());
  }
  Note("wheel " + KeyOf(control));
  Wheel(control, at);
}

void Monkey::UsePicture(QWidget* picture) {
  const QPoint at = PointIn(picture), to = PointIn(picture);
  const std::string name = KeyOf(picture) + " " + Shown(at);
  ++used[KeyOf(picture)];
  const int how = Below(generator_, 100);
  if (how < 30) {
    Note("click " + name);
    Click(picture, at, Qt::LeftButton, Chance(generator_, 0.15) ? SomeModifiers() : Qt::NoModifier);
  } else if (how < 62) {
    Note("drag " + name + " to " + Shown(to));
    Drag(picture, at, to, Chance(generator_, 0.9) ? Qt::LeftButton : Qt::RightButton,
         Chance(generator_, 0.15) ? SomeModifiers() : Qt::NoModifier);
  } else if (how < 72) {
    Note("moves over " + name);
    Mouse(picture, at, QEvent::MouseMove, Qt::NoButton, {});
  } else if (how < 80) {
    Note("right click " + name);
    Click(picture, at, Qt::RightButton);
  } else if (how < 86) {
    Note("double click " + name);
    Click(picture, at, Qt::LeftButton, {}, true);
  } else if (how < 91) {
    Note("wheel " + name);
    Wheel(picture, at);
  } else if (how < 95) {
    Note("holds the button on " + name);
    Mouse(picture, at, QEvent::MouseButtonPress, Qt::LeftButton, {});
    held_ = picture;
  } else {
    SomeKey();
  }
}

// ---- Steps

Qt::KeyboardModifiers Monkey::SomeModifiers() {
  static constexpr std::array<Qt::KeyboardModifier, 4> kSome{Qt::NoModifier, Qt::ShiftModifier,
                                                             Qt::ControlModifier, Qt::AltModifier};
  Qt::KeyboardModifiers keys = kSome[size_t(Below(generator_, 4))];
  if (Chance(generator_, 0.2)) keys |= kSome[size_t(Below(generator_, 4))];
  return keys;
}

QPoint Monkey::PointIn(const QWidget* widget) {
  const int w = std::max(1, widget->width()), h = std::max(1, widget->height());
  return {Below(generator_, w), Below(generator_, h)};
}

void Monkey::Mouse(QWidget* widget, QPoint at, int type, Qt::MouseButton button,
                   Qt::KeyboardModifiers keys) {
  QWidget* top = widget->window();
  QWindow* window = top->windowHandle();
  if (!window) return;
  if (type == QEvent::MouseButtonPress) {
    // What a window manager does with a click into a window.
    if (top != QApplication::activeWindow() && top->windowType() != Qt::Popup)
      top->activateWindow();
    buttons_ |= button;
  } else if (type == QEvent::MouseButtonRelease) {
    buttons_ &= ~Qt::MouseButtons(button);
  }
  const QPoint in = widget->mapTo(top, at);
  time_ += 20;
  qt_handleMouseEvent(window, in, window->mapToGlobal(in), buttons_, button, QEvent::Type(type),
                      keys, int(time_));
}

void Monkey::Click(QWidget* widget, QPoint at, Qt::MouseButton button, Qt::KeyboardModifiers keys,
                   bool twice) {
  const QPointer<QWidget> there(widget);
  time_ += 1000;  // no double click with the one before
  for (int i = 0; i < (twice ? 2 : 1); ++i) {
    if (!there || !there->isVisible()) break;
    if (i == 0) Mouse(there, at, QEvent::MouseMove, Qt::NoButton, keys);
    if (there) Mouse(there, at, QEvent::MouseButtonPress, button, keys);
    if (there) Mouse(there, at, QEvent::MouseButtonRelease, button, keys);
  }
  buttons_ &= ~Qt::MouseButtons(button);
}

void Monkey::Drag(QWidget* widget, QPoint from, QPoint to, Qt::MouseButton button,
                  Qt::KeyboardModifiers keys) {
  const QPointer<QWidget> there(widget);
  time_ += 1000;
  const int steps = 1 + Below(generator_, 6);
  Mouse(there, from, QEvent::MouseButtonPress, button, keys);
  for (int i = 1; i <= steps && there; ++i)
    Mouse(there, from + (to - from) * i / steps, QEvent::MouseMove, Qt::NoButton, keys);
  if (there) Mouse(there, to, QEvent::MouseButtonRelease, button, keys);
  buttons_ &= ~Qt::MouseButtons(button);
}

void Monkey::Wheel(QWidget* widget, QPoint at) {
  QWidget* top = widget->window();
  if (!top->windowHandle()) return;
  const QPointF in = widget->mapTo(top, at);
  const int turn = (Chance(generator_, 0.5) ? 120 : -120) * (1 + Below(generator_, 3));
  const Qt::KeyboardModifiers keys = Chance(generator_, 0.4) ? SomeModifiers() : Qt::NoModifier;
  QWheelEvent event(in, top->windowHandle()->mapToGlobal(in), {},
                    Chance(generator_, 0.85) ? QPoint(0, turn) : QPoint(turn, 0), buttons_, keys,
                    Qt::NoScrollPhase, false);
  QCoreApplication::sendEvent(top->windowHandle(), &event);
}

// To the window that has the keyboard, as the window system does.
void Monkey::Key(int key, Qt::KeyboardModifiers keys, const QString& text) {
  const auto window = [] { return QGuiApplication::focusWindow(); };
  if (!window()) {
    const auto windows = Windows();
    if (windows.empty()) return;
    windows.back()->activateWindow();
    if (!window()) return;
  }
  keyed_ = true;
  pressed_.start();
  qt_handleKeyEvent(window(), QEvent::KeyPress, key, keys, text);
  if (window()) qt_handleKeyEvent(window(), QEvent::KeyRelease, key, keys, text);
}

void Monkey::SomeKey() {
  static constexpr std::array kKeys{
      Qt::Key_Tab,       Qt::Key_Backtab, Qt::Key_Return, Qt::Key_Enter,    Qt::Key_Space,
      Qt::Key_Up,        Qt::Key_Down,    Qt::Key_Left,   Qt::Key_Right,    Qt::Key_Home,
      Qt::Key_End,       Qt::Key_PageUp,  Qt::Key_Delete, Qt::Key_PageDown, Qt::Key_Insert,
      Qt::Key_Backspace, Qt::Key_F1,      Qt::Key_F2,     Qt::Key_F3,       Qt::Key_F4,
      Qt::Key_F5,        Qt::Key_F6,      Qt::Key_F7,     Qt::Key_F8,       Qt::Key_F9,
      Qt::Key_F10,       Qt::Key_F11,     Qt::Key_F12,    Qt::Key_Menu,     Qt::Key_Plus,
      Qt::Key_Minus,     Qt::Key_Escape};
  if (Chance(generator_, 0.4)) {
    const int letter = Qt::Key_A + Below(generator_, 26);
    const Qt::KeyboardModifiers keys = SomeModifiers();
    const bool plain = !(keys & (Qt::ControlModifier | Qt::AltModifier));
    Note("key " + std::string(1, char(letter)) + " with " + std::to_string(int(keys) >> 25));
    return Key(letter, keys, plain ? QString(QChar(letter)).toLower() : QString());
  }
  const int key = kKeys[size_t(Below(generator_, int(kKeys.size())))];
  const Qt::KeyboardModifiers keys = Chance(generator_, 0.35) ? SomeModifiers() : Qt::NoModifier;
  Note("key " + Text(QKeySequence(key).toString()) + " with " + std::to_string(int(keys) >> 25));
  QString text;
  if (key == Qt::Key_Space) text = " ";
  if (key == Qt::Key_Return || key == Qt::Key_Enter) text = "\r";
  if (key == Qt::Key_Plus) text = "+";
  if (key == Qt::Key_Minus) text = "-";
  Key(key, keys, text);
}

// Short ones letter by letter, the others as from a keyboard of another script, or pasted.
void Monkey::Type(const QString& text) {
  const bool plain =
      std::all_of(text.begin(), text.end(), [](QChar c) { return c >= ' ' && c <= '~'; });
  if (plain && text.size() <= 24) {
    for (const QChar c : text) Key(c.toUpper().unicode(), {}, QString(c));
    return;
  }
  if (Chance(generator_, 0.5)) {
    QGuiApplication::clipboard()->setText(text);
    return Key(Qt::Key_V, Qt::ControlModifier);
  }
  if (QObject* focus = QGuiApplication::focusObject()) {
    QInputMethodEvent event;
    event.setCommitString(text);
    QCoreApplication::sendEvent(focus, &event);
  }
}

void Monkey::Resize(QWidget* window) {
  std::vector<QWidget*> can{window};
  for (QMdiSubWindow* frame : window->findChildren<QMdiSubWindow*>())
    if (frame->isVisible()) can.push_back(frame);
  QWidget* widget = can[size_t(Below(generator_, int(can.size())))];
  const QPointer<QWidget> there(widget);
  const std::string name = widget == window ? FormOf(widget) : "a window in " + FormOf(window);
  const int how = Below(generator_, 12);
  if (how == 0) {
    Note("maximises " + name);
    widget->showMaximized();
  } else if (how == 1) {
    Note("makes normal " + name);
    widget->showNormal();
  } else if (how == 2 && widget != window) {
    Note("closes " + name);
    widget->close();
  } else {
    static constexpr std::array kSizes{1, 20, 120, 300, 500, 640, 800, 1024, 1280, 1920, 3000};
    const QSize size(kSizes[size_t(Below(generator_, int(kSizes.size())))],
                     kSizes[size_t(Below(generator_, int(kSizes.size())))]);
    Note("resizes " + name + " to " + std::to_string(size.width()) + " x " +
         std::to_string(size.height()));
    widget->resize(size);
  }
}

void Monkey::Choose(QAction* action) {
  const std::string key = KeyOf(action);
  const QPointer<QAction> there(action);
  Note("chooses " + key);
  if (FormOf(action->parent()) == "Chts" && Chance(generator_, 0.7))
    chartDeeds_ = 1 + Below(generator_, 6);
  action->trigger();
  if (!there) ++entries[key];  // it went with its form before it was counted
}

// ---- What there is

std::vector<QWidget*> Monkey::Controls(QWidget* window) const {
  std::vector<QWidget*> out;
  for (QWidget* w : window->findChildren<QWidget*>()) {
    if (!w->isVisible() || !w->isEnabled() || w->window() != window) continue;
    if (w->width() < 2 || w->height() < 2 || w->visibleRegion().isEmpty()) continue;
    const bool control = (w->focusPolicy() != Qt::NoFocus && !w->inherits("QMdiArea")) ||
                         IsPicture(w) || w->inherits("QMenuBar") || w->inherits("QHeaderView") ||
                         w->inherits("QTabBar") || w->inherits("QAbstractButton") ||
                         w->inherits("QScrollBar");
    // Parts of a box take what the box gets.
    const QWidget* parent = w->parentWidget();
    const bool part =
        parent && (parent->inherits("QAbstractSpinBox") || parent->inherits("QComboBox"));
    if (control && !part) out.push_back(w);
  }
  return out;
}

namespace {

// A user comes to an entry through its menus, all of which must be open to him.
bool CanBeReached(const QAction* action, const QWidget* window, int depth = 0) {
  if (!action->isEnabled() || !action->isVisible() || depth > 5) return false;
  for (const QObject* object : action->associatedObjects()) {
    if (const auto* menu = qobject_cast<const QMenu*>(object)) {
      if (CanBeReached(menu->menuAction(), window, depth + 1)) return true;
    } else if (const auto* bar = qobject_cast<const QWidget*>(object)) {
      if ((qobject_cast<const QMenuBar*>(bar) || qobject_cast<const QToolBar*>(bar)) &&
          bar->isVisible() && bar->isEnabled() && bar->window() == window)
        return true;
    }
  }
  return false;
}

}  // namespace

std::vector<QAction*> Monkey::Reachable(QWidget* window) const {
  std::vector<QAction*> out;
  for (QAction* action : window->findChildren<QAction*>())
    if (!action->menu() && !action->isSeparator() && !action->objectName().isEmpty() &&
        action->objectName() != "mnuExit" && CanBeReached(action, window))
      out.push_back(action);
  return out;
}

QAction* Monkey::RareAction(const std::vector<QAction*>& among) {
  if (Chance(generator_, 0.3)) return among[size_t(Below(generator_, int(among.size())))];
  std::vector<QAction*> rarest;
  long least = -1;
  for (QAction* action : among) {
    const auto count = entries.find(KeyOf(action));
    const long n = count == entries.end() ? 0 : count->second;
    if (least >= 0 && n > least) continue;
    if (n < least || least < 0) rarest.clear();
    least = n;
    rarest.push_back(action);
  }
  return rarest[size_t(Below(generator_, int(rarest.size())))];
}

// The rarest of some.
QWidget* Monkey::RareControl(const std::vector<QWidget*>& among) {
  QWidget* rarest = nullptr;
  long least = 0;
  for (int i = 0; i < 4 && !among.empty(); ++i) {
    QWidget* one = among[size_t(Below(generator_, int(among.size())))];
    const auto count = used.find(KeyOf(one));
    const long n = count == used.end() ? 0 : count->second;
    if (rarest && n >= least) continue;
    rarest = one;
    least = n;
  }
  return rarest;
}

}  // namespace kora::monkey
