#include "shell/forms/maintenance_desk.h"

#include <QDialog>
#include <memory>

#include "maintenance/forms/ADTotals.h"
#include "maintenance/forms/ASXChg.h"
#include "maintenance/forms/ChartBak.h"
#include "maintenance/forms/DataEntry.h"
#include "maintenance/forms/DataStat.h"
#include "maintenance/forms/MoveFiles.h"
#include "maintenance/forms/NameData.h"
#include "maintenance/forms/RemDate.h"
#include "maintenance/forms/TextData.h"
#include "maintenance/forms/TextFull.h"

namespace kora {

MaintenanceServices MaintenanceDesk::Services() const {
  return {.files = session_.files,
          .dialogs = session_.dialogs,
          .settings = session_.settings,
          .changed = hooks_.changed,
          .folderChanged = hooks_.folderChanged,
          .print = hooks_.printTable};
}

template <typename Form, typename... Args>
void MaintenanceDesk::Open(const std::function<bool(Form&)>& fill, Args... args) {
  if (form_) {
    form_->activateWindow();
    return;
  }
  auto form = std::make_unique<Form>(Services(), args..., over_);
  if (fill && !fill(*form)) return;
  form->setAttribute(Qt::WA_DeleteOnClose);
  form_ = form.get();
  form.release()->open();
}

void MaintenanceDesk::OpenEntry() {
  Open<DataEntry>([](DataEntry& form) { return form.Fill(); });
}
void MaintenanceDesk::OpenCodeChange() { Open<ASXChg>({}); }
void MaintenanceDesk::OpenMove() { Open<MoveFiles>({}); }
void MaintenanceDesk::OpenDataCheck() {
  Open<DataStat>({});
  if (auto* form = dynamic_cast<DataStat*>(form_.data())) form->Begin();
}
void MaintenanceDesk::OpenNameCheck() { Open<NameData>({}); }
void MaintenanceDesk::OpenTotals() {
  Open<ADTotals>([](ADTotals& form) { return form.Fill(); });
}
void MaintenanceDesk::OpenBackup() {
  Open<ChartBak>([](ChartBak& form) { return form.Fill(); }, ChartBak::Way::kBackup);
}
void MaintenanceDesk::OpenRestore() {
  Open<ChartBak>([](ChartBak& form) { return form.Fill(); }, ChartBak::Way::kRestore);
}
void MaintenanceDesk::OpenCloses() { Open<TextData>({}); }
void MaintenanceDesk::OpenHistory() {
  Open<TextFull>([](TextFull& form) { return form.Fill(); });
}
void MaintenanceDesk::OpenRemoveDate() { Open<RemDate>({}); }

}  // namespace kora
