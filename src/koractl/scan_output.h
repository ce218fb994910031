#pragma once

#include <CLI/CLI.hpp>
#include <string>
#include <vector>

#include "base/home_lock.h"
#include "koractl/run.h"
#include "scans/scan_report.h"

// What the commands of the scans share: how they begin, and what they leave.

namespace kora {

// The option --report.
void AddReport(CLI::App& command, std::string& folder);

// An option whose text is that of a field, and ticks the field's box.
CLI::Option* AddTicked(CLI::App& command, const char* name, bool& tick, std::string& value,
                       const char* about);

// Ends the operation with what stands against the choices.
[[noreturn]] void AbandonFault(Run& run, const ScanFault& fault);

// The home's lock for a scan: of two scans at once the second waits, and is refused where the first
// takes too long. HomeIsHeld then, which ends the operation.
inline HomeLock::Held HoldHome(Run& run) { return run.session.files.lock().Hold(); }

// Runs the scan with a progress bar; a failure with the name file is told and ends the operation.
template <typename Scan>
auto Scanned(Run& run, Scan scan) {
  const auto progress = run.dialogs.StartProgress("Checking Data - WAIT");
  try {
    return scan(ScanRun{run.session.files, run.dataPath(), *progress});
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = "Names.dat"});
  }
}

// Stores by `save`; a failure is told and ends the operation.
template <typename Save>
void Stored(Run& run, Save save) {
  try {
    save();
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = "SubListZ.Dat"});
  }
}

// A security on the report, with the oscillator that its chart comes with ("" for none).
struct ReportedChart {
  std::string code;  // ANSI
  std::string oscillator;
};

// Draws the charts and writes FOLDER/index.html; nothing for an empty folder. A chart that can't
// be drawn is told in its place. False where one was not.
bool WriteReport(Run& run, const std::string& folder, ScanReport report,
                 const std::vector<ReportedChart>& charts);

// How a scan leaves its hits.
struct HitsOutput {
  const std::string& report;  // folder, or empty
  std::string_view title;     // of the closing message
  const char* table;          // headings on standard output
  size_t shown;               // so many of a row's cells stand on the report
};
// Prints the hits, whose cells are ANSI with the code first, writes the report that `report`
// begins, and tells `ending`, which stands on a report without rows too. The exit code.
int LeaveHits(Run& run, const HitsOutput& output, ScanReport report,
              const std::vector<std::vector<std::string>>& rows,
              const std::vector<std::string>& oscillators, const std::string& ending,
              const UnreadFiles& unread);

// The cells of all hits.
template <typename Hit>
std::vector<std::vector<std::string>> RowsOf(const std::vector<Hit>& hits) {
  std::vector<std::vector<std::string>> rows;
  for (const Hit& hit : hits) rows.push_back(CellsOf(hit));
  return rows;
}

}  // namespace kora
