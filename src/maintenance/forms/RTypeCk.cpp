#include "maintenance/forms/RTypeCk.h"

#include <QCheckBox>
#include <QLabel>
#include <QPushButton>
#include <algorithm>

#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

constexpr size_t kTypes[] = {1, 2, 4, 5};
constexpr const char* kCaptions[] = {"Record Type &1", "Record Type &2", "Record Type &4",
                                     "Record Type &5"};

}  // namespace

RTypeCk::RTypeCk(Dialogs& dialogs, QWidget* parent) : QDialog(parent), dialogs_(dialogs) {
  setObjectName("RTypeCk");
  setWindowTitle("Record Types to Check");
  auto* rows = new QVBoxLayout(this);
  for (size_t i = 0; i < checks_.size(); ++i) {
    checks_[i] = new QCheckBox(kCaptions[i], this);
    checks_[i]->setObjectName(QString("Check%1").arg(i + 1));
    rows->addWidget(checks_[i]);
  }
  rows->addWidget(NewNote(this, "Note: Record Type 3 cannot be checked", 40));
  rows->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Proceed", [this] { accept(); });
  buttons->Add("Command2", "&Close", [this] { reject(); })->setAutoDefault(false);
  rows->addLayout(buttons);
}

std::array<bool, 6> RTypeCk::types() const {
  std::array<bool, 6> types{};
  for (size_t i = 0; i < checks_.size(); ++i) types[kTypes[i]] = checks_[i]->isChecked();
  return types;
}

void RTypeCk::accept() {
  const auto chosen = types();
  if (std::none_of(chosen.begin(), chosen.end(), [](bool type) { return type; })) {
    dialogs_.Message("No Record Types selected", "Record Types");
    checks_[0]->setFocus();
    return;
  }
  QDialog::accept();
}

}  // namespace kora
