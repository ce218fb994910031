#pragma once

#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "lists/grid_rows.h"

// Adjust.Lst of a data folder: the events that bulletins told, one a line, comma-separated, with
// what is to be done about each.

namespace kora {

// Columns, numbered from 1. Texts are ANSI, as in the file.
enum AdjustColumn : size_t {
  kAdjAct = 1,  // "NI", "NC", "DC", "SP", "BI", "PC", "DI", "NL", "EN"
  kAdjCode = 2,
  kAdjFile = 3,  // "IDX", "SFE", "OVS", "OPT", "WNT", or the bulletin's base name
  kAdjMark = 5,  // "Y" do it, "N" leave, "D" done
  kAdjName = 6,  // NI, NL: the name; else the date "ddMMMyy"
  kAdj7 = 7,     // NI, NL: class; NC: new code; BI, SP: first figure; PC: tagged values
  kAdj8 = 8,     // BI, SP: second figure
  kAdj9 = 9,     // DI: cents
};
inline constexpr size_t kAdjustColumns = 20;  // what a line has beyond stays with the last of them

struct AdjustRow {
  std::vector<std::string> fields;  // trailing ones may be missing

  // Trimmed; empty where the line has no such column.
  std::string Field(size_t column) const;
  void Set(size_t column, std::string text);
  // Column 1 in upper case.
  std::string Action() const;
  bool IsMarked(char letter) const;  // in any case
};
AdjustRow ParseAdjustLine(std::string_view line);
std::string AdjustLine(const AdjustRow& row);

using AdjustRows = std::vector<AdjustRow>;

inline constexpr std::string_view kNoBulletinData = "There is no bulletin data";

std::string AdjustListPath(const std::string& folder);
// Lines that are not blank; none where there is no file. Error 7 for a file above 64 MB.
AdjustRows ReadAdjustList(const Files& files, const std::string& folder);
std::string AdjustListText(const AdjustRows& rows);
// Replaces the file as a whole.
void WriteAdjustList(const Files& files, const std::string& folder, const AdjustRows& rows);

// Orders by code, and within a code by what is done first: new issues, changes of name,
// removals, splits, bonus issues, prices, dividends, all others. Equal rows stay as they stand.
void SortAdjustments(AdjustRows& rows);
void MarkAll(AdjustRows& rows, char letter);
// Mark with D: rows of options ("ASX.OPT", "OPT"), and of warrants ("ASX.WNT", "WNT").
void MarkOptions(AdjustRows& rows);
void MarkWarrants(AdjustRows& rows);
void RemoveDone(AdjustRows& rows);

// "15SEP98" as "19980915"; years below 30 are of the 2000s. Empty unless it is a date of exactly
// seven characters.
std::string BulletinDate(std::string_view ddMMMyy);

}  // namespace kora
