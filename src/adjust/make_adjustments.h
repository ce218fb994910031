#pragma once

#include <functional>
#include <string>
#include <string_view>
#include <vector>

#include "adjust/adjust_list.h"
#include "base/files.h"
#include "platform/dialogs.h"
#include "platform/progress.h"
#include "settings/settings.h"

namespace kora {

struct AdjustRun {
  const Files& files;
  const Settings& settings;
  std::int32_t noteColour;  // ChartColours of the chart's title
  Progress& progress;       // a step a row; kItem: what is being done
  // The row at that place, from 0, was carried out and is marked D in the list.
  std::function<void(size_t row)> rowDone = {};
};

struct AdjustResult {
  bool begun = false;                 // false: no rows, or a service that has no bulletins
  bool stopped = false;               // by the user; what is left stays on the list
  std::vector<std::string> failures;  // "BHP: Disk full"; their rows are marked Y still
};

// MAKE ADJUSTMENTS: carries out the rows marked Y of the list, which is that of `folder`, marks
// them D (but those of new names), and at the end takes the rows marked D off. The list is kept
// anew with every row that changes a file, together with those files: a run that dies is taken up
// by the next one, which does no row twice. Then records that were dropped leave the name file,
// and the chart lists are checked.
//
// Errors: those of keeping the list itself, and 61; what one row meets is told in `failures`.
AdjustResult MakeAdjustments(const AdjustRun& run, AdjustRows& rows, const std::string& folder);

// Where the list is: of service 3 with no Adjust.Lst in the current folder, the folder of shares,
// to which its bulletins go; otherwise the current folder.
std::string AdjustFolder(const Files& files, const Settings& settings);

// Copies Names.dat to Names.bak and leaves out all records with a status.
void CompactNames(const Files& files, const std::string& folder);

// Of service 3: false, with the message, when folders of the whole market are missing.
bool CheckMarketFolders(const Files& files, const Settings& settings, Dialogs& dialogs);

// What is told at the end where rows failed; empty where none did.
std::string FailuresText(const AdjustResult& result);

}  // namespace kora
