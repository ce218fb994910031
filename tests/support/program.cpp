#include "tests/support/program.h"

#include <fcntl.h>
#include <sched.h>
#include <signal.h>
#include <spawn.h>
#include <stdlib.h>
#include <sys/wait.h>
#include <unistd.h>

#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>

extern char** environ;

namespace kora::test {
namespace {

// A file that takes what the program writes: unlike a pipe it never fills up.
class Capture {
 public:
  Capture() : path_((std::filesystem::temp_directory_path() / "kora-out-XXXXXX").string()) {
    fd = ::mkstemp(path_.data());
    if (fd < 0) throw std::runtime_error("no temporary file");
  }
  ~Capture() {
    ::close(fd);
    ::unlink(path_.c_str());
  }
  Capture(const Capture&) = delete;
  Capture& operator=(const Capture&) = delete;
  std::string Text() const {
    std::ifstream in(path_, std::ios::binary);
    return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
  }

  int fd = -1;

 private:
  std::string path_;
};

std::vector<char*> Pointers(std::vector<std::string>& texts) {
  std::vector<char*> out;
  for (std::string& text : texts) out.push_back(text.data());
  out.push_back(nullptr);
  return out;
}

}  // namespace

ProgramResult RunProgram(const std::string& path, const std::vector<std::string>& arguments,
                         const std::vector<std::string>& environment,
                         const std::function<bool()>& killWhen) {
  std::vector<std::string> words{path};
  words.insert(words.end(), arguments.begin(), arguments.end());
  std::vector<std::string> variables = environment;  // the first of a name holds
  for (char** v = environ; *v; ++v) variables.emplace_back(*v);
  const Capture out, err;
  posix_spawn_file_actions_t actions;
  ::posix_spawn_file_actions_init(&actions);
  ::posix_spawn_file_actions_addopen(&actions, 0, "/dev/null", O_RDONLY, 0);
  ::posix_spawn_file_actions_adddup2(&actions, out.fd, 1);
  ::posix_spawn_file_actions_adddup2(&actions, err.fd, 2);
  pid_t pid = 0;
  const int error = ::posix_spawn(&pid, path.c_str(), &actions, nullptr, Pointers(words).data(),
                                  Pointers(variables).data());
  ::posix_spawn_file_actions_destroy(&actions);
  if (error != 0) throw std::runtime_error("can't start " + path);
  int status = 0;
  bool killed = false;
  while (::waitpid(pid, &status, killWhen && !killed ? WNOHANG : 0) <= 0) {
    if (!killWhen || killed) continue;
    if (killWhen()) {
      killed = true;
      ::kill(pid, SIGKILL);
    }
    ::sched_yield();
  }
  ProgramResult result;
  result.code = WIFEXITED(status) ? WEXITSTATUS(status) : 128 + WTERMSIG(status);
  result.out = out.Text();
  result.err = err.Text();
  return result;
}

}  // namespace kora::test
