#include <memory>

#include "koractl/command.h"
#include "koractl/run.h"
#include "maintenance/move_files.h"

namespace kora {

void AddMove(CLI::App& app, CommandLine& line) {
  struct Texts {
    std::string code, from, to;
  };
  const auto texts = std::make_shared<Texts>();
  CLI::App* command =
      app.add_subcommand("move", "Take a price file from one data folder to another");
  command->add_option("CODE", texts->code, "Code of the security")->required();
  command->add_option("--from", texts->from, "The data folder that has it, as c:\\m\\asx\\")
      ->required();
  command->add_option("--to", texts->to, "The data folder that is to have it")->required();
  command->callback([&line, texts] {
    line.run = [&line, texts] {
      Run run(line);
      run.Open();
      NoProgress silent;
      return MoveDataFile(run.session.files, texts->from, texts->to, texts->code, silent,
                          run.dialogs)
                 ? kDone
                 : kAbandoned;
    };
  });
}

}  // namespace kora
