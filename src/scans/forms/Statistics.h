#pragma once

#include <array>

#include "lists/grid_source.h"
#include "platform/clock.h"
#include "scans/forms/scan_form.h"
#include "scans/market_statistics.h"

class QLabel;
class QRadioButton;

namespace kora {

// "Top Movers by Percentage": the market statistics. It opens with the rows of the last update.
class Statistics : public ScanForm {
 public:
  Statistics(ScanFormServices services, const Clock& clock, QWidget* parent);

 private:
  void Proceed() override;  // Update Statistics
  void PrintHits() override;
  void OpenRow(int row) override;
  QWidget* Criteria();
  void AddMenu();
  StatsMode Mode() const;
  void ShowTexts(const std::vector<std::vector<std::string>>& texts);

  const Clock& clock_;
  TextGrid rows_;
  std::vector<std::vector<std::string>> texts_;  // ANSI
  std::array<QRadioButton*, 4> options_{};
  QLineEdit* text1_;
  QLabel* label1_;
};

}  // namespace kora
