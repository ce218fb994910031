#pragma once

#include <QDialog>

#include "chartwindow/chart_selection.h"

class QLabel;
class QListWidget;

namespace kora {

struct ChtOptionsServices {
  ChartSelection& selection;
  const Files& files;
  const Settings& settings;
  const SettingsFile& user;
  std::int16_t chartListNo = kFullList;  // the list in use
};

// "Viewing Options": chooses the list that is stepped through.
class ChtOptions : public QDialog {
 public:
  ChtOptions(const ChtOptionsServices& services, QWidget* parent);

 private:
  void ShowChoice();
  void Choose();

  ChartSelection& selection_;
  std::vector<ListEntry> entries_;
  QListWidget* list1_;
  QLabel* label1_;
};

}  // namespace kora
