#include "tests/support/temp_home.h"

#include <stdlib.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>

namespace kora::test {
namespace {

// Where the user names no place, a file system in memory: tests that cut an operation at each of
// its calls flush thousands of times.
std::filesystem::path TempPlace() {
  const char* memory = "/dev/shm";
  const bool named = std::getenv("TMPDIR") != nullptr;
  return !named && ::access(memory, W_OK) == 0 ? memory : std::filesystem::temp_directory_path();
}

std::string MakeFolder() {
  std::string name = (TempPlace() / "kora-test-XXXXXX").string();
  if (!::mkdtemp(name.data())) throw std::runtime_error("no temporary folder");
  std::filesystem::create_directory(name + "/drive_c");
  return name;
}

}  // namespace

TempHome::TempHome(Io& io) : path_(MakeFolder()), files_(path_, io) {}

TempHome::~TempHome() {
  std::error_code ignored;
  std::filesystem::remove_all(path_, ignored);
}

void TempHome::Put(std::string_view name, std::string_view bytes) const {
  const std::filesystem::path path = std::filesystem::path(path_) / name;
  std::filesystem::create_directories(path.parent_path());
  std::ofstream out(path, std::ios::binary);
  out.write(bytes.data(), std::streamsize(bytes.size()));
  if (!out.flush()) throw std::runtime_error("can't write " + path.string());
}

std::string TempHome::Get(std::string_view name) const {
  std::ifstream in(std::filesystem::path(path_) / name, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

bool TempHome::Exists(std::string_view name) const {
  return std::filesystem::exists(std::filesystem::path(path_) / name);
}

}  // namespace kora::test
