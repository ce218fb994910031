#include "scans/forms/ChtScan3.h"

#include <QCheckBox>
#include <QGridLayout>
#include <QGroupBox>
#include <QLineEdit>

#include "platform/qt/to_qt.h"

namespace kora {
namespace {

constexpr const char* kSetting = "Scan3_Other";

}  // namespace

ChtScan3::ChtScan3(ScanFormServices services, QWidget* parent)
    : HitsForm(std::move(services), parent) {
  setObjectName("ChtScan3");
  setWindowTitle("Chart Scan 3 (Stocks breaking Parabolic Indicator)");
  Scan3Choices kept;
  TakeKeptScan3(services_.user.GetSetting(kUserSection, kSetting), kept);
  LayOutHits(Criteria(kept), Scan3Columns());
}

QWidget* ChtScan3::Criteria(const Scan3Choices& kept) {
  auto* box = new QGroupBox("Criteria", this);
  auto* grid = new QGridLayout(box);
  text1_ = NewText("Text1", "Lowest price", kept.Text1);
  text2_ = NewText("Text2", "Highest price", kept.Text2);
  text3_ = NewText("Text3", "Category", kept.Text3);
  text6_ = NewText("Text6", "Industry class", kept.Text6);
  check1_ = AddCheck(grid, 0, "Check1", "By closin&g price range", kept.Check1, {text1_, text2_});
  check2_ = AddCheck(grid, 1, "Check2", "Chec&k only Category", kept.Check2, {text3_});
  check4_ = AddCheck(grid, 2, "Check4", "Check only &Industry Class", kept.Check4, {text6_});
  check3_ = AddCheck(grid, 3, "Check3", "Look for break &UP", kept.Check3);
  check5_ = AddCheck(grid, 4, "Check5", "Look for break &DOWN", kept.Check5);
  check6_ = AddCheck(grid, 5, "Check6", "Do not check &Warrants", kept.Check6);
  grid->setColumnStretch(3, 1);
  return box;
}

Scan3Choices ChtScan3::Choices() const {
  const auto text = [](const QLineEdit* field) { return field->text().toStdString(); };
  Scan3Choices c;
  c.Check1 = check1_->isChecked();
  c.Text1 = text(text1_);
  c.Text2 = text(text2_);
  c.Check2 = check2_->isChecked();
  c.Text3 = text(text3_);
  c.Check4 = check4_->isChecked();
  c.Text6 = text(text6_);
  c.Check3 = check3_->isChecked();
  c.Check5 = check5_->isChecked();
  c.Check6 = check6_->isChecked();
  return c;
}

void ChtScan3::Proceed() {
  Scan3Criteria criteria;
  if (const auto fault = ReadScan3(Choices(), criteria)) {
    Tell(*fault);
    return;
  }
  if (criteria.filter.industry) text6_->setText(ToQt(*criteria.filter.industry));
  ScanForHits<Scan3Result>(
      kScan3Title,
      [&](const ScanRun& run, const Found& found) { return RunScan3(run, criteria, found); },
      [this] { SaveScan(services_.files, dataPath(), EntriesOf(hits())); }, Scan3Ending);
}

void ChtScan3::PrintHits() { PrintTable(Scan3Print(hits())); }

bool ChtScan3::Leave() {
  services_.user.PutSetting(kUserSection, kSetting, KeptScan3(Choices()));
  return true;
}

}  // namespace kora
