#include "update/forms/update_form.h"

#include "base/runtime_error.h"
#include "update/download_list.h"

namespace kora {

bool SaveOrTell(Dialogs& dialogs, const QString& title, const std::function<bool()>& save) {
  try {
    return save();
  } catch (const RunTimeError& e) {
    dialogs.Message(DownloadErrorText(e), title.toStdString());
    return false;
  }
}

}  // namespace kora
