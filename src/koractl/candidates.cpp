#include <cstdlib>
#include <set>

#include "base/files.h"
#include "base/text.h"
#include "koractl/describe.h"
#include "platform/settings_file.h"
#include "shell/session.h"
#include "store/name_file.h"

namespace kora {
namespace {

bool TakesValue(const CLI::Option& option) { return option.get_items_expected_max() != 0; }

// Without what a check adds: "SECONDS:FLOAT in [0 - 86400]" is SECONDS.
std::string TypeOf(const CLI::Option& option) {
  const std::string type = option.get_type_name();
  return type.substr(0, type.find(':'));
}

const CLI::Option* FindOption(const CLI::App& at, const CLI::App& app, const std::string& name) {
  const CLI::Option* option = at.get_option_no_throw(name);
  return option ? option : app.get_option_no_throw(name);
}

const CLI::App* FindCommand(const CLI::App& at, const std::string& name) {
  for (const CLI::App* command : at.get_subcommands([](const CLI::App*) { return true; }))
    if (command->get_name() == name) return command;
  return nullptr;
}

// Where on the command line the last word stands.
struct Place {
  const CLI::App* at;                    // the command so far
  const CLI::Option* waiting = nullptr;  // the option whose value it is
  size_t positional = 0;                 // how many others went before
  std::string home;
};

Place PlaceOf(const CLI::App& app, const std::vector<std::string>& words) {
  Place place{&app, nullptr, 0, {}};
  for (size_t i = 0; i + 1 < words.size(); ++i) {
    const std::string& word = words[i];
    if (place.waiting) {
      if (place.waiting->check_lname("home")) place.home = word;
      place.waiting = nullptr;
    } else if (word.starts_with("-")) {
      const size_t equals = word.find('=');
      if (word.starts_with("--home=")) place.home = word.substr(equals + 1);
      const CLI::Option* option = FindOption(*place.at, app, word.substr(0, equals));
      if (option && TakesValue(*option) && equals == word.npos) place.waiting = option;
    } else if (const CLI::App* command = FindCommand(*place.at, word)) {
      place.at = command;
      place.positional = 0;
    } else {
      ++place.positional;
    }
  }
  return place;
}

class Writer {
 public:
  explicit Writer(std::string typed) : typed_(std::move(typed)) {}

  void Add(const std::string& word, const std::string& about = {}) {
    if (word.substr(0, typed_.size()) == typed_) Put(word, about);
  }
  // In any case.
  void AddFolded(const std::string& word, const std::string& about = {}) {
    if (UCase(word.substr(0, typed_.size())) == UCase(typed_)) Put(word, about);
  }
  void AddFiles(bool folders) { text_ += folders ? "\tfolders\n" : "\tfiles\n"; }
  const std::string& text() const { return text_; }

 private:
  void Put(const std::string& word, const std::string& about) {
    text_ += word + (about.empty() ? "" : "\t" + about) + "\n";
  }
  std::string typed_, text_;
};

void AddOptions(Writer& out, const CLI::App& app) {
  for (const CLI::Option* option : app.get_options())
    for (const std::string& name : option->get_lnames())
      out.Add("--" + name, option->get_description());
}

// The home's settings are read here and not by start-up, which would mend what is missing.
void AddCodes(Writer& out, std::string home, Io& io) {
  const char* user = std::getenv("HOME");
  if (home.starts_with("~/") && user) home = user + home.substr(1);
  if (home.empty()) home = DefaultHome();
  try {
    const Files files(home, io);
    const SettingsFile ini(files, "C:\\WINDOWS\\Kora.ini");
    const std::string folder = ini.GetSetting("KoraPaths", "ChtData");
    if (folder == kUnknown) return;
    std::set<std::string> seen;
    for (const NameRec& rec : ReadNames(files, WithBackslash(folder))) {
      const std::string code(rec.Code.trimmed());
      if (!code.empty() && seen.insert(code).second)
        out.AddFolded(code, FromAnsi(rec.Name.trimmed()));
    }
  } catch (const std::exception&) {
  }
}

void AddValues(Writer& out, const CLI::Option& option, const Place& place, Io& io) {
  const std::string name = option.get_positional() ? option.get_single_name() : "";
  const std::string type = TypeOf(option);
  if (type.find('|') != type.npos) {
    for (const std::string_view word : Split(type, '|')) out.AddFolded(std::string(word));
    return;
  }
  const std::string& about = option.get_description();
  if (name == "CODE" || name == "OLD") AddCodes(out, place.home, io);
  if (type == "DIR" || type == "FOLDER")
    out.AddFiles(true);
  else if (name == "FILE" || type == "FILE" || about.find("FILE.cht") != about.npos)
    out.AddFiles(false);
}

}  // namespace

std::string Candidates(const CLI::App& app, const std::vector<std::string>& words, Io& io) {
  if (words.empty()) return {};
  Writer out(words.back());
  const Place place = PlaceOf(app, words);
  if (place.waiting) {
    AddValues(out, *place.waiting, place, io);
  } else if (words.back().starts_with("-")) {
    AddOptions(out, *place.at);
    if (place.at != &app)
      for (const CLI::Option* option : app.get_options())
        for (const std::string& name : option->get_lnames())
          if (name != "help" && name != "version") out.Add("--" + name, option->get_description());
  } else {
    for (const CLI::App* command : place.at->get_subcommands([](const CLI::App*) { return true; }))
      out.Add(command->get_name(), command->get_description());
    std::vector<const CLI::Option*> positionals;
    for (const CLI::Option* option : place.at->get_options())
      if (option->get_positional()) positionals.push_back(option);
    // The last one may take as many as there are.
    if (!positionals.empty() &&
        (place.positional < positionals.size() || positionals.back()->get_expected_max() > 1))
      AddValues(out, *positionals[std::min(place.positional, positionals.size() - 1)], place, io);
  }
  return out.text();
}

}  // namespace kora
