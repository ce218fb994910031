#pragma once

#include <set>
#include <string>
#include <vector>

#include "demo/random.h"

namespace kora::demo {

// The sectors of the market: the groups of the industry classes that shares fall in.
inline constexpr int kSectors = 8;
struct Sector {
  const char* name;       // "Mining"
  const char* indexCode;  // "XMIN"
  int group;              // industry class of the group, ends in 0
};
const Sector& SectorOf(int sector);

// A class with what its companies' names end in.
struct IndustryClass {
  int id;  // three digits
  const char* text;
  std::vector<const char*> endings;  // none: not a class of shares
};
// In order of their ids; a group before its classes.
const std::vector<IndustryClass>& IndustryClasses();

// Names companies that there are none of, each name and each code once.
class Namer {
 public:
  explicit Namer(std::uint64_t seed);

  struct Company {
    std::string code;  // three letters
    std::string word;  // "Tarrowin"
    std::string name;  // "Tarrowin Gold NL", at most 35 characters
    int classId;
  };
  Company Next(int sector);

 private:
  std::string CodeFor(const std::string& word);

  Random random_;
  std::vector<std::string> words_;
  size_t used_ = 0;
  std::set<std::string> names_, codes_;
};

}  // namespace kora::demo
