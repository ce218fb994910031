#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <string_view>

#include "base/text.h"

namespace kora {

#pragma pack(push, 1)
// One security of a chart list, 8 bytes.
struct ListRec {
  std::int16_t ListRecNo;  // record number in Names.dat, until that is sorted again
  FixedText<6> ListCode;
};
#pragma pack(pop)

static_assert(sizeof(ListRec) == 8 && offsetof(ListRec, ListCode) == 2);

// The letters of the list files in their order; Z holds the results of a scan.
inline constexpr std::string_view kListLetters = "ABCDEFGHJKZ";

// "...\SubListA.Dat" for 'A'.
inline std::string ListFilePath(const std::string& dataPath, char letter) {
  return dataPath + "SubList" + letter + ".Dat";
}

}  // namespace kora
