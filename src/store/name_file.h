#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "base/file_set.h"
#include "base/files.h"
#include "base/record_file.h"
#include "store/name_rec.h"

namespace kora {

class Dialogs;

using NameFile = RecordFile<NameRec>;

// Names that 16 bits number.
inline constexpr std::int32_t kMostNames = 32767;

// Names.dat of a data folder. It is opened for each operation and closed at once.
std::string NameFilePath(const std::string& dataPath);

// All records, read in one run; empty when the file is not there. Error 6, here and in every
// look-up, when the file has more records than a 16-bit number can name.
std::vector<NameRec> ReadNames(const Files& files, const std::string& dataPath);

// The number of the first record whose six code bytes equal `paddedCode` (six characters,
// compared as given), or 0. Reads the file in runs.
std::int16_t FindCode(const NameFile& names, std::string_view paddedCode, NameRec& found);

struct NameAndClass {
  std::string Name;      // trimmed, UTF-8
  std::string IndClass;  // trimmed
};
// For a title at chart time: the first record whose Code equals the given six bytes, compared
// as given, so that lower case finds nothing. `record` is filled when found; both texts are
// empty when not, or when there is no file.
NameAndClass FindNameByCode(const Files& files, const std::string& dataPath, std::string_view code,
                            NameRec& record);

// The security that stands for every chart routine.
struct CurrentName {
  NameRec Rec{};               // NameRec
  std::int16_t NameRecNo = 0;  // record last found
  std::int16_t NameCount = 0;  // records in the file at the last open
  std::string CurrentCode;
  // The price file within the data folder ("ORE.WDT"); empty when no security was found.
  std::string PriceFileName;
};

// Pads and upper-cases CurrentCode, finds its record and sets PriceFileName to the code
// + ".WDT". Not found, or a code that can name no file (IsFileCode): the message "No File
// For That Name" and an empty PriceFileName; the record last found stays.
// Also returns whether it was found. Errors 53, 75, 76 when Names.dat can't be opened.
bool LocateCurrentCode(const Files& files, const std::string& dataPath, Dialogs& dialogs,
                       CurrentName& current);

// Writes the current security's record in its place, with what `change` does to it; the rest
// stays as the file has it now, and current.Rec becomes what was written. A record that has
// moved meanwhile is found by its code. Error 63 when the security is no longer in the file, or
// none is current; 53, 75, 76 when the file can't be opened, 70 (HomeIsHeld) while another program
// writes the store.
void RewriteCurrentName(const Files& files, const std::string& dataPath, CurrentName& current,
                        const std::function<void(NameRec&)>& change);

enum class NameSort {
  kCategory,  // Category "000", RecType, Code: the order after a save
  kCode,
  kIndClass,  // IndClass, then Code
};

// Sorts record numbers by their 12-character keys: a Shell sort whose equal keys may change
// places, which is why it is this one and no other.
struct SortEntry {
  std::int32_t RecNo;
  std::string Key;
};
void ShellSort(std::vector<SortEntry>& items);
std::string SortKey(const NameRec& record, NameSort mode);

// The records in sorted order, those with NameStatus 1 left out.
std::vector<NameRec> SortedNames(std::span<const NameRec> records, NameSort mode);

// Replaces a name file as a whole. Error 6 for more records than 16 bits number.
void WriteNames(const Files& files, const std::string& path, std::span<const NameRec> records);

// Sorts the file, dropping records with NameStatus 1. With fewer than two records the file is
// left as it is. A failure leaves the old file. Error 70 (HomeIsHeld) while another program writes
// the store.
void SortNameFile(const Files& files, const std::string& dataPath, NameSort mode);

// The editor's sort of its own copy, Temp.Wk2.
void SortEditorCopy(const Files& files, const std::string& dataPath, NameSort mode);

// What is wrong with a row of the editor, or nothing.
struct RowFault {
  size_t row;           // from 0
  std::string message;  // "Code must be entered", "Record Type must be entered"
};
// Checks the rows as the editor does before a save and resets a Category outside 0 to 99 to 0.
// A row that is blank altogether has no fault.
std::optional<RowFault> CheckRows(std::span<NameRec> rows);

// Saves the editor's rows: names.bak is taken from names.DAT, the file made anew with
// NameStatus 0 and MinMove 0.05, rows with a blank code left out, sorted by category. Messages
// as they come; a failing write leaves the old names.DAT. True when saved. `beside` adds what goes
// by the records' numbers, which changes with the file or not at all.
using StageBesideNames = std::function<void(FileSet&, std::span<const NameRec>)>;
bool SaveNames(const Files& files, const std::string& dataPath, std::span<const NameRec> rows,
               Dialogs& dialogs, const StageBesideNames& beside = {});

}  // namespace kora
