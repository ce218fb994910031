#include "shell/forms/company_desk.h"

#include "companies/forms/ChtSnap.h"
#include "companies/forms/Fundmnt.h"

namespace kora {

CompanyDesk::CompanyDesk(Session& session, QWidget* over, CompanyDeskHooks hooks)
    : session_(session), over_(over), hooks_(std::move(hooks)) {}

CompanyFormServices CompanyDesk::Services() const {
  return {.files = session_.files,
          .settings = session_.settings,
          .dialogs = session_.dialogs,
          .user = session_.user,
          .print = hooks_.printTable,
          .namesChanged = hooks_.namesChanged,
          .changeSize = hooks_.changeSize,
          .currentCode = [this] { return std::string(session_.current.Rec.Code.trimmed()); }};
}

void CompanyDesk::OpenCompanies() {
  if (companies_) {
    companies_->activateWindow();
    return;
  }
  auto* form = new Fundmnt(Services(), over_);
  if (!form->Fill()) {
    delete form;
    return;
  }
  companies_ = form;
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
}

void CompanyDesk::OpenSnapshot() {
  if (snapshot_) {
    snapshot_->activateWindow();
    return;
  }
  auto* form =
      new ChtSnap({.snapshot = {session_.files, session_.settings.paths, session_.settings.download,
                                session_.dialogs, session_.processes, session_.clock},
                   .settings = session_.settings,
                   .user = session_.user,
                   .print = hooks_.printTable,
                   .pageSetup = hooks_.pageSetup,
                   .changeSize = hooks_.changeSize},
                  over_);
  snapshot_ = form;
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
}

bool CompanyDesk::CanShowStock() const {
  const std::int16_t service = session_.settings.download.DataService;
  return (service == 1 || service == 3) &&
         KoraDetailsReady(session_.files, session_.settings.download);
}

void CompanyDesk::ShowStock(const std::string& code, QWidget* over) {
  if (!stock_) {
    auto* form = new StockInf(Services(), over);
    if (!form->Fill()) {
      delete form;
      return;
    }
    stock_ = form;
    form->setAttribute(Qt::WA_DeleteOnClose);
  }
  stock_->Show(code);
  stock_->show();
  stock_->activateWindow();
}

}  // namespace kora
