#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "settings/settings.h"

namespace kora {

// What the folder chooser is asked for.
struct LocateCase {
  std::string purpose;  // "Charting Data File Folder"
  std::string start;    // folder it opens on
};
// By caller ("CPath") and index; nothing for a pair that no form uses.
std::optional<LocateCase> LocateFor(std::string_view caller, int index, const Paths& paths);

// Drives that can be read, "C:" first where it is there.
std::vector<std::string> Drives(const Files& files);

// The folders in `folder`, without their path; empty where it can't be read.
std::vector<std::string> SubFolders(const Files& files, std::string_view folder);

// `folder` with a closing "\", or the nearest folder above it that is there; the drive's root
// at the end. Empty for a text without a drive.
std::string NearestFolder(const Files& files, std::string_view folder);

// The folder that holds `folder`; a root is its own.
std::string ParentFolder(std::string_view folder);

}  // namespace kora
