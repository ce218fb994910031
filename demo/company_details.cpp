#include "demo/company_details.h"

#include <algorithm>
#include <cmath>

#include "base/numbers.h"
#include "base/text.h"
#include "demo/comms_program.h"
#include "demo/random.h"

namespace kora::demo {
namespace {

constexpr std::uint64_t kStream = 3'000'000;
constexpr const char* kLabels[] = {"ASXCODE",      "Description", "Type",         "First Quoted",
                                   "Total Issued", "Current Div", "Div. Type",    "Div. Payable  ",
                                   "Ex Div Date",  "Franking %",  "Asset backing"};

std::string Record(std::string_view code, const std::vector<std::string>& fields) {
  std::string text;
  for (const std::string& field : fields) text += (text.empty() ? "" : "|") + field;
  return PadRight(code, 6) + PadRight(text, 306);
}

// Dollars to a tenth of a cent.
std::string Dollars(double value) { return Format(std::floor(value * 1000 + 0.5) / 1000, "0.00#"); }

}  // namespace

CompanyFiles MakeCompanyDetails(const std::vector<Company>& companies, const CalendarDate& today,
                                std::uint64_t seed) {
  CompanyFiles files;
  files.header = Str(std::int32_t(std::size(kLabels))) + "\r\n";
  for (const char* label : kLabels) files.header += std::string(label) + "\r\n";
  std::int32_t record = 0;
  for (size_t i = 0; i < companies.size(); ++i) {
    const auto& [rec, close] = companies[i];
    Random random(seed, kStream + i);
    const std::string code(Trim(rec.Code.trimmed())), name(Trim(rec.Name.trimmed()));
    const bool pays = random.Chance(0.67);
    const double yearly = double(close) * random.Between(0.015, 0.075);
    const double interim = yearly * random.Between(0.38, 0.5);
    const int franking = random.Chance(0.6) ? 100 : random.Below(5) * 20;
    const std::string issued = Str(double(1 + random.Below(900)) * 1e6);
    const std::string backing = Dollars(double(close) * random.Between(0.4, 1.3));
    const CalendarDate quoted = AddMonths({today.year, today.month, 1}, -36 - random.Below(480));
    files.index += code + "," + Str(record + 1) + "\r\n";
    for (const bool final : {false, true}) {
      if (final && !pays) break;
      const CalendarDate paid = AddMonths({today.year, today.month, 15}, final ? -2 : -8);
      const CalendarDate ex = AddMonths(paid, -1);
      const double dividend = pays ? (final ? yearly - interim : interim) : 0;
      files.store +=
          Record(code, {name, "Ordinary fully paid", FormatDisplayDate(quoted), issued,
                        pays ? Dollars(dividend) : "", pays ? (final ? "FINAL" : "INTERIM") : "",
                        pays ? FormatDisplayDate(paid) : "", pays ? FormatDisplayDate(ex) : "",
                        pays ? Str(std::int32_t(franking)) : "", backing});
      ++record;
    }
  }
  return files;
}

std::string CommsProgram() { return kCommsProgram; }

}  // namespace kora::demo
