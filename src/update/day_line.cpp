#include "update/day_line.h"

#include <array>

#include "base/dates.h"
#include "base/files.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr size_t kLongestShown = 200;

using Fields = std::array<std::string_view, kOptionCommas + 1>;

// Without memory of its own: every line of a market comes here, twice.
Fields FieldsOf(std::string_view line) {
  Fields fields;
  for (std::string_view& field : fields) {
    const size_t end = line.find(',');
    field = line.substr(0, end);
    if (end == std::string_view::npos) break;
    line.remove_prefix(end + 1);
  }
  return fields;
}

bool IsExpiry(const CalendarDate& date, std::int32_t days) {
  const std::int64_t number = std::int64_t(DayNumber(date)) + days;
  return number >= DayNumber({1, 1, 1}) && number <= DayNumber({9999, 12, 31});
}

// Blanks, a sign, digits and one point: what Val reads to its end.
bool IsNumber(std::string_view text) {
  text = Trim(text);
  if (!text.empty() && (text.front() == '+' || text.front() == '-')) text.remove_prefix(1);
  bool digits = false, point = false;
  for (const char c : text) {
    if (c >= '0' && c <= '9') {
      digits = true;
    } else if (c == '.' && !point) {
      point = true;
    } else {
      return false;
    }
  }
  return digits;
}

}  // namespace

std::string ReadDayLine(std::string_view line, bool options, DayLine& day) {
  if (line.find('\0') != std::string_view::npos) return " The line is no text";
  const Fields fields = FieldsOf(line);
  day = {};
  day.code = Trim(Trim(fields[0]).substr(0, 6));
  if (const std::string upper = UCase(day.code); KeptCode(upper) != upper)
    day.code = KeptCode(upper);
  if (day.code.empty()) return {};
  if (!IsFileCode(day.code)) return " The code cannot be the name of a file";
  day.date = Trim(fields[1]);
  const auto date = ParseFileDate(day.date);
  if (!date) return " The date is not a date yyyymmdd";
  try {
    day.Open = CSng(Val(fields[2]));
    day.High = CSng(Val(fields[3]));
    day.Low = CSng(Val(fields[4]));
    day.Close = CSng(Val(fields[5]));
    day.Volume = CLng(Val(fields[6]));
    if (options) {
      day.days = CLng(Val(fields[7]));
      day.OptType = Trim(fields[8]);
      if (!IsExpiry(*date, day.days)) return " The days to expiry are too many";
    } else {
      const double spare = Val(fields[7]);
      day.hasSpare = spare != 0;
      day.spare = CLng(spare);
    }
  } catch (const RunTimeError&) {
    return " A number is too large";
  }
  return {};
}

std::vector<std::string> MisreadFields(std::string_view line, bool options) {
  constexpr std::array<std::string_view, kOptionCommas> names{"",    "",      "Open",   "High",
                                                              "Low", "Close", "Volume", "spare"};
  constexpr size_t kClose = 5;
  std::vector<std::string> out;
  const Fields fields = FieldsOf(line);
  for (size_t i = 2; i < names.size(); ++i) {
    if (IsNumber(fields[i]) || (i != kClose && Trim(fields[i]).empty())) continue;
    out.push_back(std::string(options && i == 7 ? "days" : names[i]) + " \"" +
                  ShownLine(fields[i]) + "\" read as " + Str(Val(fields[i])));
  }
  return out;
}

std::string ShownLine(std::string_view line) {
  std::string out = FromAnsi(line.substr(0, kLongestShown));
  for (char& c : out)
    if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) c = '?';
  if (line.size() > kLongestShown) out += "...";
  return out;
}

}  // namespace kora
