#include <memory>

#include "demo/demo_market.h"
#include "koractl/run.h"

namespace kora {

void AddDemo(CLI::App& app, CommandLine& line) {
  const auto options = std::make_shared<DemoOptions>();
  CLI::App* command = app.add_subcommand("demo", "Make an installation with an invented market");
  command->add_option("--securities", options->securities, "Securities and indices")
      ->capture_default_str()
      ->check(CLI::Range(5, 5000));
  command->add_option("--years", options->years, "Years of history")
      ->capture_default_str()
      ->check(CLI::Range(1, 40));
  command->add_option("--seed", options->seed, "The same seed gives the same bytes")
      ->capture_default_str()
      ->check([](const std::string& text) {
        return text.starts_with('-') ? "The seed " + text + " is negative" : std::string();
      });
  command->callback([&line, options] {
    line.run = [&line, options] {
      Run run(line);
      Session& s = run.session;
      if (s.ini.Exists())
        run.Abandon("There is an installation in " + s.files.home() + " already.", "KORA");
      return MakeDemo(s.files, s.ini, s.user, run.dialogs, *options) ? kDone : kAbandoned;
    };
  });
}

}  // namespace kora
