#include <memory>

#include "koractl/run.h"
#include "koractl/table.h"
#include "update/master_list.h"

namespace kora {

void AddMaster(CLI::App& app, CommandLine& line) {
  const auto file = std::make_shared<std::string>();
  CLI::App* command = app.add_subcommand("master", "Make the master list from a plain list");
  command->add_option("FILE", *file, "Lines code,type,category,class,name,details")->required();
  command->callback([&line, file] {
    line.run = [&line, file] {
      Run run(line);
      run.Open();
      const auto count = MakeMasterList(run.session.files, run.session.settings.paths.SystemPath,
                                        *file, run.dialogs);
      if (!count) return kAbandoned;
      WriteOut(std::to_string(*count) + " securities\n");
      return kDone;
    };
  });
}

}  // namespace kora
