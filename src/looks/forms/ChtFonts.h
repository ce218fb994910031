#pragma once

#include <QDialog>
#include <functional>
#include <optional>

#include "looks/forms/look_services.h"
#include "looks/look_settings.h"

class QLabel;
class QRadioButton;

namespace kora {

// The two fonts of charts, printouts and tables.
class ChtFonts : public QDialog {
 public:
  // Lets the user choose a font, starting at the standing one; nothing when cancelled.
  using PickFont = std::function<std::optional<FontChoice>(
      QWidget* over, const FontChoice& standing, bool printerFontsOnly)>;
  // With no `pick`, the platform's own list of fonts.
  ChtFonts(LookServices services, QWidget* parent, PickFont pick = {});

 private:
  void Pick(int index);
  void ChooseNone();
  void ShowChoice(int index);
  void Save();

  LookServices services_;
  PickFont pick_;
  bool none_ = false;  // the standard face was chosen for both
  FontChoice choice_[2];
  QLabel* label3_[2];
  QRadioButton* printerFonts_;
};

}  // namespace kora
