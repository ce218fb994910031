#pragma once

#include <QDialog>
#include <functional>

#include "platform/dialogs.h"
#include "settings/settings.h"

class QLabel;
class QLineEdit;

namespace kora {

struct CPathServices {
  SettingsFile& ini;
  const Files& files;
  Dialogs& dialogs;
  Settings& settings;
  std::function<bool()> readAllSettings;  // false: the user gave up
  std::function<void()> pathsSaved;       // the main window shows its title anew
  std::function<void()> endProgram;
  std::function<void()> openWMPath;
};

// "Path Details": the folders of the installation.
class CPath : public QDialog {
 public:
  CPath(CPathServices services, QWidget* parent);

  // Asks what to do where the paths are missing, and fills the fields. False when the program
  // ends instead.
  bool Fill();
  // After another data folder was chosen elsewhere.
  void ShowChartData();

  void reject() override;

 protected:
  bool eventFilter(QObject* object, QEvent* event) override;

 private:
  QLineEdit* AddField(const char* name, const char* caption, int row, int browse);
  QLabel* AddLabel(int index, const char* caption, int row);
  void OpenLocate(int index);
  bool CheckDataFolder(const std::string& folder);
  bool Save();

  CPathServices services_;
  QLineEdit *text1_, *text2_, *text4_;
  QLabel* label10_[2];
  bool changed_ = false;
};

}  // namespace kora
