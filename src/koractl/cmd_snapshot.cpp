#include <algorithm>
#include <memory>
#include <optional>

#include "base/text.h"
#include "companies/snapshot.h"
#include "koractl/run.h"
#include "koractl/table.h"

namespace kora {
namespace {

struct SnapshotWords {
  int list = 1;
  std::string code;
  bool index = false;
};

struct SnapshotRun {
  SnapshotRun(const CommandLine& line, int list, bool writes = false) : run(line), number(list) {
    run.Open();
    if (writes)
      held.emplace(run.session.files.lock().Hold());  // from what is read to what is saved
    try {
      rows = ReadSnapshot(run.session.files, SystemPath(), number);
    } catch (const RunTimeError& e) {
      run.Abandon(e.what(), kSnapshotTitle);
    }
  }
  const std::string& SystemPath() const { return run.session.settings.paths.SystemPath; }
  std::vector<SnapshotRow>::iterator Find(const std::string& code) {
    return std::find_if(rows.begin(), rows.end(),
                        [&](const SnapshotRow& row) { return EqualNoCase(row.code, code); });
  }
  void Save() { SaveSnapshot(run.session.files, SystemPath(), number, rows); }
  void Print() const {
    Table table("Code Last Bid Ask Close Volume Trade Today Tag Units UnitCost Dividend");
    for (const SnapshotRow& row : rows) {
      table.Text(ToAnsi(row.code));
      for (const std::string& price : row.prices) table.Text(ToAnsi(price));
      table.Text(std::string(1, row.kind)).Text(ToAnsi(row.units)).Text(ToAnsi(row.cost));
      table.Text(ToAnsi(row.dividend)).EndRow();
    }
    table.Print();
  }

  Run run;
  std::optional<HomeLock::Held> held;
  int number;
  std::vector<SnapshotRow> rows;
};

int Show(const CommandLine& line, const SnapshotWords& words) {
  SnapshotRun(line, words.list).Print();
  return kDone;
}

int Add(const CommandLine& line, const SnapshotWords& words) {
  SnapshotRun s(line, words.list, true);
  const std::string code = UCase(Trim(words.code));
  if (!IsFileCode(code)) throw UsageError("\"" + words.code + "\" is no code");
  if (s.Find(code) != s.rows.end()) return kDone;
  if (s.rows.size() >= kMostSnapshotRows) s.run.Abandon(kTooManyRows, kSnapshotTitle);
  s.rows.push_back({.code = code, .kind = words.index ? 'I' : 'S'});
  s.Save();
  return kDone;
}

int Remove(const CommandLine& line, const SnapshotWords& words) {
  SnapshotRun s(line, words.list, true);
  const auto row = s.Find(std::string(Trim(words.code)));
  if (row == s.rows.end()) s.run.Abandon("Code not found", kSnapshotTitle);
  s.rows.erase(row);
  s.Save();
  return kDone;
}

int Fetch(const CommandLine& line, const SnapshotWords& words) {
  SnapshotRun s(line, words.list);
  Session& session = s.run.session;
  const SnapshotServices services{session.files, session.settings.paths, session.settings.download,
                                  s.run.dialogs, session.processes,      session.clock};
  if (!FetchSnapshot(services, words.list, s.rows)) return kAbandoned;
  s.Print();
  return kDone;
}

}  // namespace

void AddSnapshot(CLI::App& app, CommandLine& line) {
  const auto words = std::make_shared<SnapshotWords>();
  CLI::App* snapshot = app.add_subcommand("snapshot", "Show or change a snapshot list");
  snapshot->add_option("LIST", words->list, "1, 2 or 3")
      ->required()
      ->check(CLI::Range(1, kSnapshotLists));
  snapshot->require_subcommand(0, 1);
  const auto to = [&line, words](int (*run)(const CommandLine&, const SnapshotWords&)) {
    return [&line, words, run] { line.run = [&line, words, run] { return run(line, *words); }; };
  };
  // A command without a word of its own shows the list: its callback comes first.
  snapshot->preparse_callback([to](size_t) { to(Show)(); });
  CLI::App* add = snapshot->add_subcommand("add", "Add a security");
  add->add_option("CODE", words->code, "Code")->required();
  add->add_flag("--index", words->index, "It is an index");
  add->callback(to(Add));
  CLI::App* remove = snapshot->add_subcommand("remove", "Take a security out");
  remove->add_option("CODE", words->code, "Code")->required();
  remove->callback(to(Remove));
  snapshot->add_subcommand("fetch", "Fetch prices by the comms program")->callback(to(Fetch));
}

}  // namespace kora
