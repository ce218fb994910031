#pragma once

#include <chrono>
#include <functional>
#include <memory>
#include <string>
#include <utility>

#include "base/io.h"
#include "base/runtime_error.h"

namespace kora {

// Raised, with number 70, where another program holds the home's lock. The text is the whole
// message: it names the program, its process and its machine.
class HomeIsHeld : public RunTimeError {
 public:
  explicit HomeIsHeld(const std::string& text) : RunTimeError(kPermissionDenied, text) {}
};

// Whoever writes the store holds the home's lock while he does, so that two programs never write
// at once. Readers take none. It is the host's own lock on the file Kora.lock of the home, which
// the host frees when the process that holds it dies, on a shared folder too.
//
// Within one lock holds may nest: an operation that is made of others takes it once more.
class HomeLock {
 public:
  HomeLock(std::string home, Io& io) : home_(std::move(home)), io_(io) {}

  // A hold on the lock, given back at its end.
  class Held {
   public:
    Held(Held&& other) noexcept : lock_(std::exchange(other.lock_, nullptr)) {}
    Held& operator=(Held&&) = delete;
    ~Held() {
      if (lock_ && --lock_->depth_ == 0) lock_->held_.reset();
    }

   private:
    friend class HomeLock;
    explicit Held(HomeLock& lock) : lock_(&lock) { ++lock.depth_; }
    HomeLock* lock_;
  };

  // Waits for the lock as long as `wait` says. Raises HomeIsHeld when another program has it
  // still; 75, 61 and what else Io raises where the lock's file can't be made.
  [[nodiscard]] Held Hold();

  std::string program = "KORA Charting";  // as others are told who holds it
  std::chrono::milliseconds wait{5000};
  // What is done between two tries; it takes a while. Sleeps where there is none.
  std::function<void()> idle;

 private:
  const std::string home_;
  Io& io_;
  std::unique_ptr<HostLock> held_;
  int depth_ = 0;
};

}  // namespace kora
