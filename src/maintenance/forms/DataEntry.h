#pragma once

#include <array>
#include <optional>

#include "maintenance/data_entry.h"
#include "maintenance/forms/work_form.h"

class QCheckBox;
class QPushButton;

namespace kora {

// "Data Entry - Keyboard": one day's prices typed in, security after security. The folder is the
// form's own: the program's stays.
class DataEntry : public WorkForm {
 public:
  DataEntry(MaintenanceServices services, QWidget* parent);

  // Shows the first security. False, and told, where there is none.
  bool Fill();

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  static constexpr size_t kBoxes = 5;  // Open, High, Low, Close, Volume

  bool Open(std::int32_t number);
  void Show(EntrySecurity security);
  void ShowPrevious();
  void ProposeDate();
  void ClearBoxes();
  void LeaveCode();
  void Save();
  void Reset();
  void ChooseFolder();
  QLineEdit* BoxOf(EntryBox box) const;
  EntryTexts Texts() const;

  std::string folder_;
  std::optional<EntrySecurity> security_;
  QLabel *label17_, *label18_, *previousDate_;
  QLineEdit *text1_, *text7_, *text8_;
  std::array<QLabel*, kBoxes> captions_{}, previous_{};
  std::array<QLineEdit*, kBoxes> current_{};
  QCheckBox *check1_, *check2_;
};

}  // namespace kora
