#pragma once

#include <functional>
#include <map>
#include <ostream>
#include <string>
#include <vector>

#include "shell/session.h"

namespace kora::test {

using Words = std::vector<std::string>;

// What a user does: a command line of koractl, or the routine that a form calls, in a session
// that was started as the program starts.
struct Step {
  Words words;
  std::function<bool(Session&)> work;  // false where it was told that it is not done
};

template <typename... Word>
Step Cmd(Word... word) {
  return {{std::string(word)...}, {}};
}
inline Step Do(std::function<bool(Session&)> work) { return {{}, std::move(work)}; }

// What the rules themselves make of an operation that was cut short, or that fails.
enum Ends : unsigned {
  kWhole = 0,  // the operation is done or not, all files together
  // A file after the other: each is an old one or a new one.
  kFileByFile = 1,
  // Days go into price files one by one, each file by itself; the journal takes the next run on.
  kDayByDay = 2,
  // The list of adjustments is saved after each row that was carried out; a security may have
  // several.
  kRowByRow = 4,
  // A record is written in its place, or behind the others. A torn one does not count, and the next
  // write takes its place.
  kInPlace = 8,
  // A setting that can't be kept holds for this run of the program, and nobody is told.
  kPassedOver = 16,
  // Done behind something else, which goes on without a word where it fails.
  kQuiet = 32,
  // One key of the settings after the other.
  kKeyByKey = 64,
  // The script of the chart on show, which each chart begins anew, is written as well.
  kScript = 128,
};

struct Operation {
  const char* name;
  std::vector<Step> before;  // steps that lay the scene, over a demo market
  Step step;
  unsigned ends = kWhole;
  std::map<std::string, std::string> files = {};  // of the scene, by name below the home
};

inline void PrintTo(const Operation& operation, std::ostream* out) { *out << operation.name; }

const std::vector<Operation>& CommandOperations();
const std::vector<Operation>& FormOperations();

}  // namespace kora::test
