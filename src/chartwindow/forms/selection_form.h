#pragma once

#include <QDialog>
#include <QEvent>
#include <functional>
#include <optional>
#include <string>

#include "chartwindow/chart_selection.h"
#include "platform/dialogs.h"

class QComboBox;
class QGridLayout;
class QLabel;
class QLineEdit;
class QPushButton;
class QScrollBar;
class QToolButton;

namespace kora {

// Services of chart selection. A hook that is empty leaves its control greyed.
struct ChtSelServices {
  ChartSelection& selection;
  ChartState& state;
  const Files& files;
  Dialogs& dialogs;
  const Settings& settings;
  const SettingsFile& user;
  const ChartColours& colours;
  std::function<void()> showChart;           // the chart window's NextChart
  std::function<void()> showWindow;          // shows the chart window, on the way from the start
  std::function<void()> closed;              // the chart window closes, the menus come back
  std::function<void()> secondDropped = {};  // the second chart of a pair was not chosen
  // Nothing was chosen: back to the chart on show. False where none stands.
  std::function<bool()> backToChart = {};
  // Chart defaults, modally; `averagesChanged` is called when an average was switched or saved.
  std::function<void(const std::function<void()>& averagesChanged)> openChtDef;
  std::function<bool()> openFinDate;   // true when a date was chosen
  std::function<void()> openChtBands;  // percentage bands, modally
  std::function<bool()> openWMPath;    // true when another folder was chosen
};

// What the forms for the first and the second chart share: a security by code or by stepping,
// type, period and spacing.
class SelectionForm : public QDialog {
 public:
  void reject() override;

 protected:
  SelectionForm(const char* name, const QString& title, ChtSelServices services, QWidget* parent);

  QPushButton* AddButton(const char* name, const char* caption);
  QLabel* AddCaption(const char* caption, QWidget* buddy);
  QLineEdit* AddShown(const char* name, int characters);
  QGridLayout* SecurityRow();
  // Text3 and its arrows.
  QWidget* SpacingRow();

  // Shows the view.
  virtual void Refresh();
  virtual void Leave() = 0;  // Command2
  virtual void Escape() { reject(); }
  void ShowChart();
  // The code has the focus, its text selected.
  void FocusCode();
  // ENTER and mouse in the fields; true when taken.
  virtual bool FieldEnter(QObject* field);
  virtual bool FieldMouse(QObject*, QEvent::Type) { return false; }

  bool eventFilter(QObject* object, QEvent* event) override;
  void keyPressEvent(QKeyEvent* event) override;
  void showEvent(QShowEvent* event) override;

  ChtSelServices services_;
  QLabel *label8_, *label4_;
  QLineEdit *text1_, *text2_, *text3_, *text4_, *text5_;
  QScrollBar* vScroll1_;
  QComboBox *combo1_, *combo4_;
  QPushButton *ok_, *command2_;

 private:
  void Step(bool up);
  bool EnterTyped();
  bool EnterCode();
  bool placed_ = false;
  // A code was typed for the one shown and is not entered yet; what was chosen since.
  bool typed_ = false;
  std::string shown_;
  std::optional<int> style_, period_;
};

}  // namespace kora
