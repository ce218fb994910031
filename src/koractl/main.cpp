#include <cstdio>
#include <cstdlib>
#include <exception>
#include <new>

#include "base/runtime_error.h"
#include "koractl/koractl.h"

using namespace kora;

namespace {

// What is thrown where nobody can catch it, in a library's destructor: nearly always that memory
// gave out. Files are replaced whole, so that an end here leaves none half-written.
[[noreturn]] void EndAbandoned() {
  try {
    if (const auto thrown = std::current_exception()) std::rethrow_exception(thrown);
  } catch (const std::bad_alloc&) {
    std::fprintf(stderr, "[KORA] %s\n", ErrorText(kOutOfMemory));
  } catch (const std::exception& e) {
    std::fprintf(stderr, "[KORA] %s\n", e.what());
  } catch (...) {
    std::fprintf(stderr, "[KORA] Unexpected end\n");
  }
  std::_Exit(kAbandoned);
}

}  // namespace

int main(int argc, char** argv) {
  std::set_terminate(EndAbandoned);
  return RunKoractl(argc, argv);
}
