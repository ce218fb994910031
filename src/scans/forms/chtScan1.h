#pragma once

#include <array>

#include "lists/grid_source.h"
#include "scans/chart_scan1.h"
#include "scans/forms/scan_form.h"

class QLabel;

namespace kora {

// "Indicates rises and falls over a selected magnitude and new buy/sell signals ...": Chart Scan 1.
class chtScan1 : public ScanForm {
 public:
  chtScan1(ScanFormServices services, QWidget* parent);

 private:
  // The hits; a click on the heading of the percentages orders them by SortByPercentage.
  class Hits : public TextGrid {
   public:
    bool Sort(int column, bool descending) override;
  };

  void Proceed() override;
  void PrintHits() override;
  bool Leave() override;
  void OpenRow(int row) override;
  QWidget* Criteria(const Scan1Choices& kept);
  Scan1Choices Choices() const;
  void LeaveText5();
  bool SaveGrid();

  Hits rows_;
  QCheckBox *check7_, *check1_, *check15_, *check8_, *check14_, *check16_;
  QCheckBox *check9_, *check12_, *check10_, *check11_;
  std::array<QCheckBox*, kScanOscillators> oscillators_{};
  QLineEdit *text3_, *text2_, *text1_, *text6_, *text4_, *text5_;
  QLabel* label8_;
  bool noHits_ = true;
  bool wanted_ = false;  // the hits belong into the list of results
};

}  // namespace kora
