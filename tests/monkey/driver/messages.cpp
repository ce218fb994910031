#include "tests/monkey/driver/messages.h"

#include <regex>

#include "base/runtime_error.h"

namespace kora::monkey {

std::set<int> NumbersOfGuide(const std::string& html) {
  std::set<int> numbers;
  const size_t from = html.find("<table id=\"numbers\">");
  if (from == html.npos) return numbers;
  const std::string table = html.substr(from, html.find("</table>", from) - from);
  static const std::regex row("<tr><td>([0-9]+)</td>");
  for (std::sregex_iterator it(table.begin(), table.end(), row), end; it != end; ++it)
    numbers.insert(std::stoi((*it)[1]));
  return numbers;
}

std::string FaultOfMessage(const std::string& text, const std::set<int>& numbers) {
  static const std::regex told("[Ee]rror (?:No\\.|number) *(-?[0-9]+)");
  for (std::sregex_iterator it(text.begin(), text.end(), told), end; it != end; ++it)
    if (!numbers.contains(std::stoi((*it)[1]))) return "the guide lacks the number";
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
