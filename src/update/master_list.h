#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "base/text.h"

// The master list: for every code of the markets its type, category, industry class and name.

namespace kora {

class Dialogs;

#pragma pack(push, 1)
// One record of KoraName.Mas, 62 bytes. All behind the code is scrambled in the file.
struct MasterRec {
  FixedText<6> Code;  // upper case
  FixedText<56> Rest;
};
#pragma pack(pop)
static_assert(sizeof(MasterRec) == 62);

// What characters 48 to 122 of a scrambled record stand for. Only digits and letters go through
// it: others, those between them too, stand for themselves.
using MasterTable = std::array<unsigned char, 75>;

// Each character for itself, unless KoraName.Tab stands beside the list: 75 lines, each the
// decimal code of what the next character from 48 on stands for; those of no digit and no
// letter are not looked at. Error 5 for a file that has anything else.
MasterTable LoadMasterTable(const Files& files, const std::string& systemPath);

struct MasterEntry {
  std::string code;
  std::string type;      // one digit
  std::string category;  // up to two digits
  std::string IndClass;  // up to three digits
  std::string name;
  std::string details;
};

struct MasterList {
  std::vector<MasterRec> Records;          // ordered by code, readable
  std::array<std::int32_t, 26> Letters{};  // KoraName.idx: first record of A to Z, 0 none

  // Where the codes that begin with the letter of `code` start; 0 where there is none.
  std::int32_t StartOf(std::string_view code) const;
  MasterEntry Entry(std::int32_t record) const;  // from 1
};

std::string MasterFile(const std::string& systemPath);

// The records alone; fewer than 2 count as none. Error 7 beyond 16 MB.
std::vector<MasterRec> ReadMasterRecords(const Files& files, const std::string& systemPath);
// Both files. Raises where the list or its index can't be read; error 5 for an index without
// 26 numbers.
MasterList ReadMasterList(const Files& files, const std::string& systemPath);

// The entry of a code, looked for from `startRec` on, until the first letter of the records
// goes beyond the code's. Empty when it is not there, or startRec is outside the list.
MasterEntry FindMaster(const MasterList& list, std::string_view code, std::int32_t startRec);

// What `INUpList` shows while there is no master list.
std::span<const std::string_view> MasterMissingLines();
// Where it looks up the entry at `place` of the list that it shows, from 1.
std::int32_t LookUpStart(std::int32_t place);

// ---- Refreshing the name file: form `ExMaster`

// One row of the name file editor.
struct EditorRow {
  std::string code, name, details, type, category, IndClass;
};
// Items that keep what they have: name, details, type, category, class.
using KeepTicks = std::array<bool, 5>;

// Takes what the master list has into the rows. Empty items are filled whatever is ticked. The
// rows stay as they were when the list can't be used, which is told, or the user stops.
bool UpdateFromMaster(const Files& files, const std::string& systemPath, std::span<EditorRow> rows,
                      const KeepTicks& keep, Dialogs& dialogs);

// ---- Making a list

// Makes KoraName.Mas and KoraName.idx from a plain text file, named by its path on the machine:
// lines "code,type,category,class,name,details" under a header that begins with "Code", or
// without one. Fields at the end may be missing; of lines with one code the last holds. A line
// that can't be taken refuses the file, with its number. Returns the number of codes, nothing
// when refused.
std::optional<std::int32_t> MakeMasterList(const Files& files, const std::string& systemPath,
                                           const std::string& hostFile, Dialogs& dialogs);

}  // namespace kora
