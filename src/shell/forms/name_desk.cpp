#include "shell/forms/name_desk.h"

#include <QDialog>

#include "lists/forms/IndClass.h"
#include "names/forms/NameForm.h"

namespace kora {
namespace {

// True when the form stands already: it comes to the front.
bool Stands(const QPointer<QDialog>& form) {
  if (form) form->activateWindow();
  return form;
}

}  // namespace

NameDesk::NameDesk(Session& session, QWidget* over, NameDeskHooks hooks)
    : session_(session), over_(over), hooks_(std::move(hooks)) {}

void NameDesk::Show(QPointer<QDialog>& place, QDialog* form) {
  place = form;
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
}

void NameDesk::OpenNames() {
  if (Stands(names_)) return;
  auto* form = new NameForm({.files = session_.files,
                             .settings = session_.settings,
                             .ini = session_.ini,
                             .user = session_.user,
                             .dialogs = session_.dialogs,
                             .clock = session_.clock,
                             .print = hooks_.printTable,
                             .pageSetup = hooks_.pageSetup,
                             .saved = hooks_.namesChanged},
                            over_);
  if (!form->Fill()) {
    delete form;
    return;
  }
  Show(names_, form);
}

void NameDesk::OpenClasses() {
  if (Stands(classes_)) return;
  auto* form = new IndClass(session_.files, session_.dialogs, session_.settings.paths.SystemPath,
                            over_, IndClass::Use::kEdit, &session_.user);
  form->SetZoom(session_.settings.Zoom);
  form->changeSize = hooks_.changeSize;
  Show(classes_, form);
}

}  // namespace kora
