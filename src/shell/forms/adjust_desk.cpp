#include "shell/forms/adjust_desk.h"

#include "adjust/forms/AdjList.h"
#include "adjust/forms/Adjust.h"

namespace kora {

AdjustServices AdjustDesk::Services() const {
  const Paths& paths = session_.settings.paths;
  return {session_.files, session_.dialogs, paths.CurrentDataPath, paths.ChartMiscPath,
          session_.colours[kChartTitle]};
}

void AdjustDesk::OpenByHand() {
  if (byHand_) {
    byHand_->activateWindow();
    return;
  }
  auto* form = new Adjust({.adjust = Services(),
                           .current = session_.current,
                           .disableMenus = hooks_.disableMenus,
                           .enableMenus = hooks_.enableMenus,
                           .adjusted = hooks_.adjusted},
                          over_);
  form->setAttribute(Qt::WA_DeleteOnClose);
  byHand_ = form;
  try {
    form->Fill();
  } catch (...) {
    delete form;
    throw;
  }
  form->show();
}

void AdjustDesk::OpenList() {
  if (list_) {
    list_->activateWindow();
    return;
  }
  auto* form = new AdjList({.files = session_.files,
                            .settings = session_.settings,
                            .ini = session_.ini,
                            .user = session_.user,
                            .dialogs = session_.dialogs,
                            .noteColour = session_.colours[kChartTitle],
                            .print = hooks_.printTable,
                            .pageSetup = hooks_.pageSetup,
                            .changeSize = hooks_.changeSize,
                            .adjusted = hooks_.adjusted},
                           over_);
  if (!form->Fill()) {
    delete form;
    return;
  }
  list_ = form;
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
}

}  // namespace kora
