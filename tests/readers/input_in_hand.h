#pragma once

#include <unistd.h>

#include <csignal>
#include <fstream>
#include <string>

#include "fuzz/readers.h"

namespace kora::test {

// The input that a body has in hand: where a broken promise ends the process it is left in a file of
// the working folder, to be looked at.
class InputInHand {
 public:
  InputInHand() { before_ = std::signal(SIGABRT, Leave); }
  ~InputInHand() { std::signal(SIGABRT, before_); }
  InputInHand(const InputInHand&) = delete;
  InputInHand& operator=(const InputInHand&) = delete;

  void Give(const Reader& reader, const std::string& name, std::string bytes) {
    Name() = std::string(reader.name) + ", " + name;
    Bytes() = std::move(bytes);
    reader.body(Bytes());
  }

 private:
  static std::string& Name() {
    static std::string name;
    return name;
  }
  static std::string& Bytes() {
    static std::string bytes;
    return bytes;
  }
  // The process ends behind this in any case.
  static void Leave(int) {
    constexpr const char* kFile = "failed-input";
    std::ofstream(kFile, std::ios::binary) << Bytes();
    const std::string text = "input: " + Name() + ", left as " + kFile + "\n";
    if (::write(STDERR_FILENO, text.data(), text.size()) < 0) return;
  }

  void (*before_)(int) = nullptr;
};

}  // namespace kora::test
