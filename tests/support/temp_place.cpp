#include "tests/support/temp_place.h"

#include <stdlib.h>
#include <unistd.h>

#include <cstdlib>
#include <filesystem>
#include <stdexcept>

namespace kora::test {

std::string MakeTempFolder(const std::string& name) {
  const char* memory = "/dev/shm";
  const bool inMemory = !std::getenv("TMPDIR") && ::access(memory, W_OK) == 0;
  const std::filesystem::path place =
      inMemory ? std::filesystem::path(memory) : std::filesystem::temp_directory_path();
  std::string folder = (place / (name + "-XXXXXX")).string();
  if (!::mkdtemp(folder.data())) throw std::runtime_error("no temporary folder");
  return folder;
}

}  // namespace kora::test
