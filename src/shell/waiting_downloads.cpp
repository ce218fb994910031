#include "shell/waiting_downloads.h"

#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Downloaded Data";

const char* QuestionFor(int service) {
  switch (service) {
    case 1:
    case 3: return " There are some KORA/Tarvo files to update into KORA";
    case 2: return " There are some BOURSE files to update into KORA";
    case 4: return " There are some Ex Internet data files to update into KORA";
    case 5: return " There are some EIS downloaded files to update into KORA";
    default: return nullptr;
  }
}

}  // namespace

std::optional<std::string> WaitingDownloads(const Files& files, const DownloadSettings& download) {
  const char* question = QuestionFor(download.DataService);
  if (!question || Trim(download.DLPath).empty()) return std::nullopt;
  // Internet data may come under its own ending and is renamed when it is taken in.
  const bool asx = download.DataService == 4 && EndsNoCase(download.InternetDLfmt, ".ASX");
  for (const std::string& name : files.List(WithBackslash(download.DLPath))) {
    const auto is = [&name](std::string_view ending) {
      return name.size() > ending.size() && EndsNoCase(name, ending);
    };
    if (is(".d") || (asx && is(".asx"))) return question;
  }
  return std::nullopt;
}

bool AskForWaitingDownloads(const Files& files, const DownloadSettings& download,
                            Dialogs& dialogs) {
  try {
    const auto question = WaitingDownloads(files, download);
    return question && dialogs.Ask(*question, kTitle, Buttons::kOkCancel) == Answer::kOk;
  } catch (const RunTimeError& e) {
    if (e.number() != kFileNotFound && e.number() != kPathAccess && e.number() != kPathNotFound)
      dialogs.Message(
          "Error while checking for KORATarvo download files not updated into KORA \n"
          "Check download paths and/or Modify Download Details ",
          kTitle);
    return false;
  }
}

}  // namespace kora
