#pragma once

#include <QPointer>
#include <functional>

#include "adjust/issue_adjustment.h"
#include "lists/text_print_out.h"
#include "shell/session.h"

class QDialog;
class QWidget;

namespace kora {

// What the forms of adjustments need of the main window.
struct AdjustDeskHooks {
  std::function<void()> disableMenus, enableMenus;
  std::function<void(const TextTable&, QWidget* over)> printTable;
  std::function<void(QWidget* over)> pageSetup;
  std::function<int(QWidget* over)> changeSize;
  // Prices and names of the data folder may have changed.
  std::function<void()> adjusted;
};

// The forms of adjustments, and what opens them. It lives as long as the main window.
class AdjustDesk {
 public:
  AdjustDesk(Session& session, QWidget* over, AdjustDeskHooks hooks)
      : session_(session), over_(over), hooks_(std::move(hooks)) {}

  // Where adjustments work now: folders and colour are those of the settings.
  AdjustServices Services() const;

  void OpenByHand();  // Adjust
  void OpenList();    // AdjList

 private:
  Session& session_;
  QWidget* over_;
  AdjustDeskHooks hooks_;
  QPointer<QDialog> byHand_, list_;
};

}  // namespace kora
