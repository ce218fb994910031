// What holds of every form: each control has a name for those who can't see it, and F1 finds a
// page of the guide.

#include <QAbstractScrollArea>
#include <QAbstractSpinBox>
#include <QAccessible>
#include <QComboBox>
#include <QDialog>
#include <QFileInfo>
#include <QMdiArea>
#include <QMdiSubWindow>
#include <QMenu>
#include <QMenuBar>
#include <QPushButton>
#include <QTextBrowser>
#include <QTimer>
#include <map>
#include <set>

#include "platform/qt/accessible_names.h"
#include "shell/forms/HelpWindow.h"
#include "shell/forms/Main.h"
#include "shell/forms/help_pages.h"
#include "tests/support/places.h"
#include "tests/support/qt/form_fixture.h"

namespace kora {
namespace {

QString NameOf(QWidget* control) {
  QAccessibleInterface* node = QAccessible::queryAccessibleInterface(control);
  return node ? node->text(QAccessible::Name).trimmed() : QString();
}

// The controls of a form that can take the keyboard and have no name.
std::set<std::string> Nameless(const QWidget* form) {
  std::set<std::string> found;
  for (QWidget* control : form->findChildren<QWidget*>()) {
    if (!control->isVisible() || !control->isEnabled() || !(control->focusPolicy() & Qt::TabFocus))
      continue;
    if (control->focusProxy() || control->window() != form->window()) continue;
    // Parts of a control are named by it.
    if (qobject_cast<QAbstractSpinBox*>(control->parentWidget()) ||
        qobject_cast<QComboBox*>(control->parentWidget()) || qobject_cast<QMenu*>(control))
      continue;
    if (NameOf(control).isEmpty())
      found.insert(form->objectName().toStdString() + "." + control->objectName().toStdString() +
                   " (" + control->metaObject()->className() + ")");
  }
  return found;
}

class EveryForm : public test::FormTest {
 protected:
  EveryForm() {
    InstallAccessibleNames();
    // A main window that was closed has told the application to end, which lets no dialog run
    // until the application itself has run again.
    QTimer::singleShot(0, qApp, [] { QCoreApplication::exit(0); });
    QApplication::exec();
    ReadSettings();
    // What some of the forms show.
    home.Put("drive_c/korawin/data/Names.dat",
             test::Bytes(std::vector<NameRec>{test::Security("AAA"), test::Security("BBB"),
                                              test::Security("CCC"),
                                              test::Security("XAD", 1, kAdvanceDecline)}));
    home.Put("drive_c/korawin/chtmisc/AAA.Txt", "T,8.25,20260226,10.00,A note,255\r\n");
    session->settings.download.DataService = 3;
    home.Put("drive_c/korawin/backup/AAA.WDT", "");
    session->settings.words.OptionXS = session->settings.words.OptionXT = true;
    main = std::make_unique<Main>(*session, "");
    main->show();
    main->activateWindow();
    EXPECT_TRUE(QTest::qWaitForWindowActive(main.get()));
  }
  // Triggers an entry and looks at the form that comes, which may hold the test up until it is
  // closed, or stand by itself.
  void Visit(const char* entry, const std::function<void(QWidget*)>& look) {
    bool seen = false;
    const auto visit = [&] {
      // One form may have opened another over itself.
      while (QWidget* form = seen ? nullptr : QApplication::activeModalWidget()) {
        look(form);
        form->close();
        seen = !QApplication::activeModalWidget();
      }
    };
    QTimer timer;
    QObject::connect(&timer, &QTimer::timeout, visit);
    timer.start(0);
    Find<QAction>(main.get(), entry)->trigger();
    WaitFor([&] { return seen; });
    EXPECT_TRUE(seen) << entry;
    QCoreApplication::sendPostedEvents(nullptr, QEvent::DeferredDelete);
  }
  void OpenCharts() {
    Find<QAction>(main.get(), "mnuChartDisplay")->trigger();
    auto* selection = Find<QDialog>(main.get(), "ChtSel");
    ASSERT_NE(selection, nullptr);
    EXPECT_EQ(Nameless(selection), std::set<std::string>());
    QTest::mouseClick(Find<QPushButton>(selection, "OK"), Qt::LeftButton);
    ASSERT_TRUE(WaitFor([&] { return main->findChild<QDialog*>("ChtSel") == nullptr; }));
  }

  std::unique_ptr<Main> main;
};

constexpr const char* kOfTheMenu[] = {
    "mnuViewData", "mnuChartDefaults", "mnFnts", "mnTPSU", "mnPrSU", "mnuLists", "mnuListsUte",
    "mnuRenameCL", "mnuPaths", "mnuDDetails", "mnuAboutKora",
    // Those that keep the data, one a line.
    "mnuKBUpdate", "mnuCodeChanged", "mnuMveData", "mnuDataCk", "mnuChkNameData", "mnuADCheck",
    "mnuBackupData", "mnuRestoreData", "mnuTextFile", "mnuTFD", "mnuCDupDts"};
constexpr const char* kOfTheChart[] = {"cmChtDef",   "cmColours",   "cmfonts",     "cmBSpaces",
                                       "cmGLSpaces", "cmLineWidth", "cmVHeight",   "cmMMASet",
                                       "cmSLInd",    "cmChtSpaces", "cmPageSetup", "cmPrintChart",
                                       "cmRText"};

TEST_F(EveryForm, EachControlThatTakesTheKeyboardHasAName) {
  const std::set<std::string> none;
  for (const char* entry : kOfTheMenu)
    Visit(entry, [&](QWidget* form) { EXPECT_EQ(Nameless(form), none) << entry; });
  OpenCharts();
  for (const char* entry : kOfTheChart)
    Visit(entry, [&](QWidget* form) { EXPECT_EQ(Nameless(form), none) << entry; });
}

TEST_F(EveryForm, ThePriceFileAndItsModificationHaveNamesAndAPage) {
  Find<QAction>(main.get(), "mnuViewData")->trigger();
  Click(Find<QDialog>(main.get(), "EnterCode"), "Command1");
  auto* data = Find<QDialog>(main.get(), "DataForm");
  ASSERT_NE(data, nullptr);
  EXPECT_EQ(Nameless(data), std::set<std::string>());
  EXPECT_EQ(HelpPageOf(data->objectName()), "data.html");
  bool seen = false;
  QTimer::singleShot(0, qApp, [&] {
    QWidget* volMod = QApplication::activeModalWidget();
    ASSERT_EQ(volMod->objectName(), "VolMod");
    EXPECT_EQ(Nameless(volMod), std::set<std::string>());
    EXPECT_EQ(HelpPageOf(volMod->objectName()), "data.html");
    seen = true;
    volMod->close();
  });
  Find<QAction>(data, "nmAdjVol")->trigger();
  EXPECT_TRUE(seen);
  data->close();
}

TEST_F(EveryForm, AComboBoxIsCalledByItsLabelAndItsChoiceIsItsValue) {
  Find<QAction>(main.get(), "mnuChartDisplay")->trigger();
  auto* selection = Find<QDialog>(main.get(), "ChtSel");
  for (QComboBox* box : selection->findChildren<QComboBox*>()) {
    if (!box->isVisible()) continue;
    EXPECT_NE(NameOf(box), box->currentText()) << box->objectName().toStdString();
    EXPECT_EQ(QAccessible::queryAccessibleInterface(box)->text(QAccessible::Value),
              box->currentText());
  }
}

TEST_F(EveryForm, TheGuideHasAPageForEachForm) {
  const QString guide = QString::fromStdString(kora::SourceDir()) + "/docs/guide/";
  const auto has = [&](QWidget* form) {
    const QString page = HelpPageOf(form->objectName());
    EXPECT_TRUE(QFileInfo::exists(guide + page)) << page.toStdString();
    if (form->objectName() != "AbtKora") {
      EXPECT_NE(page, "index.html") << form->objectName().toStdString();
    }
  };
  has(main.get());
  for (const char* entry : kOfTheMenu) Visit(entry, has);
  OpenCharts();
  for (const char* entry : kOfTheChart) Visit(entry, has);
}

TEST_F(EveryForm, F1OpensTheGuideAtTheFormInHand) {
  const auto page = [&]() -> QString {
    for (QWidget* w : QApplication::topLevelWidgets())
      if (auto* help = dynamic_cast<HelpWindow*>(w); help && help->isVisible())
        return help->findChild<QTextBrowser*>("Text1")->source().fileName();
    return {};
  };
  QTest::keyClick(main.get(), Qt::Key_F1);
  EXPECT_EQ(page(), "start.html");
  Visit("mnuLists", [&](QWidget* form) {
    QTest::keyClick(form, Qt::Key_F1);
    EXPECT_EQ(page(), "lists.html");
  });
  OpenCharts();
  QTest::keyClick(QApplication::focusWidget(), Qt::Key_F1);
  EXPECT_EQ(page(), "charts.html");
}

TEST_F(EveryForm, F10OpensTheMenu) {
  QTest::keyClick(main.get(), Qt::Key_F10);
  EXPECT_NE(main->menuBar()->activeAction(), nullptr);
  EXPECT_EQ(main->menuBar()->activeAction()->objectName(), "mnuFile");
}

}  // namespace
}  // namespace kora
