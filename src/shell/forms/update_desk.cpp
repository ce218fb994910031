#include "shell/forms/update_desk.h"

#include <utility>

#include "adjust/adjust_list.h"
#include "adjust/bulletins.h"
#include "base/text.h"
#include "platform/qt/modal.h"
#include "store/market_folders.h"
#include "update/forms/DLList.h"
#include "update/forms/ModDetails.h"
#include "update/forms/WMPath.h"

namespace kora {
namespace {

bool SetUp(const DownloadSettings& download) {
  return download.DataService >= 1 && download.DataService <= 5 && !Trim(download.DLPath).empty();
}

}  // namespace

UpdateDesk::UpdateDesk(Session& session, QWidget* over, UpdateDeskHooks hooks)
    : session_(session), over_(over), hooks_(std::move(hooks)) {}

UpdateFormServices UpdateDesk::FormServices(std::function<void()> saved) {
  return {.ini = session_.ini,
          .files = session_.files,
          .dialogs = session_.dialogs,
          .settings = session_.settings,
          .serviceSaved = std::move(saved),
          .pathChosen = hooks_.folderChanged,
          .print = hooks_.printTable};
}

void UpdateDesk::ShowDetails(std::function<void()> saved) {
  if (details_) {
    details_->activateWindow();
    return;
  }
  details_ = new ModDetails(FormServices(std::move(saved)), over_);
  details_->setAttribute(Qt::WA_DeleteOnClose);
  details_->open();
}

void UpdateDesk::OpenDetails() { ShowDetails(hooks_.enableMenus); }

void UpdateDesk::OpenUpdate() {
  if (SetUp(session_.settings.download)) {
    OpenList();
    return;
  }
  ShowDetails([this] {
    hooks_.enableMenus();
    OpenList();
  });
}

void UpdateDesk::OpenList() {
  if (list_) {
    list_->activateWindow();
    return;
  }
  const std::string folder = session_.settings.paths.CurrentDataPath;
  const auto otherFolder = [this, folder] {
    return session_.settings.paths.CurrentDataPath != folder;
  };
  auto* list = new DLList(
      {.files = session_.files,
       .settings = session_.settings,
       .current = session_.current,
       .dialogs = session_.dialogs,
       .clock = session_.clock,
       .disableMenus = hooks_.disableMenus,
       .enableMenus =
           [this, otherFolder] {
             hooks_.enableMenus();
             // A whole-market run leaves the folder on the one to view charts from.
             if (otherFolder()) hooks_.folderChanged();
           },
       .CheckBulletins =
           [this](const std::string& path, const std::string& baseName, Progress& progress) {
             AdjustListGrew_ |=
                 CheckBulletins(session_.files, session_.settings, path, baseName, progress) > 0;
           }},
      over_);
  list->setAttribute(Qt::WA_DeleteOnClose);
  list_ = list;
  if (!list->Fill()) {
    delete list;
    return;
  }
  QObject::connect(list, &QDialog::finished, over_, [this, otherFolder] {
    if (!otherFolder()) hooks_.updated();
    OfferAdjustments();
  });
  list->open();
}

void UpdateDesk::OfferAdjustments() {
  if (!std::exchange(AdjustListGrew_, false)) return;
  const Settings& settings = session_.settings;
  std::string folder;
  if (settings.download.DataService == 1) folder = settings.paths.CurrentDataPath;
  if (settings.download.DataService == 3)
    folder = Trim(ReadWmPaths(session_.files, settings.paths.SystemPath)[kWmAsx]);
  if (folder.empty() || !session_.files.CheckFile(AdjustListPath(folder))) return;
  session_.dialogs.Message(kAdjustListGrew, kAdjustListGrewTitle);
  if (hooks_.openAdjustments) hooks_.openAdjustments();
}

bool UpdateDesk::OpenDestinations(QWidget* over) {
  const std::string before = session_.settings.paths.CurrentDataPath;
  Modal<WMPath> form(FormServices(), over);
  return form.Run() && session_.settings.paths.CurrentDataPath != before;
}

}  // namespace kora
