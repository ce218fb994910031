#include <dlfcn.h>

#include <filesystem>

#include "base/runtime_error.h"
#include "koractl/pictures/pictures.h"

namespace kora {

std::unique_ptr<Pictures> LoadPictures() {
  std::error_code error;
  const auto program = std::filesystem::read_symlink("/proc/self/exe", error);
  const std::string file = (program.parent_path() / kPicturesFile).string();
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
