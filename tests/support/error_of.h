#pragma once

#include "base/runtime_error.h"

namespace kora::test {

// The number that `work` raises; 0 when it ends well.
template <typename Work>
int ErrorOf(Work&& work) {
  try {
    work();
  } catch (const RunTimeError& e) {
    return e.number();
  }
  return 0;
}

}  // namespace kora::test
