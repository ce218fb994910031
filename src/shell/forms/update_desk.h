#pragma once

#include <QPointer>
#include <functional>
#include <string>

#include "shell/session.h"
#include "update/forms/update_form.h"

class QDialog;
class QWidget;

namespace kora {

// What the forms of taking data in need of the main window.
struct UpdateDeskHooks {
  std::function<void()> disableMenus, enableMenus;
  // Another data folder was chosen: title, and the forms that show it.
  std::function<void()> folderChanged;
  std::function<void(const TextTable&, QWidget* over)> printTable;
  // The form of an update was left and lines were added to the adjustment list of its folder.
  std::function<void()> openAdjustments;
  // The form of an update was left, and prices of the data folder may have changed.
  std::function<void()> updated;
};

// The forms of taking data in, and what opens them. It lives as long as the main window.
class UpdateDesk {
 public:
  UpdateDesk(Session& session, QWidget* over, UpdateDeskHooks hooks);

  void OpenDetails();  // ModDetails
  // DLList. While no service is set up ModDetails stands in front of it.
  void OpenUpdate();
  // DLList, or the message that nothing waits.
  void OpenList();
  // WMPath over a form, until it is closed. True when another data folder was chosen.
  bool OpenDestinations(QWidget* over);

 private:
  void ShowDetails(std::function<void()> saved);
  UpdateFormServices FormServices(std::function<void()> saved = {});

  Session& session_;
  QWidget* over_;
  UpdateDeskHooks hooks_;
  void OfferAdjustments();

  bool AdjustListGrew_ = false;
  QPointer<QDialog> details_, list_;
};

}  // namespace kora
