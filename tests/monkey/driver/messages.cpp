#include "tests/monkey/driver/messages.h"

#include <charconv>
#include <string_view>
#include <system_error>
#include <vector>

#include "base/runtime_error.h"

namespace kora::monkey {
namespace {

// The numbers that stand behind `before`, blanks between.
std::vector<int> NumbersBehind(std::string_view text, std::string_view before) {
  std::vector<int> numbers;
  for (size_t at = text.find(before); at != text.npos; at = text.find(before, at)) {
    at += before.size();
    while (at < text.size() && text[at] == ' ') ++at;
    int number = 0;
    const char* end = text.data() + text.size();
    if (std::from_chars(text.data() + at, end, number).ec == std::errc()) numbers.push_back(number);
  }
  return numbers;
}

}  // namespace

std::set<int> NumbersOfGuide(const std::string& html) {
  const size_t from = html.find("<table id=\"numbers\">");
  if (from == html.npos) return {};
  const auto rows =
      NumbersBehind(html.substr(from, html.find("</table>", from) - from), "<tr><td>");
  return {rows.begin(), rows.end()};
}

std::string FaultOfMessage(const std::string& text, const std::set<int>& numbers) {
  for (const char* before : {"rror No.", "rror number"})
    for (const int number : NumbersBehind(text, before))
      if (!numbers.contains(number)) return "the guide lacks the number";
  // The standing text of a number, wherever it stands in a message.
  for (int number = 1; number < 1000; ++number) {
    const std::string standing = ErrorText(number);
    if (standing == ErrorText(0)) continue;
    if (text.find(standing) != text.npos && !numbers.contains(number))
      return "the guide lacks the number of this error";
  }
  for (const char* foreign : {ErrorText(0), "std::", "basic_string", "vector::", "map::at", "stoi",
                              "stod", "bad_", "regex", "bad optional", "what():"})
    if (text.find(foreign) != text.npos) return "no text of the program's own";
  if (text.find_first_not_of(" \t\r\n") == text.npos) return "an empty message";
  return "";
}

}  // namespace kora::monkey
