#include <memory>

#include "base/text.h"
#include "koractl/options.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "update/import_history.h"

namespace kora {
namespace {

constexpr size_t kLongestName = 35;

// A name stands in scripts and text exports between commas.
void CheckName(const std::string& name) {
  if (ToAnsi(name).size() > kLongestName)
    throw UsageError("--name: a name has at most 35 characters");
  for (const char c : name)
    if (static_cast<unsigned char>(c) < 0x20 || c == ',')
      throw UsageError("--name: no commas and no control characters in a name");
}

int Import(const CommandLine& line, const std::vector<std::string>& sources,
           const ImportOptions& options) {
  if (!options.Code.empty() && !IsFileCode(KeptCode(UCase(Trim(options.Code)))))
    throw UsageError("--code: \"" + options.Code +
                     "\" is no code; it has 1 to 6 letters and digits");
  CheckName(options.Name);
  if (!options.Name.empty() && sources.size() > 1 && options.Code.empty())
    throw UsageError("--name: several files take one name only with --code");
  Run run(line);
  run.Open();
  ImportCounts counts;
  const bool all =
      ImportHistory(run.session.files, run.dataPath(), sources, options, run.dialogs, counts);
  WriteOut(std::to_string(counts.Codes.size()) + " securities, " + std::to_string(counts.Added) +
           " rows added, " + std::to_string(counts.Replaced) + " replaced, " +
           std::to_string(counts.Refused) + " refused\n");
  return all ? kDone : kAbandoned;
}

}  // namespace

void AddImport(CLI::App& app, CommandLine& line) {
  const auto files = std::make_shared<std::vector<std::string>>();
  const auto options = std::make_shared<ImportOptions>();
  CLI::App* command = app.add_subcommand("import", "Take price history from text files");
  command->add_option("FILE", *files, "Text files of prices")->required();
  const auto dates = std::make_shared<std::string>();
  AddChoice(*command, "--dates", *dates, {"yyyymmdd", "yyyy-mm-dd", "d/m/yyyy"},
            "Form of the dates (default: the first two, told by their shape)");
  command->add_option("--code", options->Code,
                      "Code of the security (default: the code in the "
                      "file, else the file's name)");
  command
      ->add_option("--type", options->Type,
                   "Kind of new securities: 1 close with volume, 2 close, 3 advance/decline, "
                   "4 share (default), 5 index")
      ->check(CLI::Range(1, 5));
  command->add_option("--name", options->Name, "Name of a new security");
  command->add_flag("--skip-bad", options->SkipBad, "Leave out rows that can't be read");
  command->callback([&line, files, dates, options] {
    if (*dates == "yyyymmdd") options->Dates = ImportDates::kCompact;
    if (*dates == "yyyy-mm-dd") options->Dates = ImportDates::kDashed;
    if (*dates == "d/m/yyyy") options->Dates = ImportDates::kSlashed;
    line.run = [&line, files, options] { return Import(line, *files, *options); };
  });
}

}  // namespace kora
