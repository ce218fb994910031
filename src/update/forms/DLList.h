#pragma once

#include <QDialog>
#include <QElapsedTimer>
#include <functional>

#include "update/download_update.h"

class QLabel;
class QListWidget;
class QProgressBar;
class QPushButton;

namespace kora {

struct DLListServices {
  const Files& files;
  Settings& settings;
  CurrentName& current;
  Dialogs& dialogs;
  const Clock& clock;
  std::function<void()> disableMenus;
  std::function<void()> enableMenus;  // also the place to show the title anew
  std::function<void(const std::string& path, const std::string& baseName, Progress&)>
      CheckBulletins = {};
};

// "Update with Downloaded Data ": the files that wait, and taking them in.
class DLList : public QDialog, private Progress {
 public:
  DLList(DLListServices services, QWidget* parent);

  // Lists what waits. False when nothing does, which was told: the form is not shown then.
  bool Fill();

  // Close. While an update runs it asks whether to stop that, and the form stays.
  void reject() override;

 private:
  void Show(ProgressLine line, std::string_view text) override;
  void SetRunning(bool running) override;
  bool Step(int done, int total) override;

  QLabel* AddLabel(const char* name);
  QPushButton* AddButton(const char* name, const char* caption);
  void FillList(int selected);
  void ListAgain();
  void UpdateDay();
  void UpdateAll();
  void RemoveDate();
  void Leave();
  void ShowTexts();
  UpdateRun Run();

  DLListServices services_;
  DownloadEntries entries_;
  QListWidget* list1_;
  QLabel *label2_, *label3_, *label4_, *label5_, *label8_[2];
  QProgressBar* bar_;
  QPushButton *command1_, *command2_, *command3_, *command4_;
  QElapsedTimer shown_;  // since the window was last given time
  std::string first_, second_;
  bool running_ = false;
  bool stopAsked_ = false;
};

}  // namespace kora
