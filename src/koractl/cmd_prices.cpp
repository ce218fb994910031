#include <memory>

#include "base/runtime_error.h"
#include "koractl/run.h"
#include "koractl/table.h"

namespace kora {
namespace {

int Prices(const CommandLine& line, const std::string& code) {
  Run run(line);
  run.Open();
  run.Locate(code);
  Table table("Rec Date Open High Low Close Volume AdjFactor AdjDesc");
  try {
    const PriceFile file(run.session.files, run.PriceFilePath());
    std::int32_t number = 0;
    for (const PriceRec& rec : file.ReadAll()) {
      table.Number(++number).Text(rec.RecDate.raw());
      table.Number(float(rec.Open)).Number(float(rec.High)).Number(float(rec.Low));
      table.Number(float(rec.Close)).Number(std::int32_t(rec.Volume));
      table.Number(float(rec.AdjFactor)).Text(rec.AdjDesc.raw()).EndRow();
    }
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = run.session.current.PriceFileName});
  }
  table.Print();
  return kDone;
}

}  // namespace

void AddPrices(CLI::App& app, CommandLine& line) {
  const auto code = std::make_shared<std::string>();
  CLI::App* command = app.add_subcommand("prices", "Show a price file");
  command->add_option("CODE", *code, "Code of the security, in any case")->required();
  command->callback([&line, code] { line.run = [&line, code] { return Prices(line, *code); }; });
}

}  // namespace kora
