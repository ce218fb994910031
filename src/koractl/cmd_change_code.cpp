#include <memory>

#include "koractl/command.h"
#include "koractl/run.h"
#include "maintenance/code_change.h"

namespace kora {

void AddChangeCode(CLI::App& app, CommandLine& line) {
  const auto codes = std::make_shared<std::pair<std::string, std::string>>();
  CLI::App* command = app.add_subcommand("change-code", "Follow a security whose code has changed");
  command->add_option("OLD", codes->first, "The code that it had")->required();
  command->add_option("NEW", codes->second, "The code that it has now")->required();
  command->callback([&line, codes] {
    line.run = [&line, codes] {
      Run run(line);
      run.Open();
      CodeBox focus;
      NoProgress silent;
      return ChangeCode(run.session.files, run.dataPath(), codes->first, codes->second, silent,
                        run.dialogs, focus) == CodeChange::kChanged
                 ? kDone
                 : kAbandoned;
    };
  });
}

}  // namespace kora
