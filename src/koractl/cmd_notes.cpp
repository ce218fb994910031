#include <memory>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chartwindow/tools/text_note.h"
#include "koractl/chart_options.h"
#include "koractl/mouse_tools.h"
#include "koractl/options.h"
#include "koractl/table.h"
#include "platform/headless/headless_surface.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Text";

struct NoteOptions : ChartOptions {
  std::string code;
  std::string action, text, at;
};

std::string PathOf(Run& run) {
  return ChartNotesPath(run.session.settings.paths.ChartMiscPath,
                        run.session.current.Rec.Code.trimmed());
}

void PrintNotes(Run& run) {
  Table table("Date Price Text Colour");
  for (const NoteLine& note : ReadNoteLines(run.session.files, PathOf(run)))
    if (note.readable)
      table.Text(note.Date)
          .Number(CSng(note.Price))
          .Text(ToAnsi(note.Text))
          .Number(note.Colour)
          .EndRow();
  table.Print();
}

void AddNote(Run& run, const NoteOptions& o, const ChartRequest& request, const PictureSize& size,
             const std::vector<double>& at) {
  HeadlessSurface price(size.width, size.height), panel(size.width, size.panel);
  ChartScript script;
  Composition chart;
  Compose(run, o, request, script, price, size.panel > 0 ? &panel : nullptr, &chart);
  ToolStage stage(run, chart, request, price, script);
  TextNoteTool tool(stage.view());
  const size_t before = script.text().size();
  tool.Press({at[0], at[1]}, MouseButton::kLeft);
  for (const char c : o.text) tool.Type(char32_t(static_cast<unsigned char>(c)));
  tool.Type(13);
  if (run.dialogs.said()) throw Abandoned();  // it told why the text is not on file
  if (script.text().size() == before) run.Abandon("There is no text to keep", kTitle);
}

// `n` counts the texts as they are listed; lines that are none stay.
void DeleteNote(Run& run, std::int32_t n) {
  std::vector<NoteLine> notes = ReadNoteLines(run.session.files, PathOf(run));
  for (size_t i = 0; i < notes.size(); ++i) {
    if (!notes[i].readable || --n > 0) continue;
    notes.erase(notes.begin() + std::ptrdiff_t(i));
    WriteNoteLines(run.session.files, PathOf(run), notes);
    return;
  }
  throw RunTimeError(kBadRecordNumber);
}

int Notes(const CommandLine& line, const NoteOptions& o) {
  const bool add = o.action == "add", remove = o.action == "delete";
  if (add != !o.at.empty() || (add && o.text.empty()))
    throw UsageError("notes CODE add --at X,Y TEXT");
  const double n = Val(o.text);
  if (remove && !(n >= 1 && n <= 32767 && n == Int(n) && o.text.size() < 6))
    throw UsageError("notes CODE delete N");
  if (!add && !remove && !o.text.empty()) throw UsageError("notes CODE " + o.action);
  const std::vector<double> at = add ? ReadPlaces("--at", o.at, 2) : std::vector<double>();
  const PictureSize size = CheckChartOptions(o);
  Run run(line);
  OpenCharts(run, o);
  const ChartRequest request = FindChart(run, o, o.code);
  try {
    if (o.action.empty()) PrintNotes(run);
    if (add) AddNote(run, o, request, size, at);
    if (remove) DeleteNote(run, CLng(n));
    if (o.action == "clear") RemoveNotes(run.session.files, PathOf(run));
  } catch (const RunTimeError& e) {
    run.Abandon(e.what(), kTitle);
  }
  // What was told kept it from being saved.
  return run.dialogs.said() ? kAbandoned : kDone;
}

}  // namespace

void AddNotes(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<NoteOptions>();
  CLI::App* c = app.add_subcommand("notes", "Show, write and delete the texts on a chart");
  c->add_option("CODE", o->code, "Code of the security, in any case")->required();
  AddChoice(*c, "ACTION", o->action, {"add", "delete", "clear"}, "Without one they are shown");
  c->add_option("TEXT", o->text, "What to write, or the number of the text to delete");
  AddChartOptions(*c, *o);
  c->add_option("--at", o->at, "Upper left corner of the text on that chart")->type_name("X,Y");
  c->callback([&line, o] { line.run = [&line, o] { return Notes(line, *o); }; });
}

}  // namespace kora
