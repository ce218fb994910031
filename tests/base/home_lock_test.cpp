#include "base/home_lock.h"

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <filesystem>

#include "tests/support/error_of.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;
using namespace std::chrono_literals;

namespace {

// Another process that holds the lock of `home` until it is told to end.
class Holder {
 public:
  explicit Holder(const std::string& home) {
    int ready[2];
    if (::pipe(ready) != 0 || ::pipe(end_) != 0) throw std::runtime_error("no pipe");
    process_ = ::fork();
    if (process_ == 0) {
      ::close(end_[1]);
      HomeLock lock(home, MachineIo());
      lock.program = "holder";
      {
        const auto held = lock.Hold();
        char byte = 1;
        if (::write(ready[1], &byte, 1) != 1 || ::read(end_[0], &byte, 1) < 0) ::_exit(1);
      }
      ::_exit(0);
    }
    char byte;
    if (::read(ready[0], &byte, 1) != 1) throw std::runtime_error("no holder");
    ::close(ready[0]);
    ::close(ready[1]);
    ::close(end_[0]);
  }
  ~Holder() { End(); }

  void End() {
    if (process_ <= 0) return;
    ::close(end_[1]);
    ::waitpid(std::exchange(process_, 0), nullptr, 0);
  }
  void Kill() {
    ::kill(process_, SIGKILL);
    End();
  }
  int process() const { return process_; }

 private:
  int process_ = 0;
  int end_[2];
};

std::string RefusalOf(HomeLock& lock) {
  try {
    const auto held = lock.Hold();
    return "";
  } catch (const HomeIsHeld& e) {
    EXPECT_EQ(e.number(), kPermissionDenied);
    return e.what();
  }
}

}  // namespace

TEST(HomeLockTest, ASecondProcessIsToldWhoHoldsIt) {
  TempHome home;
  Holder holder(home.path());
  home.files().lock().wait = 0ms;
  const std::string refusal = RefusalOf(home.files().lock());
  char machine[256];
  ASSERT_EQ(::gethostname(machine, sizeof machine), 0);
  EXPECT_NE(refusal.find("holder (process " + std::to_string(holder.process()) + " on " + machine),
            std::string::npos)
      << refusal;
  holder.End();
  EXPECT_EQ(RefusalOf(home.files().lock()), "");
}

TEST(HomeLockTest, ALockOfADeadProcessIsTakenOver) {
  TempHome home;
  Holder holder(home.path());
  holder.Kill();
  home.files().lock().wait = 0ms;
  EXPECT_EQ(RefusalOf(home.files().lock()), "");
}

TEST(HomeLockTest, WhoWaitsHasItWhenTheOtherEnds) {
  TempHome home;
  Holder holder(home.path());
  HomeLock& lock = home.files().lock();
  int tries = 0;
  lock.idle = [&] {
    if (++tries == 3) holder.End();
  };
  EXPECT_EQ(RefusalOf(lock), "");
  EXPECT_EQ(tries, 3);
}

TEST(HomeLockTest, OfOneProgramNestsAndIsGivenBackAtTheLastEnd) {
  TempHome home;
  HomeLock other(home.path(), MachineIo());
  other.wait = 0ms;
  {
    const auto outer = home.files().lock().Hold();
    { const auto inner = home.files().lock().Hold(); }
    EXPECT_NE(RefusalOf(other), "");
  }
  EXPECT_EQ(RefusalOf(other), "");
}

TEST(HomeLockTest, NobodyIsNamedForOneThatHasGone) {
  TempHome home;
  { const auto held = home.files().lock().Hold(); }
  const std::string left = home.Get("Kora.lock");
  EXPECT_EQ(left.size(), 256u);
  EXPECT_EQ(left.find_first_not_of(" \n"), std::string::npos);
}

TEST(HomeLockTest, ALinkInItsPlaceIsNotFollowed) {
  TempHome home;
  home.Put("precious", "kept");
  std::filesystem::create_symlink("precious", home.path() + "/Kora.lock");
  EXPECT_EQ(ErrorOf([&] { const auto held = home.files().lock().Hold(); }), kPathAccess);
  EXPECT_EQ(home.Get("precious"), "kept");
}

TEST(HomeLockTest, AMissingHomeCannotBeLocked) {
  TempHome home;
  HomeLock lock(home.path() + "/none", MachineIo());
  EXPECT_EQ(ErrorOf([&] { const auto held = lock.Hold(); }), kPathNotFound);
}
