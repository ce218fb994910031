#include "update/forms/update_form.h"

#include <QLineEdit>

#include "base/runtime_error.h"
#include "platform/qt/form_parts.h"
#include "settings/forms/Locate.h"
#include "update/download_list.h"
#include "update/download_settings.h"

namespace kora {

QToolButton* NewLocateButton(const UpdateFormServices& services, const QString& name,
                             QLineEdit* box, std::function<LocateCase()> what, QWidget* form) {
  return NewFolderButton(
      form, name,
      [&files = services.files, &dialogs = services.dialogs, box, what = std::move(what), form] {
        auto* locate = new Locate(
            files, dialogs, what(),
            [box](const std::string& folder) { box->setText(ToQt(folder)); }, form);
        locate->setAttribute(Qt::WA_DeleteOnClose);
        locate->open();
      });
}

QToolButton* NewDestinationButton(const UpdateFormServices& services, int index, QLineEdit* box,
                                  QWidget* form) {
  return NewLocateButton(
      services, QString("Picture1(%1)").arg(index), box,
      [&files = services.files, &paths = services.settings.paths, index] {
        return WizardLocate(ReadWmPaths(files, paths.SystemPath), index, paths);
      },
      form);
}

bool SaveOrTell(Dialogs& dialogs, const QString& title, const std::function<bool()>& save) {
  try {
    return save();
  } catch (const RunTimeError& e) {
    dialogs.Message(DownloadErrorText(e), title.toStdString());
    return false;
  }
}

}  // namespace kora
