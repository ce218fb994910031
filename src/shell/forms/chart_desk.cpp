#include "shell/forms/chart_desk.h"

#include <QApplication>
#include <QMdiArea>
#include <QMdiSubWindow>

#include "base/dates.h"
#include "base/runtime_error.h"
#include "chart/forms/CHTPage.h"
#include "chart/forms/Page.h"
#include "chart/forms/PrinterSetup.h"
#include "chart/forms/print_job.h"
#include "chartwindow/forms/Chart2.h"
#include "chartwindow/forms/ChtSel.h"
#include "indicators/forms/ChtBands.h"
#include "indicators/forms/ChtDef.h"
#include "indicators/forms/MMASet.h"
#include "indicators/forms/OscFrm.h"
#include "indicators/forms/StpLs.h"
#include "lists/forms/CLNames.h"
#include "lists/forms/SubList.h"
#include "lists/forms/SubList2.h"
#include "store/forms/BlankSpc.h"
#include "store/forms/ChtFonts.h"
#include "store/forms/ChtSp.h"
#include "store/forms/ColNew.h"
#include "store/forms/FinDate.h"
#include "store/forms/GLSpaces.h"
#include "store/forms/PLW.h"
#include "store/forms/Scales.h"
#include "store/forms/VHeight.h"

namespace kora {
namespace {

// Opens a form that goes when it is closed.
template <typename Form>
Form* Show(Form* form) {
  form->setAttribute(Qt::WA_DeleteOnClose);
  form->open();
  return form;
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

QWidget* ChartDesk::Over() const {
  return chts_ ? static_cast<QWidget*>(chts_.data()) : over_;
}

void ChartDesk::Refresh() {
  if (chts_ && chts_->window().HasChart()) chts_->Refresh();
}

LookServices ChartDesk::Look(std::function<void()> saved) {
  return {session_.ini, session_.settings, session_.dialogs, std::move(saved)};
}

void ChartDesk::PathsChanged() {
  if (chts_) chts_->RefreshTitle();
  selection_.FolderChanged();
}

// ---- The chart window

void ChartDesk::OpenCharts() {
  if (chts_) {
    mdi_->setActiveSubWindow(qobject_cast<QMdiSubWindow*>(chts_->parentWidget()));
    chts_->setFocus();
    return;
  }
  OpenWindow();
  session_.charts.ChartStartup = true;
  OpenSelection();
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
                    .closed = [this] {
                      if (selectionForm_) selectionForm_->deleteLater();
                      hooks_.menusBack();
                    }});
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
    return [this, make] {
      auto form = make(Look([this] { Refresh(); }));
      form->exec();
      delete form;
    };
  };
  Chts& w = *chts_;
  w.SetForm("new", [this] { OpenSelection(); });
  w.SetForm("Chart2", [this] { OpenSecondChart(); });
  w.SetForm("OscFrm", [this] { OpenOscFrm(); });
  w.SetForm("cmChtDef", [this] { OpenChtDef(ChtDefOpener::kChartWindow); });
  w.SetForm("cmChtSpaces", [this] { OpenChtSp(); });
  w.SetForm("cmPageSetup", [this] { OpenPage(); });
  w.SetForm("cmPrintChart", [this] { PrintChart(); });
  w.SetForm("cmColours", [this] {
    ColNew form({.files = session_.files,
                 .systemPath = session_.settings.paths.SystemPath,
                 .dialogs = session_.dialogs,
                 .colours = session_.colours,
                 .closed = [this] { Refresh(); }},
                chts_);
    form.exec();
  });
  w.SetForm("cmfonts", look([this](LookServices s) { return new ChtFonts(s, chts_); }));
  w.SetForm("cmBSpaces", look([this](LookServices s) { return new BlankSpc(s, chts_); }));
  w.SetForm("cmGLSpaces", look([this](LookServices s) { return new GLSpaces(s, chts_); }));
  w.SetForm("cmLineWidth", look([this](LookServices s) { return new PLW(s, chts_); }));
  w.SetForm("cmVHeight", look([this](LookServices s) { return new VHeight(s, chts_); }));
  w.SetForm("cmMMASet", look([this](LookServices s) { return new MMASet(s, chts_); }));
  // The window draws again itself when this one is closed.
  w.SetForm("cmSLInd", [this] {
    StpLs form(Look({}), chts_);
    form.exec();
  });
}

void ChartDesk::OpenOscFrm() {
  OscFrm form({.files = session_.files,
               .dialogs = session_.dialogs,
               .settings = session_.settings,
               .chartPeriod = session_.charts.ChartPeriod,
               .chartStyle = session_.charts.ChartStyle,
               .boxValue = boxValue_,
               .redraw = [this] {
                 if (chts_) chts_->window().ShowOscillator();
               }},
              session_.charts.OscCode, Over());
  form.exec();
}

void ChartDesk::OpenChtSp() {
  ChtSp form(Look([this] {
               session_.charts.BarSpacing = session_.settings.charts.Spacing;
               Refresh();
             }),
             session_.charts.ChartStyle, Over());
  form.exec();
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
  const ChartWindow& shown = chts_->window();
  std::string name(session_.current.Rec.Code.trimmed());
  if (shown.ChartFromFile) {
    name = shown.SavedChartFile.substr(shown.SavedChartFile.find_last_of('\\') + 1);
    name = name.substr(0, name.find_last_of('.'));
  }
  printChoice_.pdfFile = session_.settings.paths.ChartSavePath + name + ".pdf";
  const QPointer<Chts> window = chts_;
  AskAndPrint(Printing(), printChoice_,
              {.chart = {size.width(), size.height()},
               .scriptPath = window->window().ScriptOnShow(),
               .swapCaption = [window](const std::string& caption) {
                 if (!window) return std::string();
                 const std::string before = window->windowTitle().toStdString();
                 window->setWindowTitle(QString::fromStdString(caption));
                 // Printing leaves no time for what is painted later.
                 if (QWidget* frame = window->parentWidget()) frame->repaint();
                 return before;
               },
               .done = {}},
              chts_);
}

void ChartDesk::OpenTextPage() { Show(new CHTPage(Printing(), over_))->CheckPrinter(); }

void ChartDesk::OpenPrinterSetup() { Show(new PrinterSetup(Printing(), over_)); }

// ---- Chart selection

ChtSelServices ChartDesk::SelectionServices() {
  return {.selection = selection_,
          .state = session_.charts,
          .files = session_.files,
          .dialogs = session_.dialogs,
          .settings = session_.settings,
          .user = session_.user,
          .colours = session_.colours,
          .showChart = [this] {
            if (!chts_) return;
            over_->activateWindow();
            chts_->setFocus();
            chts_->Command2();
          },
          .showWindow = [this] {
            if (!chts_) OpenWindow();
          },
          .closed = [this] {
            if (chts_) chts_->parentWidget()->close();
            hooks_.menusBack();
          },
          .openChtDef = [this](const auto& averagesChanged) {
            OpenChtDef(ChtDefOpener::kChartSelection, averagesChanged);
          },
          .openFinDate = [this] { return OpenFinDate(); },
          .openChtBands = [this] { OpenChtBands(); },
          .openWMPath = [this] {
            return hooks_.openWMPath(selectionForm_ ? selectionForm_.data() : Over());
          }};
}

void ChartDesk::OpenSelection() {
  if (selectionForm_) {
    selectionForm_->activateWindow();
    return;
  }
  // One form at a time works on the selection.
  if (secondForm_) delete secondForm_;
  selectionForm_ = Show(new ChtSel(SelectionServices(), over_));
}

void ChartDesk::OpenSecondChart() {
  if (secondForm_) {
    secondForm_->activateWindow();
    return;
  }
  ChtSelServices services = SelectionServices();
  // Leaving it leaves the first chart alone: the next one has the surface to itself.
  services.closed = {};
  services.secondDropped = [this, index = session_.charts.ChartIndex,
                            current = session_.current] {
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
  FinDate form({.dialogs = session_.dialogs,
                .FinishDate = date,
                .FinishDateOn = on,
                .saved = [&chosen] { chosen = true; }},
               selectionForm_ ? selectionForm_.data() : Over());
  form.exec();
  const auto limit = ParseFileDate(date);
  if (!chosen || !on || !limit) return false;
  state.ChosenLimitDate = date;
  state.ChosenLimitText = FormatUserDate(*limit);
  return true;
}

void ChartDesk::OpenChtBands() {
  ChtBands form({.files = session_.files,
                 .dataPath = session_.settings.paths.CurrentDataPath,
                 .dialogs = session_.dialogs,
                 .current = session_.current,
                 .saved = {}},
                BandForm::kPercentage, selectionForm_ ? selectionForm_.data() : Over());
  form.exec();
}

// ---- Forms of the menu

void ChartDesk::OpenChtDef(ChtDefOpener opener, const std::function<void()>& averagesChanged) {
  QWidget* parent = opener == ChtDefOpener::kChartSelection && selectionForm_
                        ? selectionForm_.data()
                        : Over();
  ChtDef form({.ini = session_.ini,
               .files = session_.files,
               .dialogs = session_.dialogs,
               .settings = session_.settings,
               .colours = session_.colours,
               .chartPeriod = session_.charts.ChartPeriod,
               .opener = opener,
               .readSettings = hooks_.readSettings,
               .openScales = [this] {
                 Scales scales({.files = session_.files,
                                .dataPath = session_.settings.paths.CurrentDataPath,
                                .dialogs = session_.dialogs,
                                .current = session_.current,
                                .saved = {}},
                               Over());
                 scales.exec();
               },
               .refreshChart = [this] { Refresh(); },
               .averagesChanged = [this, averagesChanged] {
                 session_.charts.Ma1On = session_.settings.charts.AvOne;
                 session_.charts.Ma2On = session_.settings.charts.AvTwo;
                 if (averagesChanged) averagesChanged();
               }},
              parent);
  form.exec();
}

void ChartDesk::OpenDefaults() { OpenChtDef(ChtDefOpener::kShell); }

void ChartDesk::OpenFonts() { Show(new ChtFonts(Look([this] { Refresh(); }), over_)); }

void ChartDesk::OpenLists() {
  Show(new SubList({session_.files, session_.dialogs, session_.settings, session_.user}, over_));
}

void ChartDesk::OpenListUtilities() {
  Show(new SubList2({session_.files, session_.dialogs, session_.settings, session_.user}, over_));
}

void ChartDesk::OpenListNames() {
  Show(new CLNames({session_.files, session_.dialogs, session_.settings, session_.user}, over_));
}

}  // namespace kora
