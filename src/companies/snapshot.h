#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "platform/clock.h"
#include "platform/dialogs.h"
#include "platform/processes.h"
#include "settings/settings.h"

// The market snapshot: lists of up to 15 securities with today's prices, fetched by the sibling
// comms program, and what the user holds of them.
//
// Files of the program folder: Snapshot.Dat, Snap2.Dat, Snap3.Dat, a security a line,
//
//   code,kind,units,unit cost,dividend
//
// Files of the download system folder: the request Snap.Snd ("S,BHP" for a stock, "I,XAO" for an
// index), the answer Snap.Lst ("BHP,last,bid,ask,close,volume,trade,today"), Comm.Stt, emptied
// for the comms program to write its state into, and Snap.Lct ("list,accesses today,yyyymmdd").

namespace kora {

inline constexpr int kSnapshotLists = 3;
inline constexpr size_t kMostSnapshotRows = 15;
inline constexpr std::string_view kSnapshotTitle = "Current Snapshot";

struct SnapshotRow {
  std::string code;
  char kind = 'S';          // "S" stock or "I" index
  std::string units, cost;  // what is held and what one cost, as typed; empty: nothing held
  std::string dividend;     // dollars a unit and year, as typed
  // Of the answer, as it came: last, bid, ask, close, volume, trade, today.
  std::array<std::string, 7> prices;
};

// "Snapshot.Dat", "Snap2.Dat" or "Snap3.Dat" of the program folder, for 1 to 3. Error 5 for
// another number.
std::string SnapshotFile(const std::string& systemPath, int list);
// Without prices. Lines without a code are left out, and what is behind the 15th row; no file is
// an empty list. Errors of reading; 7 beyond 1 MB.
std::vector<SnapshotRow> ReadSnapshot(const Files& files, const std::string& systemPath, int list);
// `SaveList`: replaces the file as a whole; rows without a code are left out.
void SaveSnapshot(const Files& files, const std::string& systemPath, int list,
                  const std::vector<SnapshotRow>& rows);

// The message for a typed number that is none, and for a row beyond the 15th.
inline constexpr std::string_view kSnapMustBeNumeric = "Must be numeric";
inline constexpr std::string_view kTooManyRows = "Maximum number of stocks for snapshot is 15";

struct SnapshotServices {
  const Files& files;
  const Paths& paths;
  const DownloadSettings& download;
  Dialogs& dialogs;
  Processes& processes;
  const Clock& clock;
};

// How often prices were fetched today; 0 from the midnight of the machine's clock on.
int SnapshotAccesses(const SnapshotServices& services);

// `FetchSnapshot`: writes the request, starts Quickcomm.exe of the download system folder and
// waits for it, then reads the answer into the rows. Messages as they come: an empty list, too
// many rows, a program that is not there or fails, no answer. `idle` runs while it waits, and
// may give up: then the answer is not read, and the program is left to itself. True when rows
// were filled.
bool FetchSnapshot(const SnapshotServices& services, int list, std::vector<SnapshotRow>& rows,
                   const std::function<bool()>& idle = {});

// `UpdateGrid`: puts the answer's prices into the rows with their codes; the others stay. Lines
// with fewer columns fill what they have, columns beyond are passed over. The number of rows
// filled.
int UpdateGrid(std::string_view answer, std::vector<SnapshotRow>& rows);

// What is held of one security, at the last and at the previous close. Dollars.
struct Holding {
  double units = 0, cost = 0;           // of a unit
  double price = 0, previous = 0;       // last price, close of the day before
  double previousValue = 0, value = 0;  // of all units
  double gain = 0;                      // value less cost of all units; 0 before there is a price
  double dividends = 0;                 // of a year
};
// Nothing where no units are held.
std::optional<Holding> HoldingOf(const SnapshotRow& row);
// Sums of values, gains and dividends; price, cost and units stay 0.
Holding Totals(const std::vector<SnapshotRow>& rows);

}  // namespace kora
