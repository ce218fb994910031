#pragma once

#include <functional>
#include <string>
#include <vector>

namespace kora {

class Processes {
 public:
  virtual ~Processes() = default;
  // Starts a program (a host path) in its own folder and waits for its end, without limit;
  // `idle` runs meanwhile, so that the window stays alive. Returns its exit code.
  // Error 53 when the program can't be started.
  virtual int RunAndWait(const std::string& program, const std::vector<std::string>& arguments,
                         const std::function<void()>& idle) = 0;
};

Processes& MachineProcesses();

}  // namespace kora
