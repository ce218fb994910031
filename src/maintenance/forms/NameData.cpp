#include "maintenance/forms/NameData.h"

#include <QLabel>
#include <QPointer>
#include <QPushButton>

#include "base/numbers.h"
#include "maintenance/data_checks.h"
#include "platform/qt/form_parts.h"

namespace kora {

NameData::NameData(MaintenanceServices services, QWidget* parent)
    : WorkForm(std::move(services), parent) {
  setObjectName("NameData");
  setWindowTitle("Name File - Data Files Check");
  auto* rows = new QVBoxLayout(this);
  rows->addWidget(NewNote(this, dataPath().empty() ? QString() : ToQt(dataPath()), 50));
  AddState(rows, "Label1");
  label2_ = new QLabel(this);
  label2_->setObjectName("Label2");
  label2_->setTextFormat(Qt::PlainText);
  rows->addWidget(label2_);
  rows->addStretch();
  AddPanel(rows);
  auto* buttons = new ButtonRow(this);
  auto* command4 = buttons->Add("Command4", "Check &Entries", [this] { Check(); });
  buttons->Add("Command1", "&Close", [this] { reject(); })->setAutoDefault(false);
  rows->addLayout(buttons);
  panel_->Hold({command4});
}

void NameData::Told(ProgressLine line, const std::string& text) {
  if (line == ProgressLine::kNote) label2_->setText(ToQt(text));
}

void NameData::Check() {
  if (panel_->running()) return;
  const QPointer<NameData> here = this;
  state_->clear();
  label2_->clear();
  NameCheck check;
  Run([&](Progress& progress) {
    check = CheckNameData(services_.files, dataPath(), progress, services_.dialogs);
  });
  if (!here) return;
  if (!check.done) {
    // Stopped, or told: nothing was changed.
    state_->clear();
    label2_->clear();
    return;
  }
  label2_->setText(ToQt("Names.DAT  has " + Str(check.count) + " Records"));
  if (check.removed + check.added > 0) SetChanged();
}

}  // namespace kora
