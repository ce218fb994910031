#pragma once

#include <string>

namespace kora::test {

// Makes a folder of a fresh name that begins with `name`, and returns its host path. Where the user
// names no place (TMPDIR), it is in memory: tests that cut an operation at each of its calls flush
// thousands of times. Whoever calls takes it away again.
std::string MakeTempFolder(const std::string& name);

}  // namespace kora::test
