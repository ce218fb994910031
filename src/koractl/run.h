#pragma once

#include <string>
#include <string_view>

#include "chart/chart_failure.h"
#include "koractl/command.h"
#include "platform/headless/console_dialogs.h"
#include "shell/session.h"
#include "store/price_rec.h"

namespace kora {

// One run on the home of the command line.
struct Run {
  // Nothing is read yet. Usage errors for an override that is no SECTION.KEY=VALUE.
  explicit Run(const CommandLine& line);

  ConsoleDialogs dialogs;
  Session session;

  // Shows the message and ends the operation.
  [[noreturn]] void Abandon(std::string_view text, std::string_view title);

  // Reads the settings. A home without a settings file ends the operation. `words` are
  // command-line words of the program.
  void Open(const std::string& words = "");

  const std::string& dataPath() const { return session.settings.paths.CurrentDataPath; }

  // The absolute path of a host file that the user names. An empty name is a usage error; a
  // working folder that is gone ends the operation.
  std::string HostPathOf(const std::string& file);

  // Finds the security, in any case, or ends the operation: session.current is set.
  void Locate(const std::string& code);
  // DOS path of the price file of the security found.
  std::string PriceFilePath() const { return dataPath() + session.current.PriceFileName; }
  // Ends the operation in the words that a chart has for a failure with a file.
  [[noreturn]] void AbandonFile(const RunTimeError& error, const ChartFailure& at,
                                std::string_view title = "KORA");
};

}  // namespace kora
