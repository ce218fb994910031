#pragma once

#include <string>
#include <vector>

namespace kora::test {

struct ProgramResult {
  int code = -1;  // exit code; 128 + the signal where one ended it
  std::string out, err;
};

// Runs a program with nothing on its standard input and waits for it. `environment` holds
// NAME=VALUE pairs beside those of the tests.
ProgramResult RunProgram(const std::string& path, const std::vector<std::string>& arguments,
                         const std::vector<std::string>& environment = {});

}  // namespace kora::test
