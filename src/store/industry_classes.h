#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

struct IndustryClass {
  std::string id, description;  // "011", free of commas
};

std::string IndustryClassFile(const std::string& systemPath);
// The table of industry classes, IndClass.dat in the program folder: one class a line, id, a
// comma, description. Lines without an id are left out; a line without a comma is an id alone.
// Empty when the file is not there. Errors of reading; 7 for a file of more than 1 MB.
std::vector<IndustryClass> ReadIndustryClasses(const Files& files, const std::string& systemPath);

// What is typed into the table: an id is numeric and takes the form "000", a description has no
// commas. The message where it is refused, and nothing changes then.
std::optional<std::string> PutClassId(IndustryClass& row, std::string_view text);
std::optional<std::string> PutClassDescription(IndustryClass& row, std::string_view text);

// By id, as keys of 12 characters; rows without an id go to the end.
void SortIC(std::vector<IndustryClass>& rows);

// Replaces the file as a whole, each line trimmed; rows without an id are left out. Errors of
// writing.
void WriteIndustryClasses(const Files& files, const std::string& systemPath,
                          const std::vector<IndustryClass>& rows);

// Trimmed IndClass of a record against a filter. A filter ending in "0" is a group: any class of
// 3 characters that begins with the filter's first two. An empty filter or class never matches.
bool MatchesIndClass(std::string_view indClass, std::string_view filter);

}  // namespace kora
