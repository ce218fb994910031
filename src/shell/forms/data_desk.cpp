#include "shell/forms/data_desk.h"

#include "base/text.h"
#include "maintenance/forms/DataForm.h"
#include "maintenance/forms/EnterCode.h"

namespace kora {
namespace {

// At the upper left corner of `window`.
void Open(EnterCode* form, const QWidget* window) {
  form->setAttribute(Qt::WA_DeleteOnClose);
  try {
    form->Fill();
  } catch (...) {
    delete form;
    throw;
  }
  form->open();
  form->move(window->mapToGlobal(QPoint(0, 0)));
}

}  // namespace

void DataDesk::OpenData() {
  if (codes_) {
    codes_->activateWindow();
    return;
  }
  auto* form = new EnterCode(
      {.files = session_.files,
       .dataPath = session_.settings.paths.CurrentDataPath,
       .dialogs = session_.dialogs,
       .lastIndex = lastIndex_,
       .view = [this](const CodeSelection& selection, QWidget* over) { View(selection, over); }},
      over_);
  codes_ = form;
  Open(form, over_);
}

void DataDesk::OpenCodes(QWidget* over, std::function<void(const std::string& code)> select) {
  auto* form = new EnterCode({.files = session_.files,
                              .dataPath = session_.settings.paths.CurrentDataPath,
                              .dialogs = session_.dialogs,
                              .lastIndex = lastIndex_,
                              .select = std::move(select)},
                             over);
  Open(form, over_);
}

void DataDesk::View(const CodeSelection& selection, QWidget* over) {
  if (data_) return;  // another is being read
  over_->raise();
  auto* form = new DataForm({.files = session_.files,
                             .settings = session_.settings,
                             .user = session_.user,
                             .dialogs = session_.dialogs,
                             .print = hooks_.printTable,
                             .pageSetup = hooks_.pageSetup,
                             .changeSize = hooks_.changeSize,
                             .saved = hooks_.pricesChanged},
                            {.code = FromAnsi(selection.CurrentCode()),
                             .name = selection.Name(),
                             .path = selection.CurrentDataFile(),
                             .RecType = selection.RecType()},
                            over);
  data_ = form;
  const bool shown = form->Fill();
  if (!data_) return;
  if (!shown) {
    delete form;
    return;
  }
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
}

}  // namespace kora
