#include "shell/forms/scan_desk.h"

#include "base/numbers.h"
#include "lists/chart_list.h"
#include "scans/forms/ChtScan2.h"
#include "scans/forms/ChtScan3.h"
#include "scans/forms/Statistics.h"
#include "scans/forms/chtScan1.h"

namespace kora {

ScanDesk::ScanDesk(Session& session, QWidget* over, ScanDeskHooks hooks)
    : session_(session), over_(over), hooks_(std::move(hooks)) {}

ScanFormServices ScanDesk::FormServices() {
  return {.files = session_.files,
          .dialogs = session_.dialogs,
          .settings = session_.settings,
          .user = session_.user,
          .scanning = scanning_,
          .disableMenus = hooks_.disableMenus,
          .enableMenus = hooks_.enableMenus,
          .print = hooks_.printTable,
          .pageSetup = hooks_.textPage,
          .openResult = [this](std::int16_t place) { hooks_.showChart(kResultList, place); },
          .openRecord =
              [this](std::int32_t record) { hooks_.showChart(kFullList, CInt(double(record))); }};
}

// The window stays in use beside the form: its charts are what the hits lead to.
template <typename Make>
void ScanDesk::Open(QPointer<QDialog>& form, Make make) {
  if (form) {
    form->raise();
    form->activateWindow();
    return;
  }
  form = make();
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->show();
}

void ScanDesk::OpenScan1() {
  Open(scan1_, [this] { return new chtScan1(FormServices(), over_); });
}
void ScanDesk::OpenScan2() {
  Open(scan2_, [this] { return new ChtScan2(FormServices(), over_); });
}
void ScanDesk::OpenScan3() {
  Open(scan3_, [this] { return new ChtScan3(FormServices(), over_); });
}
void ScanDesk::OpenStats() {
  Open(stats_, [this] { return new Statistics(FormServices(), session_.clock, over_); });
}

void ScanDesk::FolderChanged() {
  if (scanning_) return;
  for (QDialog* form : {scan1_.data(), scan2_.data(), scan3_.data(), stats_.data()}) delete form;
}

}  // namespace kora
