#pragma once

#include <functional>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "tests/support/failing_io.h"

namespace kora::test {

// Every file below a folder with its bytes, and every folder by its name with "/" behind it; but
// for the lock's and for what a kill leaves to be swept ("~" at its end).
using Store = std::map<std::string, std::string>;
Store StoreOf(const std::string& folder);
// Makes the folder hold just these files. Files that are as they should be are left alone.
void LayStore(const std::string& folder, const Store& store);
// Names that end in "~" below a folder.
std::vector<std::string> TemporariesOf(const std::string& folder);

// Runs `work` in a process of its own. What it gave, or nothing where the process was killed.
std::optional<int> InChild(const std::function<int()>& work);

// How a piece of work went that ran in a process of its own.
struct ChildRun {
  bool killed = false;
  int code = 0;     // what the work gave, where it was not killed
  int calls = 0;    // changes that it asked for
  int reads = 0;    // reads that it asked for
  std::string err;  // what it wrote to standard error
};
// `prepare` sets what fails. Standard output goes nowhere.
ChildRun RunInChild(const std::function<void(FailingIo&)>& prepare,
                    const std::function<int(Io&)>& work);

}  // namespace kora::test
