#include <algorithm>
#include <filesystem>
#include <memory>
#include <set>

#include "base/runtime_error.h"
#include "base/text.h"
#include "koractl/chart_options.h"
#include "koractl/options.h"
#include "koractl/picture_output.h"
#include "koractl/pictures/pictures.h"
#include "lists/chart_list.h"
#include "store/name_file.h"

namespace kora {
namespace {

struct PictureOptions : ChartOptions {
  std::vector<std::string> codes;
  std::string list;
  std::string type;
  int scale = 1;
  std::string out;
};

const std::vector<std::string>& ListWords() {
  static const std::vector<std::string> words{"A", "B", "C", "D", "E", "F",
                                              "G", "H", "J", "K", "Z", "names"};
  return words;
}

// The codes of a list, or of the name file, as they stand there.
std::vector<std::string> CodesOfList(Run& run, const std::string& list) {
  const Files& files = run.session.files;
  try {
    if (list != "names") {
      const auto place = std::find(ListWords().begin(), ListWords().end(), list);
      const auto number = std::int16_t(kFirstChartList + (place - ListWords().begin()));
      return CodesOf(ReadList(files, run.dataPath(), number));
    }
    std::vector<std::string> codes;
    for (const NameRec& rec : ReadNames(files, run.dataPath()))
      codes.emplace_back(rec.Code.trimmed());
    return codes;
  } catch (const RunTimeError& e) {
    run.AbandonFile(e, {.file = list == "names" ? "Names.dat" : "the chart list"});
  }
}

// What one chart is made of: script or picture, as the ending asks for.
class ChartMaker {
 public:
  ChartMaker(Run& run, const PictureOptions& options, const PictureSize& size)
      : run_(run), options_(options), size_(size) {}

  std::string Make(const std::string& code, const std::string& fileName, Output output) {
    const ChartRequest request = FindChart(run_, options_, code);
    ChartScript script;
    if (output != Output::kPicture) {
      ComposeScript(run_, options_, request, size_, script);
      return script.text();
    }
    Load();
    return pictures_->Make(PictureKindOf(fileName), size_, [&](Surface& price, Surface* panel) {
      Compose(run_, options_, request, script, price, panel);
    });
  }

  // Brings what draws, unless it is there. Errors of LoadPictures.
  void Load() {
    if (!pictures_) pictures_ = LoadPictures();
  }

 private:
  Run& run_;
  const PictureOptions& options_;
  PictureSize size_;
  std::unique_ptr<Pictures> pictures_;
};

int ChartToFile(const CommandLine& line, const PictureOptions& o, const PictureSize& size) {
  const Output output = OutputOf(o.out);
  Run run(line);
  OpenCharts(run, o);
  WriteOutput(run, o.out, ChartMaker(run, o, size).Make(o.codes[0], o.out, output));
  return kDone;
}

// True when that chart stands in the folder; what stood against it was told under its code.
bool ChartInFolder(Run& run, ChartMaker& maker, const std::string& code, const std::string& folder,
                   const std::string& type) {
  run.dialogs.Begin(code);
  try {
    if (!IsFileCode(code)) run.Abandon("No File For That Name", "Name File");
    const std::string file = folder + CodeFileName(code, "." + type);
    WriteOutput(run, file, maker.Make(code, file, OutputOf(file)));
    return true;
  } catch (const Abandoned&) {
  } catch (const RunTimeError& e) {
    run.dialogs.Message(e.what(), "KORA");
  }
  return false;
}

void MakeFolder(Run& run, const std::string& folder) {
  std::error_code error;
  std::filesystem::create_directories(folder, error);
  if (!std::filesystem::is_directory(folder))
    run.Abandon(folder + " can't be made" + (error ? ": " + error.message() : ""), "KORA");
}

int ChartsToFolder(const CommandLine& line, const PictureOptions& o, const PictureSize& size) {
  Run run(line);
  OpenCharts(run, o);
  std::vector<std::string> codes;
  std::set<std::string> seen;
  for (const std::string& wanted : o.list.empty() ? o.codes : CodesOfList(run, o.list)) {
    const std::string code = UCase(Trim(wanted));
    if (seen.insert(code).second) codes.push_back(code);
  }
  const std::string type = o.type.empty() ? "png" : o.type;
  ChartMaker maker(run, o, size);
  if (type != "cht") maker.Load();
  MakeFolder(run, o.out);
  const auto progress = run.dialogs.StartProgress("Charts");
  int done = 0, failed = 0;
  for (const std::string& code : codes) {
    if (!ChartInFolder(run, maker, code, o.out, type)) ++failed;
    progress->Step(++done, int(codes.size()));
  }
  if (failed == 0) return kDone;
  run.dialogs.Begin("");
  run.dialogs.Message(
      std::to_string(failed) + " of " + std::to_string(codes.size()) + " charts could not be made",
      "KORA");
  return kAbandoned;
}

int Chart(const CommandLine& line, const PictureOptions& o) {
  const PictureSize size = CheckChartOptions(o, o.scale);
  if (o.codes.empty() == o.list.empty())
    throw UsageError("Either CODE or --list says what is charted");
  if (o.out.ends_with('/')) return ChartsToFolder(line, o, size);
  if (!o.list.empty() || o.codes.size() > 1)
    throw UsageError("--out: \"" + o.out + "\": several charts go into a folder (FOLDER/)");
  if (!o.type.empty()) throw UsageError("--type is for charts that go into a folder (FOLDER/)");
  return ChartToFile(line, o, size);
}

}  // namespace

void AddChart(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<PictureOptions>();
  CLI::App* c = app.add_subcommand("chart", "Draw a chart, or many");
  c->add_option("CODE", o->codes, "Codes of securities, in any case");
  AddChartOptions(*c, *o);
  AddChoice(*c, "--list", o->list, ListWords(),
            "In place of CODE: every security of a chart list, or of the name file");
  c->add_option("--scale", o->scale, "Pixels of a PNG to the unit")
      ->capture_default_str()
      ->check(CLI::Range(1, 8));
  c->add_option("--out", o->out,
                "FILE.cht, .png, .svg or .pdf; - for the script; FOLDER/ for a file a code")
      ->required()
      ->type_name("FILE");
  AddChoice(*c, "--type", o->type, {"png", "svg", "pdf", "cht"},
            "Kind of the files in FOLDER/ (default png)");
  c->callback([&line, o] { line.run = [&line, o] { return Chart(line, *o); }; });
}

}  // namespace kora
