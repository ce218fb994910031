#pragma once

#include <QDialog>
#include <array>

#include "settings/settings.h"

class QCheckBox;
class QRadioButton;

namespace kora {

// How bulletins are taken onto the adjustment list.
class AdjOpts : public QDialog {
 public:
  AdjOpts(SettingsFile& ini, Settings& settings, QWidget* parent);

 private:
  void Save();

  SettingsFile& ini_;
  Settings& settings_;
  std::array<QRadioButton*, 4> divs_;
  QCheckBox* shortNames_;
};

}  // namespace kora
