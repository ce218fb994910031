#pragma once

#include <CLI/CLI.hpp>
#include <string>
#include <vector>

#include "base/io.h"

// What is told of the command line from the parser itself, so that it always agrees with it.

namespace kora {

// Candidates for the last of `words`, which follow the program's name up to where the user is
// typing: a line each, with a tab and what it is where there is something to say. A line that
// begins with a tab says that files or folders fit too. The store is read for codes, and nothing
// is ever written; what can't be read brings no candidates.
std::string Candidates(const CLI::App& app, const std::vector<std::string>& words, Io& io);

// The sections of the manual page on options and commands, as roff.
std::string ManualSections(const CLI::App& app);

}  // namespace kora
