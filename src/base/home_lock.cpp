#include "base/home_lock.h"

#include <unistd.h>

#include <array>
#include <thread>

#include "base/host_file_set.h"

namespace kora {
namespace {

constexpr std::chrono::milliseconds kPause{5};

std::string MachineName() {
  std::array<char, 256> name{};
  if (::gethostname(name.data(), name.size() - 1) != 0) return "this machine";
  return name.data();
}

}  // namespace

HomeLock::Held HomeLock::Hold() {
  if (depth_ > 0) return Held(*this);
  const std::string holder =
      program + " (process " + std::to_string(::getpid()) + " on " + MachineName() + ")";
  const auto end = std::chrono::steady_clock::now() + wait;
  for (;;) {
    std::string heldBy;
    held_ = io_.TryLock(home_ + "/Kora.lock", holder, heldBy);
    if (held_) {
      Held held(*this);
      FinishSet(io_, SetJournalOf(home_));
      return held;
    }
    if (std::chrono::steady_clock::now() >= end)
      throw HomeIsHeld("The data is being written by " +
                       (heldBy.empty() ? std::string("another program") : heldBy) +
                       ". Nothing was changed. Try again when it has finished.");
    if (idle) {
      idle();
    } else {
      std::this_thread::sleep_for(kPause);
    }
  }
}

}  // namespace kora
