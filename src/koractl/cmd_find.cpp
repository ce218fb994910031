#include <memory>

#include "koractl/run.h"
#include "koractl/table.h"

namespace kora {

void AddFind(CLI::App& app, CommandLine& line) {
  const auto code = std::make_shared<std::string>();
  CLI::App* command = app.add_subcommand("find", "Find the price file of a security");
  command->add_option("CODE", *code, "Code of the security, in any case")->required();
  command->callback([&line, code] {
    line.run = [&line, code] {
      Run run(line);
      run.Open();
      run.Locate(*code);
      const CurrentName& found = run.session.current;
      Table table("Rec Code File");
      table.Number(found.NameRecNo).Text(found.Rec.Code.raw());
      table.Text(ToAnsi(run.PriceFilePath())).EndRow();
      table.Print();
      return kDone;
    };
  });
}

}  // namespace kora
