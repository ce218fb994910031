#pragma once

#include "base/io.h"

namespace kora {

// Exit codes.
inline constexpr int kDone = 0;
inline constexpr int kAbandoned = 1;  // the message says why; nothing half-written
inline constexpr int kUsage = 2;      // the command line is wrong

// Runs one command line, its program's name first, and gives the exit code. Tables go to standard
// output, messages to standard error. The installation is reached through `io`; files of the host
// that the command line names are the machine's own.
int RunKoractl(int argc, const char* const* argv, Io& io = MachineIo());

}  // namespace kora
