#pragma once

#include <string>

#include "base/files.h"

namespace kora::bench {

// A home in the temporary folder with one security, BENCH, of `records` trading days; gone at
// the end.
class Home {
 public:
  explicit Home(int records);
  ~Home();
  Home(const Home&) = delete;
  Home& operator=(const Home&) = delete;
  const Files& files() const { return files_; }

 private:
  std::string path_;
  Files files_;
};

}  // namespace kora::bench
