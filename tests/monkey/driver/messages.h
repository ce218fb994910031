#pragma once

#include <set>
#include <string>

namespace kora::monkey {

// The numbers of errors that a page of the guide explains: the first cells of its table "numbers".
std::set<int> NumbersOfGuide(const std::string& html);

// What is wrong with a message that the user is shown: it tells of an error that has no number in
// the guide, by number or by text, or it is no text of the program's own. Empty: nothing.
std::string FaultOfMessage(const std::string& text, const std::set<int>& numbers);

}  // namespace kora::monkey
