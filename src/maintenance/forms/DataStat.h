#pragma once

#include <QPointer>

#include "maintenance/data_checks.h"
#include "maintenance/forms/work_form.h"

class QListWidget;
class QPushButton;

namespace kora {

class RTypeCk;

// "Checking Data Files": the check of the prices, and the removal of what it listed.
class DataStat : public WorkForm {
 public:
  DataStat(MaintenanceServices services, QWidget* parent);

  // Asks for the kinds of data, then checks them.
  void Begin();

 protected:
  void Told(ProgressLine line, const std::string& text) override;
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  void Check(const std::array<bool, 6>& types);
  void Print();
  void EditList();
  void Remove();
  void DropItem(int row);
  void EnableButtons();

  QListWidget* list1_;
  QPushButton *command1_, *command2_, *command3_, *command4_;
  QPointer<RTypeCk> types_;
  bool editing_ = false;
};

}  // namespace kora
