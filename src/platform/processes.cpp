#include "platform/processes.h"

#include <spawn.h>
#include <sys/wait.h>
#include <time.h>

#include <cerrno>
#include <filesystem>

#include "base/runtime_error.h"
extern char** environ;

namespace kora {
namespace {

class HostProcesses : public Processes {
 public:
  int RunAndWait(const std::string& program, const std::vector<std::string>& arguments,
                 const std::function<void()>& idle) override {
    std::error_code error;
    const std::filesystem::path path = std::filesystem::absolute(program, error);
    if (error || program.empty()) throw RunTimeError(kFileNotFound);
    std::vector<char*> argv;
    argv.push_back(const_cast<char*>(path.c_str()));
    for (const std::string& a : arguments) argv.push_back(const_cast<char*>(a.c_str()));
    argv.push_back(nullptr);
    pid_t pid = 0;
    posix_spawn_file_actions_t actions;
    if (::posix_spawn_file_actions_init(&actions) != 0) throw RunTimeError(kOutOfMemory);
    int failed = ::posix_spawn_file_actions_addchdir_np(&actions, path.parent_path().c_str());
    if (failed == 0)
      failed = ::posix_spawn(&pid, path.c_str(), &actions, nullptr, argv.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    if (failed != 0) throw RunTimeError(kFileNotFound);
    int status = 0;
    for (;;) {
      const pid_t got = ::waitpid(pid, &status, idle ? WNOHANG : 0);
      if (got == pid) break;
      if (got < 0 && errno != EINTR) throw RunTimeError(kDeviceError);
      if (got == 0) {
        idle();
        const timespec pause{0, 20 * 1000 * 1000};
        ::nanosleep(&pause, nullptr);
      }
    }
    return WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  }
};

}  // namespace

Processes& MachineProcesses() {
  static HostProcesses processes;
  return processes;
}

}  // namespace kora
