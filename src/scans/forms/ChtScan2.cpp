#include "scans/forms/ChtScan2.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLabel>
#include <QLineEdit>

#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr const char* kSetting = "Scan2_Other";

}  // namespace

ChtScan2::ChtScan2(ScanFormServices services, QWidget* parent)
    : HitsForm(std::move(services), parent) {
  setObjectName("ChtScan2");
  setWindowTitle("Chart Scan 2 (Increases in Volume)");
  Scan2Choices kept;
  TakeKeptScan2(services_.user.GetSetting(kUserSection, kSetting), kept);
  LayOutHits(Criteria(kept), Scan2Columns());
}

QWidget* ChtScan2::Criteria(const Scan2Choices& kept) {
  auto* box = new QGroupBox("Criteria", this);
  auto* grid = new QGridLayout(box);
  text1_ = NewText("Text1", "Lowest price", kept.Text1);
  text2_ = NewText("Text2", "Highest price", kept.Text2);
  text3_ = NewText("Text3", "Increase in volume, percent", kept.Text3);
  text5_ = NewText("Text5", "Days of the average volume", kept.Text5);
  text4_ = NewText("Text4", "Change of price, percent", kept.Text4);
  text6_ = NewText("Text6", "Industry class", kept.Text6);
  check1_ = AddCheck(grid, 0, "Check1", "By closin&g price range", kept.Check1, {text1_, text2_});
  auto* average = new QLabel("% over average volume last", this);
  auto* days = new QLabel("days", this);
  check2_ = AddCheck(grid, 1, "Check2", "By increases in &volume", kept.Check2,
                     {text3_, average, text5_, days});
  check3_ = AddCheck(grid, 2, "Check3", "By +/- in &price %", kept.Check3, {text4_});
  check4_ = AddCheck(grid, 3, "Check4", "Check only &Industry Class", kept.Check4, {text6_});
  check5_ = AddCheck(grid, 4, "Check5", "Do not check &warrants", kept.Check5);
  grid->setColumnStretch(5, 1);
  return box;
}

Scan2Choices ChtScan2::Choices() const {
  const auto text = [](const QLineEdit* field) { return field->text().toStdString(); };
  Scan2Choices c;
  c.Check1 = check1_->isChecked();
  c.Text1 = text(text1_);
  c.Text2 = text(text2_);
  c.Check2 = check2_->isChecked();
  c.Text3 = text(text3_);
  c.Text5 = text(text5_);
  c.Check3 = check3_->isChecked();
  c.Text4 = text(text4_);
  c.Check4 = check4_->isChecked();
  c.Text6 = text(text6_);
  c.Check5 = check5_->isChecked();
  return c;
}

void ChtScan2::Proceed() {
  Scan2Criteria criteria;
  if (const auto fault = ReadScan2(Choices(), criteria)) {
    Tell(*fault);
    return;
  }
  if (criteria.filter.industry) text6_->setText(ToQt(*criteria.filter.industry));
  ScanForHits<Scan2Result>(
      kScan2Title,
      [&](const ScanRun& run, const Found& found) { return RunScan2(run, criteria, found); },
      [this] { SaveScan2(services_.files, dataPath(), hits()); }, Scan2Ending);
}

void ChtScan2::PrintHits() { PrintTable(Scan2Print(hits())); }

bool ChtScan2::Leave() {
  services_.user.PutSetting(kUserSection, kSetting, KeptScan2(Choices()));
  return true;
}

}  // namespace kora
