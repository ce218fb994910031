#pragma once

#include <QDialog>
#include <functional>
#include <string>

#include "maintenance/note_list.h"

class QListWidget;

namespace kora {

struct TxtDataServices {
  const Files& files;
  Dialogs& dialogs;
  std::string ChartMiscPath;
  std::string code;                    // of the security on show; ANSI
  std::function<void()> refresh = {};  // the chart on show
};

// The texts of the security on show, to remove them.
class TxtData : public QDialog {
 public:
  TxtData(TxtDataServices services, QWidget* parent);

  // Lists the texts. False, and told, where there are none.
  bool Fill();
  void done(int result) override;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void Drop(int row);
  void Refresh();

  TxtDataServices services_;
  NoteList notes_;
  QListWidget* list1_;
};

}  // namespace kora
