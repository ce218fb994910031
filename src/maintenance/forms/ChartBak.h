#pragma once

#include <vector>

#include "maintenance/forms/work_form.h"

class QListWidget;
class QPushButton;

namespace kora {

// " BACKUP  Charting Data Files": the price store copied to the backup folder, or back.
class ChartBak : public WorkForm {
 public:
  enum class Way { kBackup, kRestore };
  ChartBak(MaintenanceServices services, Way way, QWidget* parent);

  // Lists the source. False, and told, where it is not there.
  bool Fill();

 protected:
  void Told(ProgressLine line, const std::string& text) override;
  void Stepped(int done, int total) override;

 private:
  void CopyAll();
  void CopySelected();
  void Copy(const std::function<void(Progress&)>& copy);

  const Way way_;
  const std::string source_, destination_;
  std::string from_, to_;
  QLabel *label1_, *label2_;
  QListWidget* file1_;
  QPushButton *command1_, *command2_, *command3_;
};

}  // namespace kora
