#pragma once

#include <string>
#include <vector>

#include "base/files.h"

namespace kora {

struct IndustryClass {
  std::string id, description;  // "011", free of commas
};

// The table of industry classes, IndClass.dat in the program folder: one class a line, id, a
// comma, description. Lines without an id are left out; a line without a comma is an id alone.
// Empty when the file is not there. Errors of reading; 7 for a file of more than 1 MB.
std::vector<IndustryClass> ReadIndustryClasses(const Files& files, const std::string& systemPath);

}  // namespace kora
