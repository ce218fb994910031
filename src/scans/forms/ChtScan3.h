#pragma once

#include "scans/chart_scan3.h"
#include "scans/forms/hits_form.h"

namespace kora {

// "Chart Scan 3 (Stocks breaking Parabolic Indicator)".
class ChtScan3 : public HitsForm<Scan3Hit> {
 public:
  ChtScan3(ScanFormServices services, QWidget* parent);

 private:
  void Proceed() override;
  void PrintHits() override;
  bool Leave() override;
  QWidget* Criteria(const Scan3Choices& kept);
  Scan3Choices Choices() const;

  QCheckBox *check1_, *check2_, *check3_, *check4_, *check5_, *check6_;
  QLineEdit *text1_, *text2_, *text3_, *text6_;
};

}  // namespace kora
