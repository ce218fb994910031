#include "koractl/describe.h"

namespace kora {
namespace {

std::string Roff(const std::string& text) {
  std::string out;
  for (const char c : text) {
    if (c == '\\')
      out += "\\e";
    else if (c == '-')
      out += "\\-";
    else if (c == '|')
      out += "|\\:";  // lists of choices may be broken there
    else if ((c == '.' || c == '\'') && out.empty())
      out += std::string("\\&") + c;
    else
      out += c;
  }
  return out;
}

std::string Bold(const std::string& text) { return "\\fB" + Roff(text) + "\\fR"; }
std::string Italic(const std::string& text) { return "\\fI" + Roff(text) + "\\fR"; }

std::string Names(const CLI::Option& option) {
  std::string out;
  for (const std::string& name : option.get_snames())
    out += (out.empty() ? "" : ", ") + Bold("-" + name);
  for (const std::string& name : option.get_lnames())
    out += (out.empty() ? "" : ", ") + Bold("--" + name);
  if (option.get_positional()) return Italic(option.get_single_name());
  return option.get_items_expected_max() == 0 ? out : out + " " + Italic(option.get_type_name());
}

std::string Entries(const CLI::App& app) {
  std::string out;
  for (const CLI::Option* option : app.get_options()) {
    // Every command has it.
    if (app.get_parent() && option == app.get_help_ptr()) continue;
    out += ".TP\n" + Names(*option) + "\n" + Roff(option->get_description());
    if (const std::string standing = option->get_default_str(); !standing.empty())
      out += " (default: " + Roff(standing) + ")";
    out += "\n";
  }
  return out;
}

std::string Usage(const CLI::App& command, const std::string& name) {
  std::string out = Bold(name);
  bool options = false;
  for (const CLI::Option* option : command.get_options()) {
    if (!option->get_positional()) {
      options |= option != command.get_help_ptr();
      continue;
    }
    std::string word = Italic(option->get_single_name());
    if (option->get_expected_max() > 1) word += "...";
    out += " " + (option->get_required() ? word : "[" + word + "]");
  }
  return out + (options ? " [" + Italic("OPTIONS") + "]" : "");
}

std::string Commands(const CLI::App& app, const std::string& before) {
  std::string out;
  for (const CLI::App* command : app.get_subcommands([](const CLI::App*) { return true; })) {
    const std::string name = before + command->get_name();
    const bool more = !command->get_subcommands([](const CLI::App*) { return true; }).empty();
    out += ".SS " + Bold(name) + "\n" + Roff(command->get_description()) + ".\n";
    if (!more) out += ".PP\n" + Usage(*command, name) + "\n";
    out += Entries(*command);
    out += Commands(*command, name + " ");
  }
  return out;
}

}  // namespace

std::string ManualSections(const CLI::App& app) {
  return ".SH OPTIONS\nThese stand before the command or behind it.\n" + Entries(app) +
         ".SH COMMANDS\n" + Commands(app, "");
}

}  // namespace kora
