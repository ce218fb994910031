#pragma once

#include "lists/grid_source.h"
#include "scans/chart_scan2.h"
#include "scans/forms/scan_form.h"

namespace kora {

// "Chart Scan 2 (Increases in Volume)".
class ChtScan2 : public ScanForm {
 public:
  ChtScan2(ScanFormServices services, QWidget* parent);

 private:
  void Proceed() override;
  void PrintHits() override;
  bool Leave() override;
  void OpenRow(int row) override;
  QWidget* Criteria(const Scan2Choices& kept);
  Scan2Choices Choices() const;

  TextGrid rows_;
  std::vector<Scan2Hit> hits_;  // a row each
  QCheckBox *check1_, *check2_, *check3_, *check4_, *check5_;
  QLineEdit *text1_, *text2_, *text3_, *text5_, *text4_, *text6_;
  bool stored_ = false;  // the hits are the list of results
};

}  // namespace kora
