#pragma once

#include <atomic>
#include <thread>

namespace kora::monkey {

// Ends the process where one event takes more time of the processor than it may: it hangs. Counts
// what the thread that made it uses, so that a busy machine changes nothing. What waits for
// something that never comes uses none: that is told after some minutes.
class Watchdog {
 public:
  explicit Watchdog(double seconds);
  ~Watchdog();
  Watchdog(const Watchdog&) = delete;
  Watchdog& operator=(const Watchdog&) = delete;

  void NextEvent();  // of the thread that made it

 private:
  double Used() const;
  void Watch();

  const double seconds_;
  const pthread_t watched_;
  clockid_t clock_{};
  std::atomic<double> since_{0};
  std::atomic<long> events_{0};
  std::atomic<bool> done_{false};
  std::thread thread_;
};

}  // namespace kora::monkey
