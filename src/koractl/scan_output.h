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

}  // namespace kora
