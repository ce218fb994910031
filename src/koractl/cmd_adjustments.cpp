#include <algorithm>
#include <memory>

#include "adjust/bulletins.h"
#include "adjust/make_adjustments.h"
#include "base/numbers.h"
#include "base/text.h"
#include "koractl/options.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "store/market_folders.h"

namespace kora {
namespace {

constexpr const char* kAdjustmentsTitle = "Adjustments List";

// The bar of a long pass, or none.
struct PassBar {
  explicit PassBar(Dialogs& dialogs, std::string_view title)
      : shown(dialogs.StartProgress(title)) {}
  Progress& get() { return shown ? *shown : none; }
  std::unique_ptr<Progress> shown;
  NoProgress none;
};

int TakeBulletins(const CommandLine& line, const std::string& name) {
  Run run(line);
  run.Open();
  const Settings& settings = run.session.settings;
  std::string folder = run.dataPath();
  if (settings.download.DataService == 3) {
    if (!CheckMarketFolders(run.session.files, settings, run.dialogs)) return kAbandoned;
    const WmPaths lines = ReadWmPaths(run.session.files, settings.paths.SystemPath);
    folder = WithBackslash(Trim(lines[kWmAsx]));
  }
  PassBar bar(run.dialogs, "Bulletins");
  int added = 0;
  MergeBulletins(run.session.files, settings, folder, std::string(Trim(name)), bar.get(), added);
  WriteOut("# Added=" + Str(std::int32_t(added)) + "\n");
  return kDone;
}

// Opens the list; `work` gives the exit code.
int OnAdjustments(const CommandLine& line,
                  const std::function<int(Run&, AdjustRows&, const std::string& folder)>& work) {
  Run run(line);
  run.Open();
  const Files& files = run.session.files;
  if (!CheckMarketFolders(files, run.session.settings, run.dialogs)) return kAbandoned;
  const std::string folder = AdjustFolder(files, run.session.settings);
  AdjustRows rows = ReadAdjustList(files, folder);
  return work(run, rows, folder);
}

int ShowAdjustments(const CommandLine& line) {
  return OnAdjustments(line, [](Run&, AdjustRows& rows, const std::string&) {
    size_t columns = 10;
    for (const AdjustRow& row : rows) columns = std::max(columns, row.fields.size());
    std::string heads = "Act Code File Column4 ADJ Name";
    for (size_t i = 7; i <= columns; ++i) heads += " Column" + Str(std::int32_t(i));
    Table table(heads);
    for (const AdjustRow& row : rows) {
      for (size_t i = 0; i < columns; ++i)
        table.Text(i < row.fields.size() ? std::string_view(row.fields[i]) : std::string_view());
      table.EndRow();
    }
    table.Print();
    return kDone;
  });
}

// Changes the list and keeps it.
int ChangeAdjustments(const CommandLine& line, const std::function<void(AdjustRows&)>& change) {
  return OnAdjustments(line, [&](Run& run, AdjustRows&, const std::string& folder) {
    const auto held = run.session.files.lock().Hold();
    AdjustRows rows = ReadAdjustList(run.session.files, folder);
    change(rows);
    WriteAdjustList(run.session.files, folder, rows);
    return kDone;
  });
}

int MakeMarked(const CommandLine& line) {
  return OnAdjustments(line, [](Run& run, AdjustRows&, const std::string& folder) {
    const auto held = run.session.files.lock().Hold();
    AdjustRows rows = ReadAdjustList(run.session.files, folder);
    PassBar bar(run.dialogs, "MAKE ADJUSTMENTS");
    const AdjustResult result = MakeAdjustments({.files = run.session.files,
                                                 .settings = run.session.settings,
                                                 .noteColour = run.session.colours[kChartTitle],
                                                 .progress = bar.get()},
                                                rows, folder);
    if (!result.failures.empty()) run.Abandon(FailuresText(result), kAdjustmentsTitle);
    return result.stopped ? kAbandoned : kDone;
  });
}

}  // namespace

void AddBulletins(CLI::App& app, CommandLine& line) {
  const auto name = std::make_shared<std::string>();
  CLI::App* command =
      app.add_subcommand("bulletins", "Take the bulletins of a day onto the adjustment list");
  command->add_option("NAME", *name, "Their base name, as 15SEP98")->required();
  command->callback(
      [&line, name] { line.run = [&line, name] { return TakeBulletins(line, *name); }; });
}

void AddAdjustments(CLI::App& app, CommandLine& line) {
  CLI::App* list = app.add_subcommand("adjustments", "Show or work on the adjustment list");
  list->require_subcommand(0, 1);
  list->callback([&line, list] {
    if (list->get_subcommands().empty()) line.run = [&line] { return ShowAdjustments(line); };
  });
  struct Entry {
    const char* name;
    const char* description;
    void (*change)(AdjustRows&);
  };
  static constexpr Entry kEntries[] = {
      {"sort", "Order by code and action", SortAdjustments},
      {"remove-done", "Take rows marked D off the list", RemoveDone},
      {"mark-options", "Mark the rows of options with D", MarkOptions},
      {"mark-warrants", "Mark the rows of warrants with D", MarkWarrants},
  };
  for (const Entry& entry : kEntries)
    list->add_subcommand(entry.name, entry.description)->callback([&line, change = entry.change] {
      line.run = [&line, change] { return ChangeAdjustments(line, change); };
    });
  list->add_subcommand("make", "Carry out the rows marked Y")->callback([&line] {
    line.run = [&line] { return MakeMarked(line); };
  });
  const auto letter = std::make_shared<std::string>();
  CLI::App* set = list->add_subcommand("set", "Set ADJ of all rows");
  AddChoice(*set, "LETTER", *letter, {"Y", "N", "D"}, "Y do it, N leave, D done")->required();
  set->callback([&line, letter] {
    line.run = [&line, letter] {
      return ChangeAdjustments(line, [&](AdjustRows& rows) { MarkAll(rows, (*letter)[0]); });
    };
  });
}

}  // namespace kora
