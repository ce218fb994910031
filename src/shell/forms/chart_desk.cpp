#include "shell/forms/chart_desk.h"

#include <QApplication>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QTimer>
#include <memory>

#include "base/dates.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chart/forms/CHTPage.h"
#include "chart/forms/Page.h"
#include "chart/forms/PrinterSetup.h"
#include "chart/forms/print_job.h"
#include "chartwindow/forms/Chart2.h"
#include "chartwindow/forms/ChtSel.h"
#include "indicators/forms/ChtBands.h"
#include "indicators/forms/ChtDef.h"
#include "indicators/forms/MMASet.h"
#include "indicators/forms/MultiOsc.h"
#include "indicators/forms/OscFrm.h"
#include "indicators/forms/StpLs.h"
#include "indicators/forms/SwingSet.h"
#include "lists/chart_list.h"
#include "lists/forms/CLNames.h"
#include "lists/forms/SubList.h"
#include "lists/forms/SubList2.h"
#include "looks/forms/BlankSpc.h"
#include "looks/forms/ChtFonts.h"
#include "looks/forms/ChtSp.h"
#include "looks/forms/ColNew.h"
#include "looks/forms/FinDate.h"
#include "looks/forms/GLSpaces.h"
#include "looks/forms/PLW.h"
#include "looks/forms/Scales.h"
#include "looks/forms/VHeight.h"
#include "maintenance/forms/TxtData.h"
#include "platform/qt/form_parts.h"
#include "platform/qt/modal.h"
#include "store/name_file.h"

namespace kora {
namespace {

// Opens a form that goes when it is closed.
template <typename Form>
Form* Show(Form* form) {
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
  return form;
}

// Gives a window another caption and returns the one before.
std::function<std::string(const std::string&)> CaptionSwapper(QPointer<QWidget> window) {
  return [window](const std::string& caption) {
    if (!window) return std::string();
    const std::string before = window->windowTitle().toStdString();
    window->setWindowTitle(QString::fromStdString(caption));
    // Printing leaves no time for what is painted later.
    if (QWidget* frame = window->parentWidget()) frame->repaint();
    return before;
  };
}

}  // namespace

ChartDesk::ChartDesk(Session& session, QWidget* over, QMdiArea* mdi, ChartDeskHooks hooks)
    : session_(session),
      over_(over),
      mdi_(mdi),
      hooks_(std::move(hooks)),
      selection_({.files = session.files,
                  .dialogs = session.dialogs,
                  .settings = session.settings,
                  .ini = session.ini,
                  .user = session.user,
                  .state = session.charts,
                  .current = session.current}),
      printer_([this](const std::string& bytes) {
        session_.files.WriteAll(printChoice_.pdfFile, bytes);
      }) {}

QWidget* ChartDesk::Over() const { return chts_ ? static_cast<QWidget*>(chts_.data()) : over_; }

void ChartDesk::Refresh() {
  if (anal_)
    anal_->Command2();
  else if (chts_ && chts_->window().HasChart())
    chts_->Refresh();
}

LookServices ChartDesk::Look(std::function<void()> saved) {
  return {session_.ini, session_.settings, session_.dialogs, std::move(saved)};
}

void ChartDesk::PathsChanged() {
  CloseView();
  if (chts_) chts_->RefreshTitle();
  selection_.FolderChanged();
}

// ---- The chart window

void ChartDesk::OpenCharts() {
  if (chts_) {
    auto* frame = qobject_cast<QMdiSubWindow*>(chts_->parentWidget());
    if (frame->isMinimized() || frame->isShaded()) frame->showNormal();
    mdi_->setActiveSubWindow(frame);
    chts_->setFocus();
    return;
  }
  if (!AnySecurity()) return;
  OpenWindow();
  session_.charts.ChartStartup = true;
  OpenSelection();
}

void ChartDesk::StandWindow() {
  if (selectionForm_) delete selectionForm_;
  if (secondForm_) delete secondForm_;
  if (!chts_) {
    // In a run that has not met chart selection yet charts are drawn as the settings have them.
    // Where there is nothing to select a saved chart can be shown all the same.
    if (CountSecurities() > 0) selection_.Load();
    OpenWindow();
  }
  if (auto* frame = qobject_cast<QMdiSubWindow*>(chts_->parentWidget()))
    mdi_->setActiveSubWindow(frame);
}

void ChartDesk::ShowSavedChart(const std::string& path) {
  StandWindow();
  chts_->ShowSavedFile(path);
}

void ChartDesk::ShowChart(std::int16_t ChartListNo, std::int16_t place) {
  StandWindow();
  ChartState& state = session_.charts;
  state.ChartListNo = ChartListNo;
  state.ChartListName = ChartListNo == kFullList ? std::string(" FULL LIST   (Names.Dat)")
                                                 : ChartListName(session_.user, ChartListNo);
  state.ICFilterOn = false;
  state.ICFilter.clear();
  state.ChartDirection = 1;
  state.ChartIndex = std::int16_t(place);
  chts_->ShowChosen();
}

size_t ChartDesk::CountSecurities() const {
  try {
    return ReadNames(session_.files, session_.settings.paths.CurrentDataPath).size();
  } catch (const RunTimeError&) {
    return 0;
  }
}

// Without one there is nothing to choose from, and what to do next is told instead.
bool ChartDesk::AnySecurity() {
  const std::string& folder = session_.settings.paths.CurrentDataPath;
  std::string why;
  try {
    if (!ReadNames(session_.files, folder).empty()) return true;
    why = session_.files.IsFolder(folder) ? "There are no securities in " + folder
                                          : "There is no folder " + folder;
  } catch (const RunTimeError& e) {
    why = "The name file in " + folder + " can't be read: " + e.what();
  }
  session_.dialogs.Message(
      why +
          "\n\nBring prices in (Download, or koractl import), make an invented market with koractl "
          "demo, or choose another folder in File, Folder Locations.",
      "CHARTS");
  hooks_.menusBack();
  return false;
}

void ChartDesk::OpenWindow() {
  chts_ = new Chts({.files = session_.files,
                    .dialogs = session_.dialogs,
                    .settings = session_.settings,
                    .ini = session_.ini,
                    .user = session_.user,
                    .colours = session_.colours,
                    .current = session_.current,
                    .state = session_.charts,
                    .VolumeUnitText = hooks_.VolumeUnitText,
                    .closed =
                        [this] {
                          CloseView();
                          if (selectionForm_) selectionForm_->deleteLater();
                          hooks_.menusBack();
                        },
                    .zoomOver = [this] { return over_; }});
  WireWindow();
  QMdiSubWindow* frame = mdi_->addSubWindow(chts_);
  frame->setAttribute(Qt::WA_DeleteOnClose);
  frame->setGeometry(mdi_->viewport()->rect());
  frame->show();
  chts_->setFocus();
  // With the layout done the pictures have their sizes.
  QApplication::sendPostedEvents();
}

void ChartDesk::WireWindow() {
  const auto look = [this](auto make) {
    return [this, make] { RunForm(make(Look([this] { Refresh(); }))); };
  };
  Chts& w = *chts_;
  w.SetForm("new", [this] { OpenSelection(); });
  w.SetForm("Chart2", [this] { OpenSecondChart(); });
  w.SetForm("OscFrm", [this] { OpenOscFrm(); });
  w.SetForm("mo1", [this] { OpenView(1); });
  w.SetForm("mo2", [this] { OpenView(2); });
  w.SetForm("cmuMOS", [this] { OpenMultiOsc(); });
  w.SetForm("cmChtDef", [this] { OpenChtDef(ChtDefOpener::kChartWindow); });
  w.SetForm("cmChtSpaces", [this] { OpenChtSp(); });
  w.SetForm("cmPageSetup", [this] { OpenPage(); });
  w.SetForm("cmPrintChart", [this] { PrintChart(); });
  w.SetForm("cmColours", [this] {
    RunForm(new ColNew({.files = session_.files,
                        .systemPath = session_.settings.paths.SystemPath,
                        .dialogs = session_.dialogs,
                        .colours = session_.colours,
                        .closed = [this] { Refresh(); }},
                       chts_));
  });
  w.SetForm("cmfonts", look([this](LookServices s) { return new ChtFonts(s, chts_); }));
  w.SetForm("cmBSpaces", look([this](LookServices s) { return new BlankSpc(s, chts_); }));
  w.SetForm("cmGLSpaces", look([this](LookServices s) { return new GLSpaces(s, chts_); }));
  w.SetForm("cmLineWidth", look([this](LookServices s) { return new PLW(s, chts_); }));
  w.SetForm("cmVHeight", look([this](LookServices s) { return new VHeight(s, chts_); }));
  w.window().SetAskBoxValue([this](float computed) { return AskBoxValue(computed); });
  w.SetForm("cmuSwingsettings", [this] { OpenSwingSet(); });
  w.SetForm("cmMMASet", look([this](LookServices s) { return new MMASet(s, chts_); }));
  w.SetForm("cmRText", [this] { OpenTexts(); });
  // The window draws again itself when this one is closed.
  w.SetForm("cmSLInd", [this] { RunForm(new StpLs(Look({}), chts_)); });
  OfferStock();
}

void ChartDesk::OfferStock() {
  if (!chts_) return;
  std::function<void()> open;
  if (hooks_.canShowStock && hooks_.canShowStock())
    open = [this] {
      if (chts_->window().HasChart())
        hooks_.showStock(std::string(session_.current.Rec.Code.trimmed()), chts_);
    };
  chts_->SetForm("cmStkDetails", std::move(open));
}

void ChartDesk::PricesChanged() {
  OfferStock();
  Refresh();
}

void ChartDesk::OpenTexts() {
  auto form = std::make_unique<TxtData>(
      TxtDataServices{.files = session_.files,
                      .dialogs = session_.dialogs,
                      .ChartMiscPath = session_.settings.paths.ChartMiscPath,
                      .code = std::string(Trim(session_.current.Rec.Code.trimmed())),
                      .refresh = [this] { Refresh(); }},
      chts_);
  if (chts_->window().HasChart() && form->Fill()) RunForm(form.release());
}

// ---- The multi-oscillator view

void ChartDesk::OpenView(int set) {
  if (!chts_) return;
  if (anal_) {
    mdi_->setActiveSubWindow(qobject_cast<QMdiSubWindow*>(anal_->parentWidget()));
    anal_->ShowSet(set);
    return;
  }
  chts_->window().AnalPageMode = true;
  anal_ = new Anal(
      {.view = {.files = session_.files,
                .dialogs = session_.dialogs,
                .settings = session_.settings,
                .user = session_.user,
                .colours = session_.colours,
                .current = session_.current,
                .state = session_.charts,
                .VolumeUnitText = hooks_.VolumeUnitText},
       .print = [this] { PrintView(); },
       // The view has closed itself in the middle of an event of its menu bar, which a
       // form that ran within that event would take away.
       .openMultiOsc = [this] { QTimer::singleShot(0, over_, [this] { OpenMultiOsc(); }); },
       .returned =
           [this] {
             if (!anal_) return;
             anal_.clear();
             if (!chts_) return;
             chts_->window().AnalPageMode = false;
             mdi_->setActiveSubWindow(qobject_cast<QMdiSubWindow*>(chts_->parentWidget()));
             chts_->setFocus();
             Refresh();
           }},
      set);
  QMdiSubWindow* frame = mdi_->addSubWindow(anal_);
  frame->setAttribute(Qt::WA_DeleteOnClose);
  frame->setGeometry(chts_->parentWidget()->geometry());
  frame->show();
  anal_->setFocus();
  // One chart is on show at a time: who goes to the chart window leaves the view.
  QObject::connect(mdi_, &QMdiArea::subWindowActivated, anal_.data(),
                   [chts = chts_, anal = anal_](QMdiSubWindow* active) {
                     if (active && chts && anal && active == chts->parentWidget()) anal->Leave();
                   });
  QApplication::sendPostedEvents();
  if (anal_) anal_->Command2();
}

// Without a chart drawn behind it.
void ChartDesk::CloseView() {
  if (!anal_) return;
  QWidget* frame = anal_->parentWidget();
  anal_.clear();
  if (chts_) chts_->window().AnalPageMode = false;
  frame->close();
}

void ChartDesk::OpenMultiOsc() {
  Modal<MultiOsc> form(MultiOscServices{session_.user, session_.dialogs}, Over());
  if (form.Run()) Refresh();
}

void ChartDesk::PrintView() {
  if (Printing().printer.Orientation() == kLandscape &&
      session_.dialogs.Ask("You have your page orientation set as landscape. This may not print "
                           "correctly. Do you want to continue ?",
                           "Print Chart", Buttons::kYesNo) != Answer::kYes)
    return;
  const std::string name(session_.current.Rec.Code.trimmed());
  printChoice_.pdfFile = session_.settings.paths.ChartSavePath + name + ".pdf";
  AskAndPrint(Printing(), printChoice_,
              {.chart = anal_->Size(),
               .scriptPath = anal_->view().ScriptPath(),
               .swapCaption = CaptionSwapper(anal_.data()),
               .done = {}},
              anal_);
}

float ChartDesk::AskBoxValue(float computed) {
  boxValue_ = computed;
  RunForm(new OscFrm({.files = session_.files,
                      .dialogs = session_.dialogs,
                      .settings = session_.settings,
                      .chartPeriod = session_.charts.ChartPeriod,
                      .chartStyle = Style::kPointFigure,
                      .boxValue = boxValue_,
                      .redraw = {}},
                     {}, Over()));
  return boxValue_;
}

void ChartDesk::OpenSwingSet() {
  SwingChoice choice = session_.charts.Swing;
  RunForm(new SwingSet({session_.dialogs, choice,
                        [this, &choice] {
                          session_.charts.Swing = choice;
                          if (session_.charts.SwingOn) Refresh();
                        }},
                       chts_));
}

void ChartDesk::OpenOscFrm() {
  RunForm(new OscFrm({.files = session_.files,
                      .dialogs = session_.dialogs,
                      .settings = session_.settings,
                      .chartPeriod = session_.charts.ChartPeriod,
                      .chartStyle = session_.charts.ChartStyle,
                      .boxValue = boxValue_,
                      .redraw =
                          [this] {
                            if (chts_) chts_->window().ShowOscillator();
                          }},
                     session_.charts.OscCode, Over()));
}

void ChartDesk::OpenChtSp() {
  RunForm(new ChtSp(Look([this] {
                      session_.charts.BarSpacing = session_.settings.charts.Spacing;
                      Refresh();
                    }),
                    session_.charts.ChartStyle, Over()));
}

// ---- Printing

PrintServices ChartDesk::Printing() {
  // The printer starts with its page as it was kept; from then on the forms turn it.
  if (!pageTurned_) {
    pageTurned_ = true;
    const std::int16_t kept = session_.settings.page.Orient;
    if (kept == kPortrait || kept == kLandscape) printer_.SetOrientation(kept);
  }
  return {session_.files,   session_.ini,     session_.dialogs, session_.settings,
          session_.colours, session_.printer, printer_};
}

void ChartDesk::OpenPage() {
  const QSizeF size = chts_->ChartSize();
  std::string script;
  try {
    script = session_.files.ReadAll(chts_->window().ScriptOnShow());
  } catch (const RunTimeError&) {
    // Nothing was charted yet: the sheet shows an empty box.
  }
  Show(new Page(Printing(), {size.width(), size.height()}, std::move(script), chts_))
      ->CheckPrinter();
}

void ChartDesk::PrintChart() {
  const QSizeF size = chts_->ChartSize();
  if (chts_->window().ScriptOnShow().empty()) {
    session_.dialogs.Message("There is no chart to print", "Print Chart");
    return;
  }
  std::string name = chts_->window().SuggestedName();
  name = name.substr(0, name.find_last_of('.'));
  printChoice_.pdfFile = session_.settings.paths.ChartSavePath + name + ".pdf";
  const QPointer<Chts> window = chts_;
  AskAndPrint(Printing(), printChoice_,
              {.chart = {size.width(), size.height()},
               .scriptPath = window->window().ScriptOnShow(),
               .swapCaption = CaptionSwapper(window.data()),
               .done = {}},
              chts_);
}

void ChartDesk::OpenTextPage() { Show(new CHTPage(Printing(), over_))->CheckPrinter(); }

void ChartDesk::PrintList(const TextTable& table, QWidget* over) {
  printChoice_.pdfFile = session_.settings.paths.SystemPath + table.layout.heading + ".pdf";
  AskAndPrintTable(Printing(), printChoice_, table, over);
}

void ChartDesk::OpenPrinterSetup() { Show(new PrinterSetup(Printing(), over_)); }

// ---- Chart selection

ChtSelServices ChartDesk::SelectionServices() {
  return {
      .selection = selection_,
      .state = session_.charts,
      .files = session_.files,
      .dialogs = session_.dialogs,
      .settings = session_.settings,
      .user = session_.user,
      .colours = session_.colours,
      .showChart =
          [this] {
            if (!chts_) return;
            over_->activateWindow();
            chts_->setFocus();
            chts_->ShowChosen();
          },
      .showWindow =
          [this] {
            if (!chts_) OpenWindow();
          },
      .closed =
          [this] {
            if (chts_) chts_->parentWidget()->close();
            hooks_.menusBack();
          },
      .openChtDef =
          [this](const auto& averagesChanged) {
            OpenChtDef(ChtDefOpener::kChartSelection, averagesChanged);
          },
      .openFinDate = [this] { return OpenFinDate(); },
      .openChtBands = [this] { OpenChtBands(); },
      .openWMPath =
          [this] { return hooks_.openWMPath(selectionForm_ ? selectionForm_.data() : Over()); }};
}

void ChartDesk::OpenSelection() {
  if (selectionForm_) {
    selectionForm_->activateWindow();
    return;
  }
  // One form at a time works on the selection.
  if (secondForm_) delete secondForm_;
  struct Standing {
    ChartState state;
    CurrentName current;
    ChartSettings charts;
    std::string folder;
  };
  const auto take = [this] {
    return Standing{session_.charts, session_.current, session_.settings.charts,
                    session_.settings.paths.CurrentDataPath};
  };
  const auto standing = std::make_shared<Standing>(take());
  ChtSelServices services = SelectionServices();
  services.backToChart = [this, standing] {
    if (!chts_ || !(chts_->window().Chart.ChartDrawn || chts_->window().ChartFromFile))
      return false;
    if (session_.settings.paths.CurrentDataPath == standing->folder) {
      const ChartSettings& now = session_.settings.charts;
      session_.charts = standing->state;
      session_.current = standing->current;
      // Set in the defaults meanwhile.
      if (now.AvOne != standing->charts.AvOne) session_.charts.Ma1On = now.AvOne;
      if (now.AvTwo != standing->charts.AvTwo) session_.charts.Ma2On = now.AvTwo;
    }
    session_.charts.ChartStartup = false;
    chts_->BackToChart();
    return true;
  };
  const bool first = standing->state.ChartIndex == 0;
  selectionForm_ = Show(new ChtSel(std::move(services), over_));
  // The window draws the first chart by itself as it opens.
  if (first) *standing = take();
}

void ChartDesk::OpenSecondChart() {
  if (secondForm_) {
    secondForm_->activateWindow();
    return;
  }
  ChtSelServices services = SelectionServices();
  // Leaving it leaves the first chart alone: the next one has the surface to itself.
  services.closed = {};
  services.secondDropped = [this, index = session_.charts.ChartIndex, current = session_.current] {
    session_.charts.ChartIndex = index;
    session_.current = current;
    if (chts_) chts_->DropSecondChart();
  };
  secondForm_ = new Chart2(std::move(services), Over());
  secondForm_->setAttribute(Qt::WA_DeleteOnClose);
  secondForm_->show();
}

bool ChartDesk::OpenFinDate() {
  ChartState& state = session_.charts;
  std::string date = state.ChosenLimitDate;
  bool on = state.DateLimitOn, chosen = false;
  RunForm(new FinDate({.dialogs = session_.dialogs,
                       .FinishDate = date,
                       .FinishDateOn = on,
                       .saved = [&chosen] { chosen = true; }},
                      selectionForm_ ? selectionForm_.data() : Over()));
  const auto limit = ParseFileDate(date);
  if (!chosen || !on || !limit) return false;
  state.ChosenLimitDate = date;
  state.ChosenLimitText = FormatUserDate(*limit);
  return true;
}

void ChartDesk::OpenChtBands() {
  RunForm(new ChtBands({.files = session_.files,
                        .dataPath = session_.settings.paths.CurrentDataPath,
                        .dialogs = session_.dialogs,
                        .current = session_.current,
                        .saved = {}},
                       BandForm::kPercentage, selectionForm_ ? selectionForm_.data() : Over()));
}

// ---- Forms of the menu

void ChartDesk::OpenChtDef(ChtDefOpener opener, const std::function<void()>& averagesChanged) {
  QWidget* parent =
      opener == ChtDefOpener::kChartSelection && selectionForm_ ? selectionForm_.data() : Over();
  RunForm(new ChtDef({.ini = session_.ini,
                      .files = session_.files,
                      .dialogs = session_.dialogs,
                      .settings = session_.settings,
                      .colours = session_.colours,
                      .chartPeriod = session_.charts.ChartPeriod,
                      .opener = opener,
                      .readSettings = hooks_.readSettings,
                      .openScales =
                          [this] {
                            RunForm(new Scales({.files = session_.files,
                                                .dataPath = session_.settings.paths.CurrentDataPath,
                                                .dialogs = session_.dialogs,
                                                .current = session_.current,
                                                .saved = {}},
                                               Over()));
                          },
                      .refreshChart = [this] { Refresh(); },
                      .averagesChanged =
                          [this, averagesChanged] {
                            session_.charts.Ma1On = session_.settings.charts.AvOne;
                            session_.charts.Ma2On = session_.settings.charts.AvTwo;
                            if (averagesChanged) averagesChanged();
                          }},
                     parent));
}

void ChartDesk::OpenDefaults() { OpenChtDef(ChtDefOpener::kShell); }

void ChartDesk::OpenFonts() {
  Show(new ChtFonts(Look([this] { Refresh(); }), over_));
}

void ChartDesk::OpenLists() {
  Show(new SubList({.files = session_.files,
                    .dialogs = session_.dialogs,
                    .settings = session_.settings,
                    .user = session_.user,
                    .openCodes = hooks_.openCodes},
                   over_));
}

void ChartDesk::OpenListUtilities() {
  Show(new SubList2({session_.files, session_.dialogs, session_.settings, session_.user}, over_));
}

void ChartDesk::OpenListNames() {
  Show(new CLNames({session_.files, session_.dialogs, session_.settings, session_.user}, over_));
}

}  // namespace kora
