#pragma once

#include <string>
#include <string_view>

#include "base/files.h"

namespace kora::test {

// A home of its own for one test, in the system's temporary folder, with drive_c made. Gone
// at the end.
class TempHome {
 public:
  explicit TempHome(Io& io = MachineIo());
  ~TempHome();
  TempHome(const TempHome&) = delete;
  TempHome& operator=(const TempHome&) = delete;

  const std::string& path() const { return path_; }
  Files& files() { return files_; }

  // Host files, for what a test lays down or looks at. `name` is relative to the home.
  void Put(std::string_view name, std::string_view bytes) const;
  std::string Get(std::string_view name) const;  // empty when it is not there
  bool Exists(std::string_view name) const;

 private:
  std::string path_;
  Files files_;
};

}  // namespace kora::test
