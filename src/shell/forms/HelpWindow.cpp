#include "shell/forms/HelpWindow.h"

#include <QAction>
#include <QDir>
#include <QFileInfo>
#include <QScreen>
#include <QShortcut>
#include <QTextBrowser>
#include <QToolBar>
#include <QUrl>

namespace kora {

QString FindGuide(const QString& programFolder) {
  QDir folder(programFolder);
  for (const char* place : {"guide", "../share/kora/guide"}) {
    const QString page = folder.filePath(QString(place) + "/index.html");
    if (QFileInfo::exists(page)) return QFileInfo(page).canonicalFilePath();
  }
  do {
    const QString page = folder.filePath("docs/guide/index.html");
    if (QFileInfo::exists(page)) return QFileInfo(page).canonicalFilePath();
  } while (folder.cdUp());
  return {};
}

HelpWindow::HelpWindow(const QString& page) {
  setObjectName("Help");
  setWindowTitle("KORA Charting Help");
  setAttribute(Qt::WA_DeleteOnClose);
  setAttribute(Qt::WA_QuitOnClose, false);
  auto* browser = new QTextBrowser(this);
  browser->setObjectName("Text1");
  browser->setOpenExternalLinks(false);
  browser->setSource(QUrl::fromLocalFile(page));
  setCentralWidget(browser);
  auto* bar = addToolBar("Pages");
  bar->setMovable(false);
  const auto add = [&](const char* caption, QKeySequence::StandardKey key, auto slot) {
    QAction* action = bar->addAction(caption, browser, slot);
    action->setShortcuts(key);
    return action;
  };
  QAction* back = add("&Back", QKeySequence::Back, &QTextBrowser::backward);
  QAction* forward = add("&Forward", QKeySequence::Forward, &QTextBrowser::forward);
  bar->addAction("&Contents", browser, &QTextBrowser::home);
  back->setEnabled(false);
  forward->setEnabled(false);
  connect(browser, &QTextBrowser::backwardAvailable, back, &QAction::setEnabled);
  connect(browser, &QTextBrowser::forwardAvailable, forward, &QAction::setEnabled);
  new QShortcut(Qt::Key_Escape, this, [this] { close(); });
  const QSize wanted(fontMetrics().averageCharWidth() * 100, fontMetrics().height() * 36);
  resize(wanted.boundedTo(screen()->availableGeometry().size() * 0.9));
}

}  // namespace kora
