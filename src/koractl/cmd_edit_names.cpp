#include <memory>

#include "base/text.h"
#include "koractl/options.h"
#include "koractl/run.h"
#include "names/name_editor.h"

namespace kora {
namespace {

// Loads the name file, lets `edit` change its rows, and saves what has changed.
int Edit(const CommandLine& line, const std::function<bool(NameEditor&)>& edit) {
  Run run(line);
  run.Open();
  Session& session = run.session;
  const auto held = session.files.lock().Hold();  // from what is read to what is saved
  NameEditor editor({session.files, run.dataPath(), session.settings.paths.SystemPath, run.dialogs,
                     session.ini, session.settings.download});
  try {
    editor.Load();
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = "Names.dat"}, kNameFileTitle);
  }
  if (!edit(editor)) return kAbandoned;
  if (!editor.changed()) return kDone;
  return editor.SaveNames().saved ? kDone : kAbandoned;
}

struct Entry {
  const char* name;
  const char* description;
  void (*edit)(NameEditor&);
};
constexpr Entry kEntries[] = {
    {"remove-warrants", "Take the warrants out, and keep them out of updates",
     [](NameEditor& e) { e.DeleteWarrants(); }},
    {"remove-duplicates", "Keep the first of several records of one code",
     [](NameEditor& e) { e.Dupnames(); }},
    {"fill-classes", "Give options and warrants the industry class of their stock",
     [](NameEditor& e) { e.FillClasses(); }},
    {"title-case", "Write names with capital first letters", [](NameEditor& e) { e.TitleCase(); }},
    {"clean-optional", "Empty Base, Top and PF Inc of all records",
     [](NameEditor& e) { e.CleanOptional(); }},
    {"remove-expired", "Take expired options out", [](NameEditor& e) { e.RemoveExpired(); }},
};

KeepTicks TicksOf(const std::vector<std::string>& keep) {
  constexpr const char* kItems[] = {"name", "details", "type", "category", "class"};
  KeepTicks ticks{};
  for (size_t i = 0; i < ticks.size(); ++i)
    ticks[i] = std::find(keep.begin(), keep.end(), kItems[i]) != keep.end();
  return ticks;
}

}  // namespace

void AddEditNames(CLI::App& app, CommandLine& line) {
  CLI::App* names = app.add_subcommand("edit-names", "Change the name file as its editor does");
  names->require_subcommand(1);

  const auto order = std::make_shared<std::string>();
  CLI::App* sort = names->add_subcommand(
      "sort",
      "Sort the editor's rows, dropping deleted ones; the file keeps its order by category");
  sort->add_option("ORDER", *order, "code, category or class")
      ->required()
      ->check(CLI::IsMember({"code", "category", "class"}));
  sort->callback([&line, order] {
    line.run = [&line, order] {
      return Edit(line, [&](NameEditor& e) {
        e.Sort(*order == "code"    ? NameSort::kCode
               : *order == "class" ? NameSort::kIndClass
                                   : NameSort::kCategory);
        return true;
      });
    };
  });

  for (const Entry& entry : kEntries)
    names->add_subcommand(entry.name, entry.description)->callback([&line, edit = entry.edit] {
      line.run = [&line, edit] {
        return Edit(line, [edit](NameEditor& e) {
          edit(e);
          return true;
        });
      };
    });

  const auto keep = std::make_shared<std::vector<std::string>>();
  CLI::App* master = names->add_subcommand("from-master", "Take what the master list has");
  master->add_option("--keep", *keep, "Items that stay as they are unless empty")
      ->delimiter(',')
      ->type_name("type,category,class,name,details")
      ->transform(CLI::IsMember({"type", "category", "class", "name", "details"}, CLI::ignore_case)
                      .description(""));
  master->callback([&line, keep] {
    line.run = [&line, keep] {
      return Edit(line, [&](NameEditor& e) { return e.UpdateNames(TicksOf(*keep)); });
    };
  });
}

}  // namespace kora
