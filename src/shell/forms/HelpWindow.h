#pragma once

#include <QMainWindow>
#include <QString>

class QLineEdit;
class QTextBrowser;
class QToolBar;

namespace kora {

// The guide's first page: beside the program, or in the tree that it was built from. Empty when
// there is none.
QString FindGuide(const QString& programFolder);

// The user's guide in a window of its own.
class HelpWindow : public QMainWindow {
 public:
  // `firstPage` as FindGuide gives it. The window goes with `parent`.
  explicit HelpWindow(const QString& firstPage, QWidget* parent = nullptr);

  // A page of the guide by its file's name ("charts.html").
  void ShowPage(const QString& name);

 private:
  void AddFind();
  void Find(bool backward);

  QString folder_;
  QTextBrowser* browser_;
  QToolBar* find_;
  QLineEdit* findText_;
};

}  // namespace kora
