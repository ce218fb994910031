#include "tests/monkey/driver/watchdog.h"

#include <execinfo.h>
#include <pthread.h>
#include <signal.h>
#include <time.h>
#include <unistd.h>

#include <chrono>
#include <cstdio>

namespace kora::monkey {
namespace {

constexpr int kLongestWait = 300;  // seconds

void TellPlace(int) {
  void* frames[80];
  backtrace_symbols_fd(frames, backtrace(frames, 80), STDERR_FILENO);
  _exit(4);
}

}  // namespace

Watchdog::Watchdog(double seconds) : seconds_(seconds), watched_(pthread_self()) {
  pthread_getcpuclockid(watched_, &clock_);
  signal(SIGUSR1, TellPlace);
  NextEvent();
  thread_ = std::thread([this] { Watch(); });
}

Watchdog::~Watchdog() {
  done_ = true;
  thread_.join();
}

double Watchdog::Used() const {
  timespec t{};
  clock_gettime(clock_, &t);
  return double(t.tv_sec) + double(t.tv_nsec) * 1e-9;
}

void Watchdog::NextEvent() {
  since_ = Used();
  ++events_;
}

void Watchdog::Watch() {
  long seen = -1;
  auto standing = std::chrono::steady_clock::now();
  while (!done_) {
    std::this_thread::sleep_for(std::chrono::milliseconds(200));
    const auto now = std::chrono::steady_clock::now();
    const double used = Used() - since_;
    if (events_ != seen) {
      seen = events_;
      standing = now;
    }
    const bool waits = now - standing > std::chrono::seconds(kLongestWait) && used < 1;
    if (used < seconds_ && !waits) continue;
    std::fprintf(stderr, "HANGS: %s\n",
                 waits ? "waits for what does not come" : "the event does not end");
    pthread_kill(watched_, SIGUSR1);
    sleep(5);
    _exit(4);
  }
}

}  // namespace kora::monkey
