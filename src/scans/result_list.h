#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "base/files.h"

namespace kora {

// A security that a scan found.
struct ResultEntry {
  std::string code;         // any case, blanks around it
  std::int32_t record = 0;  // in the name file
};

// The entries of a scan's hits.
template <typename Hit>
std::vector<ResultEntry> EntriesOf(const std::vector<Hit>& hits) {
  std::vector<ResultEntry> entries;
  for (const Hit& hit : hits) entries.push_back({hit.code, hit.record});
  return entries;
}

// SaveScan: the entries become the list of scan results, SubListZ.Dat, in their order. The file
// is replaced as a whole: a failure leaves the old list. Error 6 for a record number, or for more
// entries, than 16 bits number; HomeIsHeld.
void SaveScan(const Files& files, const std::string& dataPath,
              const std::vector<ResultEntry>& entries);

// The bytes of that list. Error 6 as above.
std::string ResultListBytes(const std::vector<ResultEntry>& entries);

// The question before a scan that was stopped replaces the list, title that of the scan.
inline constexpr std::string_view kStoppedQuestion =
    "The scan was stopped. Store the codes found so far in list Chart Scan Results ?";

}  // namespace kora
