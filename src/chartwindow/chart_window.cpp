#include "chartwindow/chart_window.h"

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::string_view kTitle = "Charts";

}  // namespace

ChartWindow::ChartWindow(const ChartWindowServices& services)
    : Request(RequestFromSettings(services.settings)), services_(services) {}

std::string ChartWindow::Title() const {
  return "KORA Charting 7F   -  CHARTS  " +
         std::string(Trim(services_.settings.paths.CurrentDataPath));
}

bool ChartWindow::NextChart() { return Move(1); }

bool ChartWindow::StepChart() { return Move(ChartDirection == 1 ? 1 : -1); }

bool ChartWindow::Redraw() {
  if (Loading || ChartIndex == 0) return false;
  --ChartIndex;
  return NextChart();
}

bool ChartWindow::Move(int step) {
  if (Loading) return false;
  Request.SuppressScript = false;
  EmptyDrawnLines();
  try {
    if (!LoadRecord(step)) return false;
  } catch (const RunTimeError& e) {
    ChartIndex = 0;
    services_.dialogs.Message("There is a file access problem. Check directory paths option.\n" +
                                  NameFilePath(services_.settings.paths.CurrentDataPath) + "  -  " +
                                  e.what(),
                              kTitle);
    return false;
  }
  return DrawChart();
}

bool ChartWindow::LoadRecord(int step) {
  CurrentName& current = services_.current;
  const NameFile names(services_.files,
                       NameFilePath(services_.settings.paths.CurrentDataPath));
  current.NameCount = CInt(names.count());
  if (current.NameCount == 0) {
    ChartIndex = 0;
    services_.dialogs.Message(" There are no records in Names.Dat for this folder.", kTitle);
    return false;
  }
  const int index = ChartIndex + step;
  if (index > current.NameCount) ChartIndex = 1;
  else if (index < 1) ChartIndex = current.NameCount;
  else ChartIndex = CInt(index);

  current.Rec = names.Read(ChartIndex);
  current.NameRecNo = ChartIndex;
  current.CurrentDataFile = std::string(current.Rec.Code.trimmed()) + ".WDT";
  // Such data has no bars. The style stays for the charts that follow.
  if (current.Rec.RecType >= kCloseVolume && current.Rec.RecType <= kAdvanceDecline &&
      (Request.ChartStyle == 'B' || Request.ChartStyle == 'C'))
    Request.ChartStyle = 'L';
  return true;
}

bool ChartWindow::DrawChart() {
  if (Loading) return false;
  Request.Name = services_.current.Rec;
  Request.OscName.clear();
  if (services_.panel) services_.panel->SetVisible(false);
  services_.dialogs.Yield();
  const Paths& paths = services_.settings.paths;
  ChartScript script(services_.files, paths.CurrentDataPath + "TCht.Tmp");
  const ChartServices services{.files = services_.files,
                               .dialogs = services_.dialogs,
                               .paths = paths,
                               .fonts = services_.settings.fonts,
                               .colours = services_.colours,
                               .price = services_.price,
                               .panel = services_.panel,
                               .script = &script};
  return ComposeChart(services, Request, Chart);
}

// What the mouse drew belongs to one chart.
void ChartWindow::EmptyDrawnLines() {
  if (SplitScreen) return;
  try {
    const std::string path = services_.settings.paths.CurrentDataPath + "ChtLns.Tmp";
    if (!services_.files.CheckFile(path)) return;
    if (services_.files.Open(path, OpenMode::kRead)->Size() > 0)
      services_.files.WriteAll(path, "");
  } catch (const RunTimeError&) {
    // A data folder that can't be written still shows charts.
  }
}

}  // namespace kora
