#include <memory>

#include "koractl/command.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "maintenance/remove_date.h"

namespace kora {

void AddRemoveDate(CLI::App& app, CommandLine& line) {
  struct Texts {
    std::string date, folder;
    bool latest = false;
  };
  const auto texts = std::make_shared<Texts>();
  CLI::App* command = app.add_subcommand("remove-date", "Take one date out of every price file");
  command->add_option("DATE", texts->date, "The date, d/m/yy")->required();
  command->add_flag("--latest", texts->latest, "Only the latest record of it in each file");
  command->add_option("--folder", texts->folder, "Data folder (default: the current one)");
  command->callback([&line, texts] {
    line.run = [&line, texts] {
      Run run(line);
      run.Open();
      const auto progress = run.dialogs.StartProgress("Remove Specific Date");
      RemoveDateBox focus;
      const RemovedDate removed =
          RemoveDate(run.session.files, run.session.settings,
                     texts->folder.empty() ? run.dataPath() : texts->folder, texts->date,
                     texts->latest, *progress, run.dialogs, focus);
      if (!removed.done || removed.stopped) return kAbandoned;
      WriteOut(std::to_string(removed.files) + " files changed, " +
               std::to_string(removed.records) + " records removed\n");
      return kDone;
    };
  });
}

}  // namespace kora
