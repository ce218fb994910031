#pragma once

#include <QDialog>
#include <array>

#include "indicators/multi_osc.h"
#include "platform/dialogs.h"

class QGridLayout;
class QLineEdit;
class QListWidget;

namespace kora {

struct MultiOscServices {
  SettingsFile& user;
  Dialogs& dialogs;
};

// The two sets of the multi-oscillator view: a list of names, and a column of four boxes a set. A
// name goes into the selected box by a click, or by Enter or Space in the list.
class MultiOsc : public QDialog {
 public:
  MultiOsc(MultiOscServices services, QWidget* parent);

  // Keeps what was changed.
  void reject() override;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  struct Column {
    std::array<QLineEdit*, kMultiOscSlots> boxes{};
    MultiOscSet kept;
  };
  void AddColumn(QGridLayout* grid, int set);
  void Select(QLineEdit* box);
  void Put();
  bool SaveMOSets();

  MultiOscServices services_;
  QListWidget* list1_;
  std::array<Column, kMultiOscSets> columns_;
  QLineEdit* selected_ = nullptr;
};

}  // namespace kora
