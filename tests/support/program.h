#pragma once

#include <functional>
#include <string>
#include <vector>

namespace kora::test {

struct ProgramResult {
  int code = -1;  // exit code; 128 + the signal where one ended it
  std::string out, err;
};

// Runs a program with nothing on its standard input and waits for it. `environment` holds
// NAME=VALUE pairs beside those of the tests. `killWhen` is asked while the program runs, which
// is killed at once when it says so.
ProgramResult RunProgram(const std::string& path, const std::vector<std::string>& arguments,
                         const std::vector<std::string>& environment = {},
                         const std::function<bool()>& killWhen = {});

}  // namespace kora::test
