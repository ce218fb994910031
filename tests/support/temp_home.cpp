#include "tests/support/temp_home.h"

#include <filesystem>
#include <fstream>
#include <iterator>
#include <stdexcept>

#include "tests/support/temp_place.h"

namespace kora::test {
namespace {

std::string MakeFolder() {
  std::string name = MakeTempFolder("kora-test");
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
