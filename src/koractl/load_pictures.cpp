#include <dlfcn.h>
#include <sys/auxv.h>

#include <filesystem>

#include "base/runtime_error.h"
#include "koractl/pictures/pictures.h"

namespace kora {
namespace {

// The program's own file, its links followed; by the name it was started with where the host
// does not show its processes.
std::filesystem::path OwnProgram() {
  std::error_code error;
  if (auto program = std::filesystem::read_symlink("/proc/self/exe", error); !error) return program;
  const auto* started = reinterpret_cast<const char*>(::getauxval(AT_EXECFN));
  return started ? std::filesystem::canonical(started, error) : std::filesystem::path();
}

}  // namespace

std::unique_ptr<Pictures> LoadPictures() {
  std::error_code error;
  const auto program = OwnProgram();
  std::string file = (program.parent_path() / kPicturesFile).string();
  // Beside the program where it was built, otherwise where it was installed; by a way from the
  // program, so that the whole of it can be moved.
  for (const char* place : {"../" KORA_MODULE_PLACE, "../lib/kora"}) {
    if (std::filesystem::exists(file, error)) break;
    const auto installed = program.parent_path() / place / kPicturesFile;
    if (std::filesystem::exists(installed, error)) file = installed.lexically_normal().string();
  }
  const auto refuse = [&file](const std::string& why) {
    throw RunTimeError(kFileNotFound, "Pictures can't be drawn, only scripts (.cht): " + file +
                                          " can't be loaded" + why);
  };
  if (!std::filesystem::exists(file, error)) refuse(", it is not there");
  void* module = ::dlopen(file.c_str(), RTLD_NOW | RTLD_LOCAL);
  if (!module) {
    const char* why = ::dlerror();
    refuse(why ? std::string(": ") + why : "");
  }
  void* entry = ::dlsym(module, kPicturesEntry);
  if (!entry) refuse(", it belongs to another version");
  return std::unique_ptr<Pictures>(reinterpret_cast<Pictures* (*)()>(entry)());
}

}  // namespace kora
