#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>
#include <unordered_map>
#include <vector>

#include "base/file_set.h"
#include "base/files.h"
#include "base/text.h"
#include "store/name_rec.h"

// Chart lists: subsets of the name file, paged through in the chart window in list order. Ten
// are the user's; one holds the results of the scans.

namespace kora {

class SettingsFile;

// Values of ChartListNo.
enum ChartListNumber : std::int16_t {
  kFullList = 1,  // all of Names.dat, no list
  kFirstChartList = 2,
  kLastUserList = 11,
  kResultList = 12,
};
inline constexpr int kUserLists = kLastUserList - kFirstChartList + 1;

#pragma pack(push, 1)
// One record of a list file, 8 bytes, little-endian. The record number is the one that the code
// had in Names.dat when the list was last saved or checked; the chart walk trusts it.
struct ListRec {
  std::int16_t ListRecNo;
  FixedText<6> ListCode;  // upper case, blank padded
};
#pragma pack(pop)
static_assert(sizeof(ListRec) == 8);
static_assert(offsetof(ListRec, ListRecNo) == 0 && offsetof(ListRec, ListCode) == 2);

// "SubListA.Dat" to "SubListH.Dat", "SubListJ.Dat", "SubListK.Dat", "SubListZ.Dat" for 2 to 12.
// Error 5 for any other number.
std::string ListFileName(std::int16_t ChartListNo);
std::string ListFilePath(const std::string& dataPath, std::int16_t ChartListNo);

// ---- Names under which the lists show

// The name kept in the per-user store, "Chart List A" and so on where there is none;
// "Chart Scan Results" for list 12. Error 5 for any other number.
std::string ChartListName(const SettingsFile& user, std::int16_t ChartListNo);
// Of lists 2 to 11.
using UserListNames = std::array<std::string, kUserLists>;
UserListNames GetSubLists(const SettingsFile& user);
// Writes the names back; a blank one brings the list's own name back. False when the store
// can't be written.
bool SaveSLNames(SettingsFile& user, const UserListNames& names);

// ---- List files. What writes one holds the home's lock: error 70 (HomeIsHeld) while another
// program writes the store.

// All records as they stand, with stale and impossible record numbers. A torn record at the end
// does not count; no file is an empty list. Error 6 for more records than 16 bits number.
std::vector<ListRec> ReadList(const Files& files, const std::string& dataPath,
                              std::int16_t ChartListNo);
// Replaces the file as a whole. Error 6 for more records than 16 bits number.
void WriteList(const Files& files, const std::string& dataPath, std::int16_t ChartListNo,
               std::span<const ListRec> records);

// The codes of a list as an editor shows them, trimmed; blank ones left out.
using ListCodes = std::vector<std::string>;
ListCodes CodesOf(std::span<const ListRec> records);

// Saves a list: each code with the number of the first record of Names.dat that has it. Blank
// codes and codes that left the name file are dropped; the dropped ones that are not blank are
// returned. The file is replaced as a whole; on an error (53 without a name file) it stays.
ListCodes SaveSubList(const Files& files, const std::string& dataPath, std::int16_t ChartListNo,
                      std::span<const std::string> codes);

// The codes of a name file with the first record that has each.
class CodeNumbers {
 public:
  // Error 6 for more records than 16 bits number.
  explicit CodeNumbers(std::span<const NameRec> names);

  // The records of the codes that are there; the others, unless blank, go to `dropped`.
  std::vector<ListRec> Refreshed(std::span<const std::string> codes, ListCodes& dropped) const;

 private:
  std::unordered_map<std::string, std::int16_t> numbers_;
};

// Adds a list to the set, with the record numbers that its codes have now and without those that
// left the name file. Nothing where it is right as it stands.
void StageList(FileSet& set, const Files& files, const std::string& dataPath,
               std::int16_t ChartListNo, const CodeNumbers& numbers);
// All lists that can be shown. An error of reading that may pass, or of a list that may not be
// written, is raised: its numbers would lead to other securities.
void StageLists(FileSet& set, const Files& files, const std::string& dataPath,
                const CodeNumbers& numbers);

struct ListCheck {
  int lists = 0;    // files gone through
  int removed = 0;  // codes that left the name file
};
// Goes through every list file that is there, up to list `last`, and rewrites it with the
// current record numbers, without the codes that left the name file. Each file is whole at any
// time; an error ends the check.
ListCheck CheckAllLists(const Files& files, const std::string& dataPath,
                        std::int16_t last = kResultList);

// ---- Editing one list

// Appends the code, trimmed and upper-cased. False, and nothing, when it is blank or there.
bool AddCode(ListCodes& list, std::string_view code);
// The place of a typed code, in any case, among the name file's; nothing when it is not there,
// which is told as kCodeNotFound.
std::optional<size_t> FindTypedCode(std::span<const std::string> nameCodes, std::string_view typed);
// Takes out the items at these places; places that are not there are passed over.
void DeleteItems(ListCodes& list, std::span<const size_t> places);

inline constexpr std::string_view kCodeNotFound = "Code not found";
inline constexpr std::string_view kDeleteAllItems = "Delete all items ?";
inline constexpr std::string_view kSaveChanges = "Save changes ?";
std::string DeleteQuestion(std::string_view code);             // "Delete BHP  ?"
std::string DeleteAllFromQuestion(std::string_view listName);  // "Delete all items from " + name
// Put before a list is replaced that another program wrote since it was shown.
inline constexpr std::string_view kListChangedOutside =
    "The list was changed by another program. Save over these changes ?";
// Asked when a changed list is left: by name, or "List has changed..." where it has none.
std::string ChangedQuestion(std::string_view listName);

// ---- Two lists side by side

inline constexpr std::string_view kListUtilities = "Chart List Utilities";  // title of all messages

struct ListSide {
  std::int16_t ChartListNo = 0;  // 0: no list chosen
  ListCodes Codes;
  bool Changed = false;
};

// What stands against work between the two: "Both lists must be displayed", "Lists cannot be
// same", or empty.
std::string_view CheckSides(const ListSide& a, const ListSide& b);
// Copies the items at `places` of one list behind the other, in list order; a code that is there
// already is not added again. Returns the message of CheckSides, and does nothing unless that
// is empty.
std::string_view CopyItems(const ListSide& from, ListSide& to, std::span<const size_t> places);
// The same, and takes the items out of `from`, those too that the other had already.
std::string_view MoveItems(ListSide& from, ListSide& to, std::span<const size_t> places);
// Saves the sides that have changed as SaveSubList does: all of them or, on an error, none, so that
// what was moved is in one of the two at any time. Returns the codes that were dropped.
ListCodes SaveSides(const Files& files, const std::string& dataPath,
                    std::span<const ListSide> sides);

}  // namespace kora
