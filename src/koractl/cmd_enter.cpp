#include <memory>

#include "base/text.h"
#include "koractl/command.h"
#include "koractl/run.h"
#include "maintenance/data_entry.h"

namespace kora {

void AddEnter(CLI::App& app, CommandLine& line) {
  const auto code = std::make_shared<std::string>();
  const auto texts = std::make_shared<EntryTexts>();
  CLI::App* command = app.add_subcommand("enter", "Add one day's prices by hand");
  command->add_option("CODE", *code, "Code of the security")->required();
  command->add_option("--date", texts->date, "The day, d/m/yy")->required();
  command->add_option("--close", texts->close, "Close; Cum.Total of kind 3")->required();
  command->add_option("--open", texts->open, "Open");
  command->add_option("--high", texts->high, "High; Rises of kind 3");
  command->add_option("--low", texts->low, "Low; Falls of kind 3");
  command->add_option("--volume", texts->volume, "Volume");
  command->callback([&line, code, texts] {
    line.run = [&line, code, texts] {
      Run run(line);
      run.Open();
      auto security = FindEntry(run.session.files, run.dataPath(), ToAnsi(*code), run.dialogs);
      if (!security) return kAbandoned;
      EntryBox focus;
      return SaveEntry(run.session.files, *security, *texts, run.dialogs, focus) ? kDone
                                                                                 : kAbandoned;
    };
  });
}

}  // namespace kora
