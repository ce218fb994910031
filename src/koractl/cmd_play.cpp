#include <memory>

#include "chart/script_player.h"
#include "koractl/options.h"
#include "koractl/picture_output.h"
#include "koractl/pictures/pictures.h"

namespace kora {
namespace {

struct PlayOptions {
  std::string file;
  std::string size = "638x452";
  int scale = 1;
  std::string out;
};

int Play(const CommandLine& line, const PlayOptions& o) {
  const PictureSize size = ReadSize(o.size, o.scale);
  if (OutputOf(o.out) != Output::kPicture)
    throw UsageError("--out: \"" + o.out + "\" ends in none of .png, .svg, .pdf");
  Run run(line);
  run.Open();
  Session& s = run.session;
  const std::string file = s.files.DosPath(run.HostPathOf(o.file));
  const auto pictures = LoadPictures();
  const std::string bytes =
      pictures->Make(PictureKindOf(o.out), size, [&](Surface& surface, Surface*) {
        surface.SetBackColour(s.colours[kBackground]);
        if (!ShowSavedChart(s.files, run.dialogs, surface, s.settings.fonts, s.colours, file))
          throw Abandoned();
      });
  WriteOutput(run, o.out, bytes);
  return kDone;
}

}  // namespace

void AddPlay(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<PlayOptions>();
  CLI::App* c = app.add_subcommand("play", "Play a saved chart");
  c->add_option("FILE", o->file, "A saved chart, .cht")->required();
  c->add_option("--size", o->size, "Width and height of the picture")
      ->type_name("WxH")
      ->capture_default_str();
  c->add_option("--scale", o->scale, "Pixels of a PNG to the unit")
      ->capture_default_str()
      ->check(CLI::Range(1, 8));
  c->add_option("--out", o->out, "FILE.png, .svg or .pdf")->required()->type_name("FILE");
  c->callback([&line, o] { line.run = [&line, o] { return Play(line, *o); }; });
}

}  // namespace kora
