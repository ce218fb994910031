#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "base/dates.h"
#include "store/name_rec.h"

namespace kora::demo {

struct Company {
  NameRec rec;
  float close;  // the last one
};

// The facts of invented companies as the store of security details has them: STKHeader.txt,
// SecurityDetails.Stx and Sdix1.inx. Two of three pay an interim and a final dividend.
struct CompanyFiles {
  std::string header, store, index;
};
CompanyFiles MakeCompanyDetails(const std::vector<Company>& companies, const CalendarDate& today,
                                std::uint64_t seed);

// The stand-in for the comms program, a script.
std::string CommsProgram();

}  // namespace kora::demo
