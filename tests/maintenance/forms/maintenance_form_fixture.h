#pragma once

#include <QCheckBox>
#include <QRadioButton>
#include <QTimer>

#include "base/text.h"
#include "lists/chart_list.h"
#include "maintenance/forms/work_form.h"
#include "tests/support/qt/list_form_fixture.h"

namespace kora::test {

// A data folder with a share, a close-only security and an advance/decline series, and one form of
// maintenance on it.
class MaintenanceFormTest : public ListFormTest {
 protected:
  const std::string kData = "drive_c/korawin/data/";
  const std::string kMisc = "drive_c/korawin/chtmisc/";

  void SetUp() override {
    ListFormTest::SetUp();
    PutNames({Named("AAA", "Alpha Mining"), Named("CLO", "Close Only", kCloseOnly),
              Named("XAD", "Advances", kAdvanceDecline), Named("ZZZ", "Zinc")});
    for (const char* code : {"BBB", "CCC"})
      std::filesystem::remove(home.path() + "/" + kData + code + ".WDT");
    Prices("AAA", {Day("20260226", 1, 2, 0.5f, 1.5f, 100), Day("20260227", 2, 3, 1, 2.5f, 200)});
    Prices("CLO", {Day("20260227", 4, 4, 4, 4)});
    Prices("XAD", {Day("20260227", 0, 30, 20, 1010)});
    Prices("ZZZ", {Day("20260227", 7, 7, 7, 7, 700)});
  }
  MaintenanceServices Services() {
    return {.files = session->files,
            .dialogs = dialogs,
            .settings = session->settings,
            .changed = [this] { ++changed; },
            .folderChanged = [this] { ++folderChanged; },
            .print = [this](const TextTable& table, QWidget*) { printed = table; }};
  }
  template <typename Form, typename... More>
  Form& Open(More... more) {
    auto made = std::make_unique<Form>(Services(), more..., nullptr);
    if constexpr (requires { made->Fill(); }) {
      EXPECT_TRUE(made->Fill());
    }
    return Stand(std::move(made));
  }
  template <typename Form, typename... More>
  bool StaysAway(More... more) {
    Form made(Services(), more..., nullptr);
    return !made.Fill();
  }

  void Prices(const std::string& code, const std::vector<PriceRec>& days,
              const std::string& folder = "drive_c/korawin/data/") {
    home.Put(folder + code + ".WDT", Bytes(days));
  }
  std::string PricesOf(const std::string& code,
                       const std::string& folder = "drive_c/korawin/data/") {
    return home.Get(folder + code + ".WDT");
  }
  std::string CodesOfNames(const std::string& folder = "c:\\korawin\\data\\") {
    std::string out;
    for (const NameRec& rec : ReadNames(home.files(), folder))
      out += (out.empty() ? "" : " ") + std::string(rec.Code.trimmed());
    return out;
  }
  std::string Label(const char* name) { return On<QLabel>(name)->text().toStdString(); }
  void Tick(const char* name) { On<QAbstractButton>(name)->click(); }
  std::string Focused() {
    const QWidget* focus = form->focusWidget();
    return focus ? focus->objectName().toStdString() : "";
  }
  void Key(Qt::Key key, Qt::KeyboardModifiers with = Qt::NoModifier) {
    QTest::keyClick(form->focusWidget() ? form->focusWidget() : form.get(), key, with);
  }
  // Types into what has the keyboard.
  void Keys(const char* text) { QTest::keyClicks(form->focusWidget(), text); }
  // Presses "Stop" at the first step that lets the window live.
  void StopAtOnce() {
    QTimer::singleShot(0, form.get(), [this] { On<QPushButton>("StopWork")->click(); });
  }

  int changed = 0, folderChanged = 0;
  TextTable printed;
};

}  // namespace kora::test
