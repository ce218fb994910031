#pragma once

#include <QDialog>
#include <functional>
#include <string>
#include <vector>

#include "indicators/osc_settings.h"

class QLineEdit;

namespace kora {

struct OscFrmServices {
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  Period chartPeriod;
  Style chartStyle;              // point and figure: the box value is asked for
  float& boxValue;               // of the point-and-figure chart
  std::function<void()> redraw;  // runs the oscillator's routine; empty when not for a redraw
};

// The settings box of the oscillator on show, or of a point-and-figure chart.
class OscFrm : public QDialog {
 public:
  OscFrm(OscFrmServices services, std::string_view oscCode, QWidget* parent);

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  QLineEdit* AddField(const QString& name, const QString& label, const std::string& value,
                      int columns, int limit);
  void Save();
  bool SavePeriods();
  bool SaveBoxValue();

  OscFrmServices services_;
  const Oscillator* box_ = nullptr;
  std::vector<QLineEdit*> fields_;
  QLineEdit* compare_ = nullptr;
};

}  // namespace kora
