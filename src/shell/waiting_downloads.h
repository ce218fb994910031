#pragma once

#include <optional>
#include <string>

#include "base/files.h"
#include "settings/settings.h"

namespace kora {

class Dialogs;

// The question's text when files of the service in use wait in the download folder. Errors 53,
// 75, 76 and others of the host come through.
std::optional<std::string> WaitingDownloads(const Files& files, const DownloadSettings& download);

// Looks for waiting files and asks whether to take them in. True when the user wants to. A
// folder that is missing or can't be read is passed over; another failure is told.
bool AskForWaitingDownloads(const Files& files, const DownloadSettings& download, Dialogs& dialogs);

}  // namespace kora
