#include "tests/support/killed_runs.h"

#include <fcntl.h>
#include <sys/mman.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>

namespace kora::test {
namespace {

namespace fs = std::filesystem;

std::string BytesOf(const fs::path& file) {
  std::ifstream in(file, std::ios::binary);
  std::ostringstream out;
  out << in.rdbuf();
  return out.str();
}

// What parent and child both see.
struct Counts {
  int calls, reads;
};

}  // namespace

Store StoreOf(const std::string& folder) {
  Store out;
  for (const auto& e : fs::recursive_directory_iterator(folder)) {
    const std::string name = e.path().lexically_relative(folder).string();
    if (name.ends_with('~') || name == "Kora.lock") continue;
    if (e.is_directory()) out[name + "/"] = "";
    if (e.is_regular_file()) out[name] = BytesOf(e.path());
  }
  return out;
}

void LayStore(const std::string& folder, const Store& store) {
  std::vector<fs::path> gone;
  for (const auto& e : fs::recursive_directory_iterator(folder)) {
    const std::string name = e.path().lexically_relative(folder).string();
    if (name != "Kora.lock" && !store.contains(e.is_directory() ? name + "/" : name))
      gone.push_back(e.path());
  }
  for (const fs::path& path : gone) fs::remove_all(path);
  for (const auto& [name, bytes] : store) {
    const fs::path path = fs::path(folder) / name;
    if (name.ends_with('/')) {
      fs::create_directories(path);
      continue;
    }
    if (fs::is_regular_file(path) && BytesOf(path) == bytes) continue;
    fs::create_directories(path.parent_path());
    std::ofstream(path, std::ios::binary | std::ios::trunc) << bytes;
  }
}

std::vector<std::string> TemporariesOf(const std::string& folder) {
  std::vector<std::string> out;
  for (const auto& e : fs::recursive_directory_iterator(folder))
    if (e.path().string().ends_with('~'))
      out.push_back(e.path().lexically_relative(folder).string());
  return out;
}

std::optional<int> InChild(const std::function<int()>& work) {
  std::fflush(nullptr);
  const pid_t child = ::fork();
  if (child == 0) {
    const int code = work();
    std::fflush(nullptr);
    ::_exit(code);
  }
  int status = 0;
  if (child < 0 || ::waitpid(child, &status, 0) != child) throw std::runtime_error("no process");
  if (WIFEXITED(status)) return WEXITSTATUS(status);
  if (WTERMSIG(status) != SIGKILL)
    throw std::runtime_error("ended by signal " + std::to_string(WTERMSIG(status)));
  return std::nullopt;
}

ChildRun RunInChild(const std::function<void(FailingIo&)>& prepare,
                    const std::function<int(Io&)>& work) {
  void* shared =
      ::mmap(nullptr, sizeof(Counts), PROT_READ | PROT_WRITE, MAP_SHARED | MAP_ANONYMOUS, -1, 0);
  const int err = ::memfd_create("err", 0);
  if (shared == MAP_FAILED || err < 0) throw std::runtime_error("no memory to share");
  auto* counts = static_cast<Counts*>(shared);
  const std::optional<int> code = InChild([&] {
    ::dup2(err, STDERR_FILENO);
    ::dup2(::open("/dev/null", O_WRONLY), STDOUT_FILENO);
    FailingIo io;
    prepare(io);
    const int given = work(io);
    *counts = {io.calls, io.reads};
    return given;
  });
  ChildRun run{.killed = !code, .code = code.value_or(0)};
  run.calls = counts->calls;
  run.reads = counts->reads;
  run.err.resize(size_t(::lseek(err, 0, SEEK_END)));
  if (::pread(err, run.err.data(), run.err.size(), 0) != ssize_t(run.err.size())) run.err = "?";
  ::close(err);
  ::munmap(shared, sizeof(Counts));
  return run;
}

}  // namespace kora::test
