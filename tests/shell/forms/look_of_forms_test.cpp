// What holds of the look of every form: the keyboard's place is seen, texts can be read on a dark
// desktop, the letters of a menu are its entries' own; and a screen reader finds a name for each
// control of the accessible tree, F1 a page of the guide for each form that there is.

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QAbstractScrollArea>
#include <QAbstractSpinBox>
#include <QAccessible>
#include <QComboBox>
#include <QDialog>
#include <QDirIterator>
#include <QFileInfo>
#include <QLabel>
#include <QLineEdit>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QSet>
#include <QTimer>
#include <cmath>
#include <map>
#include <set>

#include "platform/qt/accessible_names.h"
#include "platform/qt/focus_mark.h"
#include "shell/forms/Main.h"
#include "shell/forms/help_pages.h"
#include "tests/support/places.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

// Controls that can take the keyboard and have no name, by the accessible tree, as a screen reader
// walks it; tables and lists are left to the names of their rows.
void AccessiblyNameless(QAccessibleInterface* node, int depth, std::set<std::string>& found) {
  if (!node || depth > 12 || node->state().invisible || node->state().disabled) return;
  const QObject* object = node->object();
  if (node->state().focusable && node->text(QAccessible::Name).trimmed().isEmpty() && object &&
      object->isWidgetType() && (static_cast<const QWidget*>(object)->focusPolicy() & Qt::TabFocus))
    found.insert(object->objectName().toStdString() + " (" + object->metaObject()->className() +
                 ")");
  switch (node->role()) {
    case QAccessible::Table:
    case QAccessible::List:
    case QAccessible::Tree:
    case QAccessible::ComboBox:
    case QAccessible::SpinBox: return;
    default: break;
  }
  for (int i = 0; i < node->childCount(); ++i) AccessiblyNameless(node->child(i), depth + 1, found);
}

// Entries of one menu under one letter. Hidden ones don't count.
std::set<std::string> SharedLetters(const QWidget* form) {
  std::set<std::string> found;
  const auto look = [&](const QString& menu, const QList<QAction*>& actions) {
    std::map<QChar, QString> taken;
    for (const QAction* action : actions) {
      const QString text = action->text().section('\t', 0, 0);
      const qsizetype at = text.indexOf('&');
      if (action->isSeparator() || !action->isVisible() || at < 0 || at + 1 >= text.size())
        continue;
      const auto [place, free] = taken.emplace(text[at + 1].toUpper(), text);
      if (!free) found.insert((menu + ": " + place->second + " / " + text).toStdString());
    }
  };
  for (const QMenuBar* bar : form->findChildren<QMenuBar*>())
    if (bar->window() == form->window()) look("bar", bar->actions());
  for (const QMenu* menu : form->findChildren<QMenu*>())
    look(menu->objectName().isEmpty() ? menu->title() : menu->objectName(), menu->actions());
  return found;
}

// Controls that look the same with the keyboard as without.
std::set<std::string> FocusNotSeen(QWidget* form) {
  std::set<std::string> found;
  QList<QWidget*> controls;
  for (QWidget* control : form->findChildren<QWidget*>())
    if (control->isVisible() && control->isEnabled() && (control->focusPolicy() & Qt::TabFocus) &&
        !control->focusProxy() && control->window() == form->window() &&
        !control->size().isEmpty() && !qobject_cast<QAbstractSpinBox*>(control->parentWidget()) &&
        !qobject_cast<QComboBox*>(control->parentWidget()) && !qobject_cast<QMenu*>(control))
      controls << control;
  if (controls.size() < 2) return found;
  for (QWidget* control : controls) {
    QWidget* other = control == controls.first() ? controls.last() : controls.first();
    other->setFocus(Qt::TabFocusReason);
    const QImage without = control->grab().toImage();
    control->setFocus(Qt::TabFocusReason);
    // A scroll area may have moved; its own picture is what counts.
    if (QApplication::focusWidget() == control && control->grab().toImage() == without)
      found.insert(control->objectName().toStdString() + " (" + control->metaObject()->className() +
                   ")");
  }
  return found;
}

double Light(const QColor& c) {
  const auto part = [](double s) {
    return s <= 0.03928 ? s / 12.92 : std::pow((s + 0.055) / 1.055, 2.4);
  };
  return 0.2126 * part(c.redF()) + 0.7152 * part(c.greenF()) + 0.0722 * part(c.blueF());
}

double Contrast(const QColor& a, const QColor& b) {
  const double x = Light(a), y = Light(b);
  return (std::max(x, y) + 0.05) / (std::min(x, y) + 0.05);
}

// Texts that can't be read on the ground they stand on.
std::set<std::string> Unreadable(const QWidget* form) {
  std::set<std::string> found;
  for (const QWidget* w : form->findChildren<QWidget*>()) {
    if (!w->isVisible() || w->window() != form->window()) continue;
    const bool text = qobject_cast<const QLabel*>(w) || qobject_cast<const QAbstractButton*>(w) ||
                      qobject_cast<const QLineEdit*>(w) || qobject_cast<const QComboBox*>(w) ||
                      qobject_cast<const QAbstractItemView*>(w);
    if (!text) continue;
    const QWidget* seen = w;
    if (auto* area = qobject_cast<const QAbstractScrollArea*>(w)) seen = area->viewport();
    const QPalette& colours = w->palette();
    const double contrast =
        Contrast(colours.color(w->foregroundRole()), colours.color(seen->backgroundRole()));
    if (w->isEnabled() && contrast < 3)
      found.insert(form->objectName().toStdString() + "." + w->objectName().toStdString());
  }
  return found;
}

QPalette DarkDesktop() {
  QPalette dark(QColor(45, 45, 45));
  dark.setColor(QPalette::WindowText, QColor(230, 230, 230));
  dark.setColor(QPalette::Text, QColor(230, 230, 230));
  dark.setColor(QPalette::ButtonText, QColor(230, 230, 230));
  dark.setColor(QPalette::Base, QColor(30, 30, 30));
  dark.setColor(QPalette::Highlight, QColor(42, 130, 218));
  dark.setColor(QPalette::HighlightedText, Qt::white);
  return dark;
}

constexpr const char* kOfTheMenu[] = {
    "mnuChartDefaults", "mnFnts",      "mnTPSU",       "mnPrSU",      "mnuLists",
    "mnuListsUte",      "mnuRenameCL", "mnuPaths",     "mnuDDetails", "mnuAboutKora",
    "mnuViewNames",     "nmIndCl",     "mnuManAdjust", "mnuAdjExBtn", "mnuChartScan",
    "mnuChartScan2",    "mnuChtScan3", "mnStats"};
constexpr const char* kOfTheChart[] = {
    "cmChtDef",    "cmColours",   "cmfonts",     "cmBSpaces",        "cmGLSpaces",
    "cmLineWidth", "cmVHeight",   "cmMMASet",    "cmuSwingsettings", "cmuMOS",
    "cmSLInd",     "cmChtSpaces", "cmPageSetup", "cmPrintChart"};

class LookOfForms : public test::FormTest {
 protected:
  LookOfForms() {
    InstallAccessibleNames();
    focusMark = std::make_unique<FocusMark>();
    // A main window that was closed has told the application to end, which lets no dialog run
    // until the application itself has run again.
    QTimer::singleShot(0, qApp, [] { QCoreApplication::exit(0); });
    QApplication::exec();
    ReadSettings();
    session->settings.words.OptionXS = session->settings.words.OptionXT = true;
    main = std::make_unique<Main>(*session, "");
    main->show();
    main->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(main.get()));
  }
  // Those that stand by themselves, and those in the frame of the main window.
  QSet<QWidget*> Windows() const {
    QSet<QWidget*> found;
    for (QWidget* window : QApplication::topLevelWidgets())
      if (window->isVisible()) found << window;
    for (const QMdiSubWindow* frame : main->findChild<QMdiArea*>("MDI")->subWindowList())
      if (frame->widget()) found << frame->widget();
    return found;
  }
  // Triggers an entry and looks at the form that comes, which may hold the test up until it is
  // closed, or stand by itself.
  void Visit(const char* entry, const std::function<void(QWidget*)>& look) {
    const QSet<QWidget*> before = Windows();
    bool seen = false;
    const auto visit = [&] {
      if (seen) return;
      QWidget* form = QApplication::activeModalWidget();
      for (QWidget* window : Windows() - before)
        if (!form && !window->objectName().isEmpty()) form = window;
      if (!form) return;
      seen = true;
      look(form);
      form->close();
    };
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, visit);
    timer.start(0);
    Find<QAction>(main.get(), entry)->trigger();
    WaitFor([&] { return seen; });
    EXPECT_TRUE(seen) << entry;
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  }
  // Every form of the two menus, chart selection and the windows themselves.
  void VisitAll(const std::function<void(QWidget*)>& look) {
    look(main.get());
    for (const char* entry : kOfTheMenu) Visit(entry, look);
    Find<QAction>(main.get(), "mnuChartDisplay")->trigger();
    auto* selection = Find<QDialog>(main.get(), "ChtSel");
    look(selection);
    QTest::mouseClick(Find<QPushButton>(selection, "OK"), Qt::LeftButton);
    ASSERT_TRUE(WaitFor([&] { return main->findChild<QDialog*>("ChtSel") == nullptr; }));
    Find<QAction>(main.get(), "cmRelStrength")->trigger();
    look(main->charts());
    for (const char* entry : kOfTheChart) Visit(entry, look);
  }
  std::unique_ptr<FocusMark> focusMark;
  std::unique_ptr<Main> main;
};

TEST_F(LookOfForms, TheAccessibleTreeHasNoControlWithoutAName) {
  VisitAll([](QWidget* form) {
    std::set<std::string> found;
    AccessiblyNameless(QAccessible::queryAccessibleInterface(form), 0, found);
    EXPECT_EQ(found, std::set<std::string>()) << form->objectName().toStdString();
  });
}

// These texts are the system's own; any other entry takes a letter that is free.
TEST_F(LookOfForms, NoOtherEntriesOfAMenuShareALetter) {
  const std::set<std::string> given = {
      "mnuFile: Chart De&faults List / &Folder Locations",
      "mnuFile: Chart De&faults List / &Fonts",
      "slmnuEO: &Delete Selected Item/s / &Delete All Items",
      "slmnuEO: &Delete / &Delete All Items",
      "cmOptions: &Line Width (Printing) / Legible &Labels",
      "cmOscillators: &Coppock Indicator / RO&C and  FX",
      "cmOscillators: Momen&tum / MMA Se&ttings",
      "cmTools: &Chart Defaults / &Change Chart Spacing",
      "cmTools: S&plit Screen / Auto &Point and Figure Box Value "};
  VisitAll([&](QWidget* form) {
    for (const std::string& pair : SharedLetters(form))
      EXPECT_TRUE(given.contains(pair)) << form->objectName().toStdString() << "  " << pair;
  });
}

TEST_F(LookOfForms, TheFocusIsSeenOnEveryControl) {
  VisitAll([](QWidget* form) {
    EXPECT_EQ(FocusNotSeen(form), std::set<std::string>()) << form->objectName().toStdString();
  });
}

TEST_F(LookOfForms, EveryTextIsReadableOnADarkDesktop) {
  const QPalette light = QApplication::palette();
  QApplication::setPalette(DarkDesktop());
  main = std::make_unique<Main>(*session, "");
  main->show();
  main->activateWindow();
  ASSERT_TRUE(QTest::qWaitForWindowActive(main.get()));
  VisitAll([](QWidget* form) {
    EXPECT_EQ(Unreadable(form), std::set<std::string>());
    EXPECT_LT(Light(form->palette().color(QPalette::Window)), 0.2)
        << form->objectName().toStdString();
  });
  QApplication::setPalette(light);
}

// A file of forms that begins with a capital is a form.
TEST_F(LookOfForms, TheGuideHasAPageForEachFormThatThereIs) {
  const std::set<QString> without = {"AbtKora", "Logo", "RecSav", "HelpWindow"};
  int forms = 0;
  QDirIterator files(QString::fromStdString(SourceDir()) + "/src", {"*.h"}, QDir::Files,
                     QDirIterator::Subdirectories);
  while (files.hasNext()) {
    const QFileInfo file(files.next());
    const QString form = file.completeBaseName();
    if (file.dir().dirName() != "forms" || (!form[0].isUpper() && form != "chtScan1") ||
        without.contains(form))
      continue;
    ++forms;
    EXPECT_TRUE(HasHelpPage(form)) << form.toStdString();
  }
  EXPECT_GT(forms, 50);
}

}  // namespace
}  // namespace kora
