#include "shell/forms/Logo.h"

#include <QApplication>
#include <QLabel>
#include <QPainter>
#include <QScreen>
#include <QVBoxLayout>
#include <QWindow>

#include "base/runtime_error.h"
#include "base/version.h"
#include "platform/qt/to_qt.h"
#include "shell/main_menu.h"
#include "shell/waiting_downloads.h"

namespace kora {
namespace {

// Candles on a black ground, 9 units high, so that the sign says what the program is for.
QPixmap Emblem(int unit, int candles, double dpr) {
  QPixmap pixmap(QSize(unit * (candles * 2 + 2), unit * 9) * dpr);
  pixmap.setDevicePixelRatio(dpr);
  pixmap.fill(Qt::black);
  QPainter painter(&pixmap);
  painter.scale(unit, unit);
  const double closes[] = {6.2, 5.6, 6.6, 5.2, 4.4, 5.0, 4.0, 3.2, 3.9, 2.8, 2.0};
  for (int i = 0; i < candles; ++i) {
    const int last = 10 - candles + i;
    const double x = 1.5 + i * 2, from = closes[last], to = closes[last + 1];
    const QColor colour = to < from ? QColor(255, 255, 255) : QColor(192, 0, 0);
    painter.fillRect(QRectF(x + 0.45, std::min(from, to) - 0.7, 0.1, std::abs(to - from) + 1.4),
                     colour);
    painter.fillRect(QRectF(x, std::min(from, to), 1, std::abs(to - from)), colour);
  }
  return pixmap;
}

}  // namespace

Logo::Logo(Session& session, std::string commandLine)
    : QWidget(nullptr, Qt::SplashScreen), session_(session), commandLine_(std::move(commandLine)) {
  setObjectName("Logo");
  setWindowTitle(ToQt(kProgramTitle));
  setAttribute(Qt::WA_QuitOnClose, false);
  QPalette colours = palette();
  colours.setColor(QPalette::Window, Qt::black);
  colours.setColor(QPalette::WindowText, Qt::white);
  setPalette(colours);

  // The icon that was installed; without it the emblem.
  QApplication::setWindowIcon(QIcon::fromTheme("org.koracharting.kora", QIcon(Emblem(7, 4, 1))));

  auto* column = new QVBoxLayout(this);
  auto* title = new QLabel(ToQt(kProgramTitle), this);
  title->setObjectName("Label1");
  QFont large = font();
  large.setPointSizeF(font().pointSizeF() * 2.2);
  large.setBold(true);
  title->setFont(large);
  title->setAlignment(Qt::AlignCenter);
  auto* emblem = new QLabel(this);
  emblem->setPixmap(Emblem(fontMetrics().height() / 2, 10, devicePixelRatioF()));
  emblem->setAlignment(Qt::AlignCenter);
  column->addWidget(title);
  column->addWidget(emblem);
  const int margin = fontMetrics().height() * 2;
  column->setContentsMargins(margin, margin, margin, margin);

  timer2_ = new QTimer(this);
  timer2_->setObjectName("Timer2");
  timer2_->setSingleShot(true);
  timer2_->setInterval(600);
  timer2_->callOnTimeout(this, [this] { Timer(); });
}

void Logo::ScaleToScreen() {
  Settings& settings = session_.settings;
  settings.ScreenScaleH = settings.ScreenScaleW = 1;
  if (const QScreen* screen = this->screen()) {
    settings.ScreenScaleH = screen->size().height() * 15.0 / 7200;
    settings.ScreenScaleW = screen->size().width() * 15.0 / 9600;
  }
  settings.LargeScreen = settings.ScreenScaleH != 1;
}

bool Logo::Start(bool previous) {
  if (previous) {
    session_.dialogs.Message("You already have this application running.", kProgramTitle);
    return false;
  }
  session_.dialogs.SetBusy(true);
  adjustSize();
  const QRect room = screen()->geometry();
  const FormPlace place = CentreForm(room.width(), room.height(), width(), height());
  move(room.topLeft() + QPoint(place.left, place.top));
  show();
  session_.dialogs.Yield();

  ScaleToScreen();
  try {
    if (!ReadAllSettings(session_, commandLine_, true)) {
      session_.dialogs.SetBusy(false);
      close();
      return false;
    }
  } catch (const RunTimeError& e) {
    // With a folder that can't be one the program stands all the same, so that it can be mended.
    session_.dialogs.Message(std::string(e.what()) + "  " + session_.settings.paths.SystemPath,
                             kProgramTitle);
  }
  session_.dialogs.Yield();
  timer2_->start();
  return true;
}

void Logo::Timer() {
  session_.dialogs.SetBusy(false);
  session_.settings.PathsMissing = session_.settings.paths.SystemPath.empty();
  main_ = std::make_unique<Main>(session_, commandLine_);
  if (Prepare) Prepare(*main_);
  // Frames keep a window above the one that it belongs to, whenever that one comes up.
  main_->winId();
  if (windowHandle()) windowHandle()->setTransientParent(main_->windowHandle());
  main_->show();
  raise();
  if (session_.settings.PathsMissing) {
    hide();
    if (!main_->OpenPaths()) return;
  }
  if (AskForWaitingDownloads(session_.files, session_.settings.download, session_.dialogs))
    main_->OpenUpdate();
  close();
  if (Opened) Opened(*main_);
}

}  // namespace kora
