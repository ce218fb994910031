#pragma once

#include <QMainWindow>
#include <QString>

namespace kora {

// The guide's first page: beside the program, or in the tree that it was built from. Empty when
// there is none.
QString FindGuide(const QString& programFolder);

// The user's guide in a window of its own.
class HelpWindow : public QMainWindow {
 public:
  explicit HelpWindow(const QString& page);
};

}  // namespace kora
