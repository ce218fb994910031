#include <algorithm>
#include <memory>
#include <optional>

#include "adjust/bulletins.h"
#include "base/text.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "update/download_update.h"

namespace kora {
namespace {

int Downloads(const CommandLine& line) {
  Run run(line);
  run.Open();
  DownloadEntries entries;
  const ListResult result =
      BuildDownloadList(run.session.files, run.session.settings.download, run.dialogs, entries);
  if (result == ListResult::kStopped) return kAbandoned;
  Table table("File");
  for (const std::string& entry : entries) table.Text(ToAnsi(entry)).EndRow();
  table.Print();
  return kDone;
}

int Update(const CommandLine& line, const std::optional<std::string>& name, bool all) {
  Run run(line);
  run.Open();
  Session& session = run.session;
  DownloadEntries entries;
  if (BuildDownloadList(session.files, session.settings.download, run.dialogs, entries) !=
      ListResult::kFilled)
    return kAbandoned;
  const auto display = run.dialogs.StartProgress("Update");
  bool AdjustListGrew = false;
  const UpdateRun update{session.files, session.settings, session.current,
                         run.dialogs,   session.clock,    *display};
  UpdateEnd end;
  if (all) {
    end = UpdateAllDays(update, entries);
  } else {
    auto entry = entries.begin();
    if (name)
      entry = std::find_if(entries.begin(), entries.end(),
                           [&](const std::string& e) { return EqualNoCase(e, Trim(*name)); });
    if (entry == entries.end()) run.Abandon("File does not exist\n" + *name, "Update");
    end = UpdateOneDay(update, entries, size_t(entry - entries.begin()));
  }
  if (AdjustListGrew) run.dialogs.Message(kAdjustListGrew, kAdjustListGrewTitle);
  return end == UpdateEnd::kUpdated ? kDone : kAbandoned;
}

}  // namespace

void AddDownloads(CLI::App& app, CommandLine& line) {
  app.add_subcommand("downloads", "Show the downloaded files that wait")->callback([&line] {
    line.run = [&line] { return Downloads(line); };
  });
}

void AddUpdate(CLI::App& app, CommandLine& line) {
  const auto name = std::make_shared<std::optional<std::string>>();
  const auto all = std::make_shared<bool>(false);
  CLI::App* command = app.add_subcommand("update", "Take in downloaded files");
  // An empty name is a name, not the default.
  CLI::Option* entry = command->add_option_function<std::string>(
      "NAME", [name](const std::string& text) { *name = text; },
      "Entry of the list (default: the first)");
  command->add_flag("--all", *all, "Every entry, in the order of the list")->excludes(entry);
  command->callback(
      [&line, name, all] { line.run = [&line, name, all] { return Update(line, *name, *all); }; });
}

}  // namespace kora
