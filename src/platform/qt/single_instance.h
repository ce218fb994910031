#pragma once

#include <QLockFile>
#include <string>

namespace kora {

// One running program a home: whoever holds the name's lock file. The lock of a program that
// died is taken over. A home that can't be written has no lock, and every instance is the first.
class SingleInstance {
 public:
  SingleInstance(const std::string& home, const std::string& name);

  // True when another one runs.
  bool Previous() const { return previous_; }

 private:
  QLockFile lock_;
  bool previous_;
};

}  // namespace kora
