// One program for all targets: the reader is told by the name under which it is started, "fuzz_names".

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <string>
#include <string_view>

#include "fuzz/readers.h"

namespace {

const kora::test::Reader* chosen = nullptr;

}  // namespace

extern "C" int LLVMFuzzerInitialize(int*, char*** argv) {
  std::string_view name = (*argv)[0];
  name = name.substr(name.rfind('/') + 1);
  name = name.substr(name.find('_') + 1);
  chosen = kora::test::FindReader(name);
  if (chosen) return 0;
  std::fprintf(stderr, "No reader has the name %s; there are:", std::string(name).c_str());
  for (const auto& reader : kora::test::Readers())
    std::fprintf(stderr, " %s", std::string(reader.name).c_str());
  std::fputc('\n', stderr);
  std::exit(2);
}

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, size_t size) {
  chosen->body({reinterpret_cast<const char*>(data), size});
  return 0;
}
