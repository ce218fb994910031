#pragma once

#include "scans/chart_scan2.h"
#include "scans/forms/hits_form.h"

namespace kora {

// "Chart Scan 2 (Increases in Volume)".
class ChtScan2 : public HitsForm<Scan2Hit> {
 public:
  ChtScan2(ScanFormServices services, QWidget* parent);

 private:
  void Proceed() override;
  void PrintHits() override;
  bool Leave() override;
  QWidget* Criteria(const Scan2Choices& kept);
  Scan2Choices Choices() const;

  QCheckBox *check1_, *check2_, *check3_, *check4_, *check5_;
  QLineEdit *text1_, *text2_, *text3_, *text5_, *text4_, *text6_;
};

}  // namespace kora
