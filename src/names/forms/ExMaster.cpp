#include "names/forms/ExMaster.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QVBoxLayout>

#include "platform/qt/form_parts.h"

namespace kora {

ExMaster::ExMaster(QWidget* parent) : QDialog(parent) {
  setObjectName("ExMaster");
  setWindowTitle("Update Name File from KORA Master List");
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(
      NewNote(this,
              "Regular updates of the Master List are available for download from our client web "
              "site"));
  auto* keep = new QGroupBox("Tick the items that you DO NOT want changed unless empty", this);
  auto* items = new QVBoxLayout(keep);
  static constexpr const char* kItems[] = {"&Name", "&Other Details", "&Type", "Cate&gory",
                                           "&Industry Class"};
  for (size_t i = 0; i < check1_.size(); ++i) {
    check1_[i] = new QCheckBox(kItems[i], keep);
    check1_[i]->setObjectName(QString("Check1(%1)").arg(i));
    items->addWidget(check1_[i]);
  }
  rows->addWidget(keep);
  rows->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Update", [this] {
    if (!start || start()) accept();
  });
  buttons->Add("Command2", "&Close", [this] { reject(); });
  rows->addLayout(buttons);
}

KeepTicks ExMaster::ticks() const {
  KeepTicks ticks{};
  for (size_t i = 0; i < ticks.size(); ++i) ticks[i] = check1_[i]->isChecked();
  return ticks;
}

}  // namespace kora
