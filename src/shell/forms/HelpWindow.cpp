#include "shell/forms/HelpWindow.h"

#include <QAction>
#include <QDir>
#include <QFileInfo>
#include <QLineEdit>
#include <QScreen>
#include <QShortcut>
#include <QTextBrowser>
#include <QTextCursor>
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

HelpWindow::HelpWindow(const QString& firstPage, QWidget* parent)
    : QMainWindow(parent, Qt::Window),
      folder_(QFileInfo(firstPage).absolutePath()),
      browser_(new QTextBrowser(this)) {
  setObjectName("Help");
  setWindowTitle("KORA Charting Help");
  setAttribute(Qt::WA_DeleteOnClose);
  setAttribute(Qt::WA_QuitOnClose, false);
  browser_->setObjectName("Text1");
  browser_->setOpenExternalLinks(false);
  browser_->setSource(QUrl::fromLocalFile(firstPage));
  setCentralWidget(browser_);
  auto* bar = addToolBar("Pages");
  bar->setMovable(false);
  const auto add = [&](const char* caption, QKeySequence::StandardKey key, auto slot) {
    QAction* action = bar->addAction(caption, browser_, slot);
    action->setShortcuts(key);
    return action;
  };
  QAction* back = add("&Back", QKeySequence::Back, &QTextBrowser::backward);
  QAction* forward = add("&Forward", QKeySequence::Forward, &QTextBrowser::forward);
  bar->addAction("&Contents", browser_, &QTextBrowser::home);
  back->setEnabled(false);
  forward->setEnabled(false);
  connect(browser_, &QTextBrowser::backwardAvailable, back, &QAction::setEnabled);
  connect(browser_, &QTextBrowser::forwardAvailable, forward, &QAction::setEnabled);
  browser_->setAccessibleName("Page of the guide");
  AddFind();
  new QShortcut(Qt::Key_Escape, this, [this] {
    if (find_->isVisible()) {
      find_->hide();
      browser_->setFocus();
    } else {
      close();
    }
  });
  const QSize wanted(fontMetrics().averageCharWidth() * 100, fontMetrics().height() * 36);
  resize(wanted.boundedTo(screen()->availableGeometry().size() * 0.9));
}

void HelpWindow::ShowPage(const QString& name) {
  browser_->setSource(QUrl::fromLocalFile(folder_ + "/" + name));
}

void HelpWindow::AddFind() {
  find_ = new QToolBar("Find", this);
  find_->setObjectName("FindBar");
  find_->setMovable(false);
  findText_ = new QLineEdit(find_);
  findText_->setObjectName("Text2");
  findText_->setAccessibleName("Find on this page");
  findText_->setPlaceholderText("Find on this page");
  find_->addWidget(findText_);
  QAction* next = find_->addAction("Find &Next", this, [this] { Find(false); });
  next->setShortcuts(QKeySequence::FindNext);
  QAction* previous = find_->addAction("Find &Previous", this, [this] { Find(true); });
  previous->setShortcuts(QKeySequence::FindPrevious);
  addToolBar(Qt::BottomToolBarArea, find_);
  find_->hide();
  connect(findText_, &QLineEdit::returnPressed, this, [this] { Find(false); });
  new QShortcut(QKeySequence::Find, this, [this] {
    find_->show();
    findText_->setFocus();
    findText_->selectAll();
  });
}

// From the last find on, and once more from the far end. The box turns red where there is none.
void HelpWindow::Find(bool backward) {
  const auto flags = backward ? QTextDocument::FindBackward : QTextDocument::FindFlags();
  const QString text = findText_->text();
  bool found = !text.isEmpty() && browser_->find(text, flags);
  if (!found && !text.isEmpty()) {
    const QTextCursor before = browser_->textCursor();
    browser_->moveCursor(backward ? QTextCursor::End : QTextCursor::Start);
    found = browser_->find(text, flags);
    if (!found) browser_->setTextCursor(before);
  }
  QPalette colours;
  if (!found && !text.isEmpty()) {
    colours.setColor(QPalette::Base, QColor(0xB0, 0x20, 0x20));
    colours.setColor(QPalette::Text, Qt::white);
  }
  findText_->setPalette(colours);
}

}  // namespace kora
