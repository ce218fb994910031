#include <cstdio>
#include <exception>
#include <new>

#include "base/runtime_error.h"
#include "koractl/command.h"
#include "koractl/describe.h"
#include "koractl/koractl.h"
#include "koractl/options.h"
#include "revision/revision.h"

namespace kora {
namespace {

void Say(const std::string& text) { std::fprintf(stderr, "[KORA] %s\n", text.c_str()); }

int Usage(const CLI::App& app, const std::string& what) {
  const auto chosen = app.get_subcommands();
  std::fprintf(stderr, "%s\n\n%s", what.c_str(),
               (chosen.empty() ? app.help() : chosen.front()->help("koractl")).c_str());
  return kUsage;
}

}  // namespace

int RunKoractl(int argc, const char* const* argv, Io& io) {
  CLI::App app("KORA Charting without its windows", "koractl");
  CommandLine line;
  line.io = &io;
  app.require_subcommand(1);
  app.set_version_flag(
      "--version", [] { return VersionLine("koractl"); },
      "Print the version and the revision, and exit");
  app.fallthrough();
  app.add_option("--home", line.home,
                 "Folder of the installation (default: KORA_HOME, else kora under the user's "
                 "data folder)")
      ->type_name("DIR");
  app.add_option("--set", line.sets, "A setting for this run only")
      ->type_name("SECTION.KEY=VALUE")
      ->expected(1)
      ->take_all();
  app.add_option("--wait", line.wait, "Seconds to wait while another program writes the store")
      ->type_name("SECONDS")
      ->capture_default_str()
      ->check(CLI::Range(0.0, 86400.0));
  std::string answer;
  AddChoice(app, "--answer", answer, {"yes", "no", "ok", "cancel"},
            "Answer to every question that offers it");
  // clang-format off
  for (const auto add : {
           AddInit,
           AddDemo,
           AddNames,
           AddFind,
           AddPrices,
           AddBars,
           AddScale,
           AddChart,
           AddLines,
           AddNotes,
           AddZoom,
           AddMulti,
           AddPlay,
           AddPrint,
           AddImport,
           AddDownloads,
           AddUpdate,
           AddMaster,
           AddBulletins,
           AddAdjust,
           AddAdjustments,
           AddScan1,
           AddScan2,
           AddScan3,
           AddStats,
           AddList,
           AddEdit,
           AddEnter,
           AddCheck,
           AddChangeCode,
           AddMove,
           AddBackup,
           AddRestore,
           AddExport,
           AddRemoveDate,
           AddEditNames,
           AddCompany,
           AddSnapshot,
       })
    // clang-format on
    add(app, line);

  // Asked by the scripts that complete what is typed in a shell, and by the build.
  const std::vector<std::string> words(argv + (argc > 0 ? 1 : 0), argv + argc);
  const std::string first = words.empty() ? "" : words.front();
  if (first == "--complete" || first == "--manual") {
    const std::string text = first == "--manual"
                                 ? ManualSections(app)
                                 : Candidates(app, {words.begin() + 1, words.end()}, io);
    std::fwrite(text.data(), 1, text.size(), stdout);
    return kDone;
  }

  try {
    app.parse(argc, argv);
  } catch (const CLI::Success& e) {
    return app.exit(e);
  } catch (const CLI::ParseError& e) {
    const auto strange = app.remaining();
    if (app.get_subcommands().empty() && !strange.empty() && strange.front()[0] != '-')
      return Usage(app, "There is no command \"" + strange.front() + "\"");
    return Usage(app, e.what());
  }
  if (answer == "yes") line.answer = Answer::kYes;
  if (answer == "no") line.answer = Answer::kNo;
  if (answer == "ok") line.answer = Answer::kOk;
  if (answer == "cancel") line.answer = Answer::kCancel;
  try {
    return line.run();
  } catch (const Abandoned&) {
    return kAbandoned;
  } catch (const UsageError& e) {
    return Usage(app, e.what());
  } catch (const RunTimeError& e) {
    Say(e.what());
  } catch (const std::bad_alloc&) {
    Say(ErrorText(kOutOfMemory));
  } catch (const std::exception& e) {
    Say(e.what());  // of a library: nobody nearer knew better words
  }
  return kAbandoned;
}

}  // namespace kora
