#include "maintenance/forms/VolMod.h"

#include <QCheckBox>
#include <QGroupBox>
#include <QLabel>
#include <QPushButton>
#include <QRadioButton>
#include <QVBoxLayout>

#include "platform/dialogs.h"
#include "platform/qt/form_parts.h"

namespace kora {

VolMod::VolMod(DataRows& rows, RowBlock selected, Dialogs& dialogs, QWidget* parent)
    : QDialog(parent), rows_(rows), selected_(selected), dialogs_(dialogs) {
  setObjectName("VolMod");
  setWindowTitle(ToQt(kScaleTitle));
  auto* all = new QVBoxLayout(this);
  auto* caption = NewLabel(this, ToQt(ScaleCaption(selected)));
  caption->setObjectName("Label1");
  all->addWidget(caption);

  auto* groups = new QHBoxLayout;
  auto* items = new QGroupBox("Items", this);
  auto* itemRows = new QVBoxLayout(items);
  const char* names[] = {"&Open", "&High", "&Low", "&Close", "&Volume"};
  for (int i = 0; i < 5; ++i) {
    check1_[i] = new QCheckBox(names[i], items);
    check1_[i]->setObjectName(QString("Check1(%1)").arg(i));
    itemRows->addWidget(check1_[i]);
    connect(check1_[i], &QCheckBox::toggled, this,
            [this] { text_->setText(ToQt(ScaleText(Items()))); });
  }
  groups->addWidget(items);
  auto* factors = new QGroupBox("Factor", this);
  auto* factorRows = new QVBoxLayout(factors);
  const char* captions[] = {"x 10", "x 100", "/ 10", "/ 100"};
  const char* spoken[] = {"Multiply by 10", "Multiply by 100", "Divide by 10", "Divide by 100"};
  for (int i = 0; i < 4; ++i) {
    option1_[i] = new QRadioButton(captions[i], factors);
    option1_[i]->setObjectName(QString("Option1(%1)").arg(i));
    option1_[i]->setAccessibleName(spoken[i]);
    factorRows->addWidget(option1_[i]);
  }
  factorRows->addStretch();
  groups->addWidget(factors);
  all->addLayout(groups);

  // As high as its longest text, so that ticks move nothing.
  text_ = NewNote(this, ToQt(ScaleText({true, true, true, true, true})));
  text_->setObjectName("Label2");
  text_->setMinimumHeight(text_->sizeHint().height());
  text_->setText({});
  all->addWidget(text_);
  all->addStretch();

  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&PROCESS", [this] { Process(); })->setEnabled(selected.count() > 0);
  buttons->Add("Command2", "Cancel", [this] { reject(); });
  all->addLayout(buttons);
}

ScaleItems VolMod::Items() const {
  ScaleItems items{};
  for (size_t i = 0; i < items.size(); ++i) items[i] = check1_[i]->isChecked();
  return items;
}

std::optional<ScaleBy> VolMod::By() const {
  for (int i = 0; i < 4; ++i)
    if (option1_[i]->isChecked()) return ScaleBy(i);
  return std::nullopt;
}

void VolMod::Process() {
  const ScaleItems items = Items();
  const std::optional<ScaleBy> by = By();
  auto refusal = CheckScale(items, by);
  if (!refusal) refusal = rows_.Scale(selected_, items, *by);
  if (refusal)
    dialogs_.Message(refusal->text, refusal->title);
  else
    accept();
}

}  // namespace kora
