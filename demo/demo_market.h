#pragma once

#include <cstdint>

#include "base/files.h"
#include "platform/dialogs.h"
#include "platform/settings_file.h"

namespace kora {

struct DemoOptions {
  int securities = 60;  // name records: shares, indices, warrants and the rest; 5 to 5000
  int years = 6;        // of history; 1 to 40
  std::uint64_t seed = 1;
};

// Writes an installation with an invented market into the home of `files`: settings, name file,
// price files, industry classes, two chart lists, a compare file, and download files of the
// three trading days after the last record. The same options give the same bytes on every
// machine; the last day of the history is always 30 October 2026.
//
// False when the user stopped it. Errors: 5 for options out of range; 75 where the home already
// has a settings file, a name file or price files, before anything is written; those of the
// host when writing fails. After a stop or an error no file of the market is left.
bool MakeDemo(Files& files, SettingsFile& ini, SettingsFile& user, Dialogs& dialogs,
              const DemoOptions& options);

}  // namespace kora
