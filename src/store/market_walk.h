#pragma once

#include <cstdint>
#include <functional>
#include <limits>
#include <memory>
#include <span>
#include <string>
#include <string_view>

#include "base/files.h"
#include "platform/progress.h"
#include "store/name_rec.h"
#include "store/price_rec.h"

// One pass over the market: every security of the name file in the order of the file, each with
// the last records of its price file. Scans, statistics, checks, exports and the no-trade pass
// are this walk with what they do at each security.

namespace kora {

inline constexpr std::int32_t kWholeFile = std::numeric_limits<std::int32_t>::max();

// What is done at each security besides being there.
struct WalkPlan {
  // Records to read from the end of each price file, in one read; fewer where the file has fewer.
  // 0: price files are not opened, and nothing counts as unread. kWholeFile: all of them.
  std::int32_t records = 0;
  // A file with fewer records than this is passed over as unread.
  std::int32_t fewest = 1;
  // Pass over, as unread, a file whose records read hold a price that is no number, or no price
  // but 0 at all.
  bool soundPrices = false;
  // Files are read in groups before their securities are visited, on a second thread where that
  // can be. False for a visitor that writes price files: each is read right before its visit.
  bool ahead = true;
};

// A security in hand. All of it is valid during the visit alone.
struct MarketItem {
  std::int32_t number;                // its record in the name file, from 1
  const NameRec& name;                // as the file has it
  std::string_view code;              // trimmed, as the file has it
  std::int32_t count;                 // records in the price file, 0 where the plan reads none
  std::span<const PriceRec> records;  // the last ones of the file, oldest first

  // Number of records[0] in the price file.
  std::int32_t first() const { return count - std::int32_t(records.size()) + 1; }
};

// Price files that were wanted and passed over, by what was wrong.
struct UnreadFiles {
  std::int32_t missing = 0;   // not there, or a code that can name no file
  std::int32_t refused = 0;   // can't be opened or read; more records than 32,767
  std::int32_t torn = 0;      // the last record is cut short
  std::int32_t tooShort = 0;  // fewer records than the plan wants
  std::int32_t unsound = 0;   // prices that are no numbers, or none but 0

  std::int32_t total() const { return missing + refused + torn + tooShort + unsound; }
};
// "3 files could not be read"; empty for none.
std::string UnreadText(const UnreadFiles& unread);

// The walk takes memory for some files at a time, whatever the number of securities.
//
// Everything that the caller gives (progress, `wants`, `visit`) is called from the thread that
// calls Run, in the order of the file. Where the host's calls may come from any thread
// (Io::AnyThread), a second thread reads price files ahead meanwhile, with Files of its own;
// otherwise the calling thread reads them itself, with the same outcome. `wants` is asked some
// securities ahead of the visit.
//
// The name file is opened once: a walk sees the names as they stood when it began. A price file
// that changes during the walk is seen as it was at some moment before its visit.
class MarketWalk {
 public:
  // Opens the name file of the data folder. A missing one is an empty market. Errors 75, 76 and
  // those of the host when it can't be opened.
  MarketWalk(const Files& files, std::string dataPath);
  ~MarketWalk();
  MarketWalk(const MarketWalk&) = delete;
  MarketWalk& operator=(const MarketWalk&) = delete;

  // Securities in the name file. A walk goes beyond the 32,767 that a 16-bit number names; who
  // keeps record numbers in 16 bits refuses those himself.
  std::int32_t count() const;

  using Wants = std::function<bool(const NameRec& name)>;
  using Visit = std::function<void(const MarketItem& item)>;

  // Visits each security that `wants` accepts (none given: all) and whose price file could be
  // read as the plan says. Progress has a step for each that is wanted, before its visit, and
  // one at the end, of count() steps; its kItem line is the number and the code.
  //
  // Returns false when the user stopped it: securities visited until then were visited whole. A
  // price file that can't be read does not end the walk (unread()). Errors: 63 and those of the
  // host when the name file can't be read on, 7, and what `wants` or `visit` raise.
  bool Run(const WalkPlan& plan, Progress& progress, const Wants& wants, const Visit& visit);

  // Of the last Run, as far as it came.
  const UnreadFiles& unread() const { return unread_; }

 private:
  class Names;

  const Files& files_;
  std::string dataPath_;
  std::unique_ptr<Names> names_;
  UnreadFiles unread_;
};

}  // namespace kora
