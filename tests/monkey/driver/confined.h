#pragma once

#include <functional>
#include <string>
#include <vector>

#include "platform/clock.h"
#include "platform/processes.h"
#include "tests/support/forwarding_io.h"

namespace kora::monkey {

// The machine's file system, in which only what lies below one folder can be changed. What is
// refused is told.
class ConfinedIo : public test::ForwardingIo {
 public:
  std::string root;  // an absolute host folder without a slash at its end
  std::function<void(const std::string& what)> refused;

  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override;
  bool AnyThread() const override { return base_.AnyThread(); }
  void MakeFolder(const std::string& path) override;
  void Remove(const std::string& path) override;
  void Rename(const std::string& from, const std::string& to) override;
  void Link(const std::string& from, const std::string& to) override;
  std::unique_ptr<HostLock> TryLock(const std::string& path, std::string_view holder,
                                    std::string& heldBy) override;

 private:
  void Inside(const char* what, const std::string& path) const;
};

// The day after the demo market's last download.
class StandingClock : public Clock {
 public:
  CalendarDate Today() const override { return {2026, 11, 5}; }
};

// No program is ever started: each call lasts some rounds of `idle`, and ends or fails in turn.
class NoProcesses : public Processes {
 public:
  int started = 0;
  int RunAndWait(const std::string& program, const std::vector<std::string>& arguments,
                 const std::function<void()>& idle) override;
};

}  // namespace kora::monkey
