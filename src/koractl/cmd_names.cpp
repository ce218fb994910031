#include "base/runtime_error.h"
#include "koractl/run.h"
#include "koractl/table.h"

namespace kora {
namespace {

int Names(const CommandLine& line) {
  Run run(line);
  run.Open();
  std::vector<NameRec> names;
  try {
    const std::string path = NameFilePath(run.dataPath());
    if (!run.session.files.CheckFile(path)) throw RunTimeError(kFileNotFound);
    names = ReadNames(run.session.files, run.dataPath());
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = "Names.dat"});
  }
  Table table(
      "Rec Status Code RecType Name OtherDetails Base Top PFInc MinMove BandUp BandDown "
      "BollPeriods BollWidth Category Id IndClass");
  std::int32_t number = 0;
  for (const NameRec& rec : names) {
    table.Number(++number).Number(rec.NameStatus).Text(rec.Code.raw()).Number(rec.RecType);
    table.Text(rec.Name.raw()).Text(rec.OtherDetails.raw());
    table.Number(float(rec.Base)).Number(float(rec.Top)).Number(float(rec.PFInc));
    table.Number(float(rec.MinMove)).Number(rec.BandUp).Number(rec.BandDown);
    table.Number(rec.BollPeriods).Number(rec.BollWidth).Number(rec.Category);
    table.Text(rec.Id.raw()).Text(rec.IndClass.raw()).EndRow();
  }
  table.Print();
  return kDone;
}

}  // namespace

void AddNames(CLI::App& app, CommandLine& line) {
  app.add_subcommand("names", "Show the name file")->callback([&line] {
    line.run = [&line] { return Names(line); };
  });
}

}  // namespace kora
