#include "shell/forms/Main.h"

#include <QAction>
#include <QApplication>
#include <QCloseEvent>
#include <QDesktopServices>
#include <QKeyEvent>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QScreen>
#include <QStyle>
#include <QUrl>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/version.h"
#include "looks/forms/F1Size.h"
#include "platform/qt/modal.h"
#include "platform/qt/to_qt.h"
#include "shell/forms/AbtKora.h"
#include "shell/forms/HelpWindow.h"
#include "shell/forms/help_pages.h"
#include "shell/main_menu.h"
#include "store/volume_unit.h"

namespace kora {
namespace {

constexpr int kTwipsPerPixel = 15;

}  // namespace

Main::Main(Session& session, std::string commandLine)
    : session_(session),
      commandLine_(std::move(commandLine)),
      mdi_(new QMdiArea(this)),
      updates_(session, this,
               {.disableMenus = [this] { DisableMenus(); },
                .enableMenus = [this] { EnableMenus(); },
                .folderChanged = [this] { FolderChanged(); },
                .printTable = [this](const TextTable& table,
                                     QWidget* over) { desk_.PrintList(table, over); },
                .openAdjustments = [this] { Open("mnuAdjExBtn"); },
                .updated = [this] { desk_.PricesChanged(); }}),
      desk_(session, this, mdi_,
            {.readSettings = [this] { ReadSettingsAnew(session_); },
             .menusBack = [this] { EnableMenus(); },
             .openWMPath = [this](QWidget* over) { return updates_.OpenDestinations(over); },
             .VolumeUnitText =
                 [this](const NameRec& name) {
                   return VolumeUnitText(session_.files, session_.settings, name.Code.trimmed());
                 },
             .openCodes =
                 [this](QWidget* over, std::function<void(const std::string&)> select) {
                   data_.OpenCodes(over, std::move(select));
                 },
             .showStock = [this](const std::string& code,
                                 QWidget* over) { companies_.ShowStock(code, over); },
             .canShowStock = [this] { return companies_.CanShowStock(); }}),
      adjust_(session, this,
              {.disableMenus = [this] { DisableMenus(); },
               .enableMenus = [this] { EnableMenus(); },
               .printTable = [this](const TextTable& table,
                                    QWidget* over) { desk_.PrintList(table, over); },
               .pageSetup = [this](QWidget*) { desk_.OpenTextPage(); },
               .changeSize = [this](QWidget* over) { return AskTableSize(over); },
               .adjusted = [this] { desk_.PricesChanged(); }}),
      data_(session, this,
            {.printTable = [this](const TextTable& table,
                                  QWidget* over) { desk_.PrintList(table, over); },
             .pageSetup = [this](QWidget*) { desk_.OpenTextPage(); },
             .changeSize = [this](QWidget* over) { return AskTableSize(over); },
             .pricesChanged = [this] { desk_.PricesChanged(); }}),
      names_(session, this,
             {.printTable = [this](const TextTable& table,
                                   QWidget* over) { desk_.PrintList(table, over); },
              .pageSetup = [this](QWidget*) { desk_.OpenTextPage(); },
              .changeSize = [this](QWidget* over) { return AskTableSize(over); },
              .namesChanged = [this] { desk_.PricesChanged(); }}),
      companies_(session, this,
                 {.printTable = [this](const TextTable& table,
                                       QWidget* over) { desk_.PrintList(table, over); },
                  .pageSetup = [this](QWidget*) { desk_.OpenTextPage(); },
                  .changeSize = [this](QWidget* over) { return AskTableSize(over); },
                  .namesChanged = [this] { desk_.PricesChanged(); }}),
      scans_(session, this,
             {.disableMenus = [this] { DisableMenus(); },
              .enableMenus = [this] { EnableMenus(); },
              .printTable = [this](const TextTable& table,
                                   QWidget* over) { desk_.PrintList(table, over); },
              .textPage = [this] { desk_.OpenTextPage(); },
              .showChart = [this](std::int16_t list,
                                  std::int16_t place) { desk_.ShowChart(list, place); }}),
      maintenance_(session, this,
                   {.printTable = [this](const TextTable& table,
                                         QWidget* over) { desk_.PrintList(table, over); },
                    .changed = [this] { desk_.PricesChanged(); },
                    .folderChanged = [this] { FolderChanged(); }}) {
  setObjectName("Main");
  mdi_->setObjectName("MDI");
  mdi_->setHorizontalScrollBarPolicy(Qt::ScrollBarAsNeeded);
  mdi_->setVerticalScrollBarPolicy(Qt::ScrollBarAsNeeded);
  mdi_->viewport()->installEventFilter(this);
  qApp->installEventFilter(this);
  setCentralWidget(mdi_);
  BuildMenu();
  SetOpeners();
  EnableMenus();
  TakeSize();
  PathsChanged();
}

// The guide is a window by itself, and goes when the program does.
Main::~Main() { delete help_; }

void Main::BuildMenu() {
  std::map<std::string_view, QMenu*> menus;
  const auto entries = MainMenu();
  for (const MenuEntry& entry : entries) {
    const bool isMenu = std::any_of(entries.begin(), entries.end(), [&](const MenuEntry& other) {
      return other.parent == entry.name;
    });
    if (isMenu) {
      QMenu* menu = entry.parent.empty() ? menuBar()->addMenu(ToQt(entry.caption))
                                         : menus[entry.parent]->addMenu(ToQt(entry.caption));
      menu->setObjectName(ToQt(entry.name));
      menu->menuAction()->setObjectName(ToQt(entry.name));
      menus[entry.name] = menu;
      continue;
    }
    QAction* action = menus[entry.parent]->addAction(ToQt(entry.caption));
    action->setObjectName(ToQt(entry.name));
    action->setMenuRole(QAction::NoRole);
    connect(action, &QAction::triggered, this,
            [this, name = std::string(entry.name)] { Open(name); });
  }
  menus["mnuFile"]->insertSeparator(findChild<QAction*>("mnuExit"));
}

void Main::SetOpeners() {
  SetOpener("mnuChartDisplay", [this] { desk_.OpenCharts(); });
  SetOpener("mnuChartDefaults", [this] { desk_.OpenDefaults(); });
  SetOpener("mnFnts", [this] { desk_.OpenFonts(); });
  SetOpener("mnTPSU", [this] { desk_.OpenTextPage(); });
  SetOpener("mnPrSU", [this] { desk_.OpenPrinterSetup(); });
  SetOpener("mnuLists", [this] { desk_.OpenLists(); });
  SetOpener("mnuListsUte", [this] { desk_.OpenListUtilities(); });
  SetOpener("mnuRenameCL", [this] { desk_.OpenListNames(); });
  SetOpener("mnuViewData", [this] { data_.OpenData(); });
  SetOpener("mnuViewNames", [this] { names_.OpenNames(); });
  SetOpener("nmIndCl", [this] { names_.OpenClasses(); });
  SetOpener("mnuPaths", [this] { OpenPaths(); });
  SetOpener("mnuExit", [this] { EndProgram(); });
  SetOpener("mnuPntCol", [this] { AskPrinter(); });
  SetOpener("mnuTARVO", [this] { Download("Dlmain32.EXE"); });
  SetOpener("mnuBourse", [this] { Download("Dlbourse32.exe"); });
  SetOpener("mnuEIS", [this] { Download("Dleis32.EXE"); });
  SetOpener("mnuDDetails", [this] { updates_.OpenDetails(); });
  SetOpener("mnuManAdjust", [this] { adjust_.OpenByHand(); });
  SetOpener("mnuModem", [this] { updates_.OpenUpdate(); });
  SetOpener("mnuFundamtl", [this] { companies_.OpenCompanies(); });
  SetOpener("mnuAdjExBtn", [this] { adjust_.OpenList(); });
  SetOpener("mnuSnap", [this] { OpenSnapshot(); });
  SetOpener("mnuChartScan", [this] { scans_.OpenScan1(); });
  SetOpener("mnuChartScan2", [this] { scans_.OpenScan2(); });
  SetOpener("mnuChtScan3", [this] { scans_.OpenScan3(); });
  SetOpener("mnStats", [this] { scans_.OpenStats(); });
  SetOpener("mnuKBUpdate", [this] { maintenance_.OpenEntry(); });
  SetOpener("mnuCodeChanged", [this] { maintenance_.OpenCodeChange(); });
  SetOpener("mnuMveData", [this] { maintenance_.OpenMove(); });
  SetOpener("mnuDataCk", [this] { maintenance_.OpenDataCheck(); });
  SetOpener("mnuChkNameData", [this] { maintenance_.OpenNameCheck(); });
  SetOpener("mnuADCheck", [this] { maintenance_.OpenTotals(); });
  SetOpener("mnuBackupData", [this] { maintenance_.OpenBackup(); });
  SetOpener("mnuRestoreData", [this] { maintenance_.OpenRestore(); });
  SetOpener("mnuTextFile", [this] { maintenance_.OpenCloses(); });
  SetOpener("mnuTFD", [this] { maintenance_.OpenHistory(); });
  SetOpener("mnuCDupDts", [this] { maintenance_.OpenRemoveDate(); });
  SetOpener("mnuMMAScan", [this] { RunSibling("Mmascan.EXE"); });
  SetOpener("mnSHlp", [this] { OpenHelp(); });
  SetOpener("mnuAboutKora", [this] {
    auto* about = new AbtKora(this);
    about->setAttribute(Qt::WA_DeleteOnClose);
    about->open();
  });
}

void Main::SetOpener(const std::string& entry, std::function<void()> open) {
  if (open)
    openers_[entry] = std::move(open);
  else
    openers_.erase(entry);
  EnableMenus();
}

void Main::OpenSavedChart(const std::string& hostPath) {
  try {
    desk_.ShowSavedChart(session_.files.DosPath(hostPath));
  } catch (const RunTimeError& e) {
    session_.dialogs.Message(e.what(), kProgramTitle);
  }
}

// The one place where what goes wrong in an entry's work is told.
void Main::Open(const std::string& entry) {
  const auto opener = openers_.find(entry);
  if (opener == openers_.end() || !opener->second) return;
  try {
    opener->second();
  } catch (const RunTimeError& e) {
    session_.dialogs.Message(e.what(), kProgramTitle);
  }
}

void Main::DisableMenus() {
  for (const MenuEntry& entry : MainMenu())
    if (DisabledByLongTask(entry.name))
      findChild<QMenu*>(ToQt(entry.name))->menuAction()->setEnabled(false);
}

void Main::EnableMenus() {
  for (const MenuEntry& entry : MainMenu()) {
    const EntryState state =
        MenuEntryState(entry.name, session_.settings.download, session_.settings.words);
    if (auto* menu = findChild<QMenu*>(ToQt(entry.name))) {
      menu->menuAction()->setEnabled(state.enabled);
      continue;
    }
    auto* action = findChild<QAction*>(ToQt(entry.name));
    action->setVisible(state.visible);
    action->setEnabled(state.enabled && openers_.count(std::string(entry.name)) != 0);
  }
  // A submenu of greyed entries alone is greyed too.
  for (const MenuEntry& entry : MainMenu()) {
    auto* menu = findChild<QMenu*>(ToQt(entry.name));
    if (!menu || entry.parent.empty()) continue;
    const auto actions = menu->actions();
    menu->menuAction()->setEnabled(
        std::any_of(actions.begin(), actions.end(), [](QAction* a) { return a->isEnabled(); }));
  }
}

void Main::PathsChanged() {
  setWindowTitle(QString::fromStdString(MainTitle(session_.settings.paths)));
  desk_.PathsChanged();
}

void Main::TakeSize() {
  const MainSize size =
      MainWindowSize(session_.UserSetting("Height"), session_.UserSetting("Width"));
  // The standing size is that of a small screen, and grows with it.
  const double growH = size.heightKept ? 1 : session_.settings.ScreenScaleH;
  const double growW = size.widthKept ? 1 : session_.settings.ScreenScaleW;
  const QRect room = screen()->availableGeometry();
  const QSize wanted(int(size.width * growW / kTwipsPerPixel),
                     int(size.height * growH / kTwipsPerPixel));
  const int frame = style()->pixelMetric(QStyle::PM_TitleBarHeight);
  resize(wanted.boundedTo(room.size() - QSize(0, frame)));
  const FormPlace place = CentreForm(room.width(), room.height(), width(), height());
  move(room.topLeft() + QPoint(std::max(place.left, 0), std::max(place.top, 0)));
}

void Main::KeepSize() {
  const QSize size = isMaximized() || isFullScreen() ? normalGeometry().size() : this->size();
  session_.SaveUserSetting("Height", Str(std::int32_t(size.height() * kTwipsPerPixel)));
  session_.SaveUserSetting("Width", Str(std::int32_t(size.width() * kTwipsPerPixel)));
}

bool Main::OpenPaths() {
  if (cpath_) {
    cpath_->activateWindow();
    return true;
  }
  cpath_ = new CPath(
      {.ini = session_.ini,
       .files = session_.files,
       .dialogs = session_.dialogs,
       .settings = session_.settings,
       .readAllSettings = [this] { return ReadAllSettings(session_, commandLine_, true); },
       .pathsSaved =
           [this] {
             EnableMenus();
             PathsChanged();
           },
       .endProgram = [this] { EndProgram(); },
       .openWMPath = [this] { updates_.OpenDestinations(cpath_); }},
      this);
  cpath_->setAttribute(Qt::WA_DeleteOnClose);
  if (!cpath_->Fill()) {
    delete cpath_;
    return false;
  }
  cpath_->open();
  cpath_->move(mdi_->mapToGlobal(QPoint(0, 0)));
  return true;
}

// F1 opens the guide at the form in hand and F10 the menu, wherever the keyboard is.
bool Main::TakeKey(const QKeyEvent& key) {
  if (key.modifiers() != Qt::NoModifier) return false;
  if (key.key() == Qt::Key_F1) {
    const QWidget* form = QApplication::activeModalWidget();
    if (!form) form = QApplication::activeWindow();
    if (form == this && mdi_->activeSubWindow()) form = mdi_->activeSubWindow()->widget();
    // A message has no page of its own: that of the form below it.
    while (form && !HasHelpPage(form->objectName())) form = form->parentWidget();
    OpenHelpAt(HelpPageOf(form ? form->objectName() : QString()));
    return true;
  }
  if (key.key() == Qt::Key_F10 && QApplication::activeWindow() == this) {
    const auto menus = menuBar()->actions();
    const auto first =
        std::find_if(menus.begin(), menus.end(), [](QAction* a) { return a->isEnabled(); });
    if (first != menus.end()) menuBar()->setActiveAction(*first);
    return true;
  }
  return false;
}

void Main::OpenHelp() { OpenHelpAt("index.html"); }

void Main::OpenHelpAt(const QString& name) {
  const std::string own = session_.settings.paths.SystemPath + "korahlp32.hlp";
  if (session_.files.CheckFile(own) && QDesktopServices::openUrl(QUrl::fromLocalFile(
                                           QString::fromStdString(session_.files.HostPath(own)))))
    return;
  // Below a form that holds the others back the guide must be that form's own, to be read at all.
  QWidget* modal = QApplication::activeModalWidget();
  if (help_ && modal && !modal->isAncestorOf(help_)) delete help_;
  if (help_) {
    help_->ShowPage(name);
    help_->raise();
    help_->activateWindow();
    return;
  }
  const QString page = FindGuide(QCoreApplication::applicationDirPath());
  if (page.isEmpty()) {
    session_.dialogs.Message("The Help file is missing", "KORA Charting Help");
    return;
  }
  help_ = new HelpWindow(page, modal);
  help_->ShowPage(name);
  help_->show();
}

bool Main::RunSibling(const std::string& program) {
  struct Closed {};
  const std::string path = session_.settings.paths.SystemPath + program;
  if (!session_.files.CheckFile(path)) throw RunTimeError(kFileNotFound, "File not found  " + path);
  DisableMenus();
  try {
    session_.processes.RunAndWait(session_.files.HostPath(path), {}, [this] {
      session_.dialogs.Yield();
      if (closed_) throw Closed();
    });
  } catch (const Closed&) {
    // Its program ends by itself.
    return false;
  } catch (...) {
    EnableMenus();
    throw;
  }
  EnableMenus();
  return true;
}

void Main::OpenSnapshot() {
  const std::string program = "Quickpeek.EXE";
  if (session_.files.CheckFile(session_.settings.paths.SystemPath + program))
    RunSibling(program);
  else
    companies_.OpenSnapshot();
}

void Main::Download(const std::string& program) {
  if (RunSibling(program)) updates_.OpenList();
}

void Main::FolderChanged() {
  PathsChanged();
  scans_.FolderChanged();
  if (cpath_) cpath_->ShowChartData();
}

void Main::AskPrinter() {
  AskPrinterColours(session_.files, session_.settings.paths.SystemPath, session_.dialogs,
                    session_.printer);
}

int Main::AskTableSize(QWidget* over) {
  Modal<F1Size> form(LookServices{.ini = session_.ini,
                                  .settings = session_.settings,
                                  .dialogs = session_.dialogs,
                                  .saved = {}},
                     over);
  form.Run();
  return session_.settings.Zoom;
}

void Main::EndProgram() {
  KeepSize();
  hide();
  QCoreApplication::exit(0);
}

void Main::closeEvent(QCloseEvent* event) {
  closed_ = true;
  KeepSize();
  mdi_->closeAllSubWindows();
  if (help_) help_->close();
  event->accept();
  QCoreApplication::exit(0);
}

// A window that fills the frame goes on filling it when the frame changes its size.
bool Main::eventFilter(QObject* object, QEvent* event) {
  if (event->type() == QEvent::KeyPress && object->isWidgetType() &&
      TakeKey(*static_cast<QKeyEvent*>(event)))
    return true;
  if (object == mdi_->viewport() && event->type() == QEvent::Resize) {
    const QSize before = mdiSize_;
    mdiSize_ = mdi_->viewport()->size();
    for (QMdiSubWindow* frame : mdi_->subWindowList())
      if (frame->geometry() == QRect(QPoint(0, 0), before)) frame->resize(mdiSize_);
  }
  return QMainWindow::eventFilter(object, event);
}

}  // namespace kora
