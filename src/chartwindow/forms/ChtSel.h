#pragma once

#include "chartwindow/forms/selection_form.h"

class QCheckBox;

namespace kora {

// "Chart Selection Menu": a chart is asked for here. The selection is to be loaded by the form
// alone; ENTER in the code finds the security, a second ENTER shows its chart.
class ChtSel : public SelectionForm {
 public:
  ChtSel(ChtSelServices services, QWidget* parent);

 protected:
  void Refresh() override;
  void Leave() override;
  void Escape() override;
  bool FieldEnter(QObject* field) override;
  bool FieldMouse(QObject* field, QEvent::Type type) override;
  bool event(QEvent* event) override;

 private:
  QLineEdit* AddSwitch(const char* name);
  void ColourAverage(QCheckBox* box, bool onGround, int entry);
  void Activated();
  void OpenChtOptions();
  void OpenSearch();
  void OpenIndClass();
  void ClickFinishDate();

  QLineEdit *text6_, *text7_, *text8_;
  QComboBox *combo2_, *combo3_;
  QCheckBox *oAve1_, *oAve2_, *check16_;
  bool doubleClicked_ = false;
  QPushButton *command1_, *command6_, *command7_;
};

}  // namespace kora
