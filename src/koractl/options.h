#pragma once

#include <CLI/CLI.hpp>
#include <string>
#include <vector>

// Options that several commands share.

namespace kora {

// An option that takes one of a few words, in any case, and keeps it as the list has it.
inline CLI::Option* AddChoice(CLI::App& command, const std::string& name, std::string& value,
                              const std::vector<std::string>& words, const std::string& about) {
  std::string shown;
  for (const std::string& word : words) shown += (shown.empty() ? "" : "|") + word;
  CLI::Option* option = command.add_option(name, value, about)->type_name(shown);
  if (!value.empty()) option->capture_default_str();
  return option->transform(CLI::IsMember(words, CLI::ignore_case).description(""));
}

inline void AddPeriod(CLI::App& command, std::string& value) {
  AddChoice(command, "--period", value, {"A", "W", "M"}, "Daily, weekly or monthly");
}

inline void AddVolume(CLI::App& command, std::string& value) {
  AddChoice(command, "--volume", value, {"on", "off"}, "The volume request");
}

}  // namespace kora
