#pragma once

#include <string>

#include "base/files.h"
#include "platform/settings_file.h"
#include "settings/settings.h"

namespace kora {

// How a home becomes an installation. The settings file comes last: it is what makes a folder an
// installation, so that one that was broken off is none, and is made by the next try. What is
// there already is never emptied. Errors are those of the host; each holds the home's lock.

// The folders of `paths`, and name file and industry classes, empty.
void MakeHomeFolders(const Files& files, const Paths& paths);

// An empty installation with the settings of a new one.
void MakeEmptyHome(const Files& files, SettingsFile& ini);

// Why a DOS folder can't be the data folder of a new installation, in a sentence; empty where it
// can: it has a name file, and its path can be kept as a setting.
std::string WhyNoDataFolder(const Files& files, const std::string& folder);

// An installation whose data folder is one that is there, ending in "\". Nothing in it is changed.
void MakeHomeOver(const Files& files, SettingsFile& ini, const std::string& folder);

}  // namespace kora
