#pragma once

#include <QDialog>
#include <functional>
#include <utility>
#include <vector>

#include "indicators/chart_defaults.h"

class QCheckBox;
class QGridLayout;
class QLabel;
class QLineEdit;

namespace kora {

class ToggleBox;

enum class ChtDefOpener { kShell, kChartSelection, kChartWindow };

struct ChtDefServices {
  SettingsFile& ini;
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  const ChartColours& colours;
  Period chartPeriod;
  ChtDefOpener opener;
  std::function<void()> readSettings;  // reads the keys anew when the form opens
  std::function<void()> openScales;    // the form of manual scales
  std::function<void()> refreshChart;  // the chart window's refresh button
  // An average was switched, or all was saved: the settings hold what charts are to take.
  std::function<void()> averagesChanged;
};

// "Chart Defaults": all periods and switches of charts and oscillators.
class ChtDef : public QDialog {
 public:
  ChtDef(ChtDefServices services, QWidget* parent);

  void reject() override;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  using Twin = std::pair<QLineEdit*, QLineEdit*>;
  Twin AddTwin(QGridLayout* grid, int row, int column, const char* caption, const char* daily,
               const char* twin);
  void AddHeads(QGridLayout* grid, int column);
  void AddPeriods(QGridLayout* grid);
  void AddSwitches(QGridLayout* grid);
  void Fill(const ChartDefaults& form);
  ChartDefaults Typed() const;
  // The first box whose text is no period, or nothing.
  QLineEdit* FirstFault() const;
  void Save();
  void OpenScales();
  void AverageSwitched();

  ChtDefServices services_;
  std::vector<Twin> periods_;  // in the order of OscKeys()
  Twin average1_, average2_;
  ToggleBox *avOne_, *avTwo_, *avCalc_, *scMethod_;
  ToggleBox *bars_, *lines_, *volumes_, *cutVols_, *showOsc_;
  QCheckBox *fxRev_, *fillIn_, *rfAve_;
  QLabel* saved_;
  QLineEdit* compFile_;
};

}  // namespace kora
