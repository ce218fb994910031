#include "indicators/forms/SwingSet.h"

#include <QGridLayout>
#include <QLabel>
#include <QLineEdit>
#include <QRadioButton>

#include "base/numbers.h"
#include "platform/qt/form_parts.h"

namespace kora {
namespace {

struct Option {
  const char* caption;
  SwingKind kind;
};
constexpr Option kOptions[] = {{"&Standard", SwingKind::kStandard},
                               {"&Days", SwingKind::kDays},
                               {"&Points", SwingKind::kPoints},
                               {"&Automatic points", SwingKind::kPointsAuto}};

}  // namespace

SwingSet::SwingSet(SwingSetServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("SwingSet");
  setWindowTitle(ToQt(kSwingTitle));
  auto* grid = new QGridLayout(this);
  const SwingChoice& choice = services_.choice;
  for (int i = 0; i < 4; ++i) {
    options_[i] = new QRadioButton(kOptions[i].caption, this);
    options_[i]->setObjectName(QString("Option1(%1)").arg(i));
    options_[i]->setChecked(kOptions[i].kind == choice.kind || i == 0);
    grid->addWidget(options_[i], i, 0);
  }
  const auto box = [&](const char* name, SwingKind kind, double unset, int row, const char* unit) {
    QLineEdit* field = NewField(this, name, 6, 10);
    const bool kept = choice.size != 0 && (choice.kind == kind || choice.kind == SwingKind::kNone);
    field->setText(ToQt(Str(kept ? choice.size : unset)));
    field->setAccessibleName(unit);
    grid->addWidget(field, row, 1);
    grid->addWidget(NewLabel(this, unit), row, 2);
    return field;
  };
  text1_ = box("Text1", SwingKind::kDays, kSwingDays, 1, "days");
  text2_ = box("Text2", SwingKind::kPoints, kSwingPoints, 2, "points (cents of a share)");
  grid->setColumnStretch(2, 1);
  AddOkCancel(this, grid, [this] { Save(); });
  ShowBoxes();
  for (QRadioButton* option : options_) {
    connect(option, &QRadioButton::toggled, this, [this] { ShowBoxes(); });
    if (option->isChecked()) option->setFocus();
  }
}

SwingKind SwingSet::Chosen() const {
  for (int i = 0; i < 4; ++i)
    if (options_[i]->isChecked()) return kOptions[i].kind;
  return SwingKind::kStandard;
}

// A box belongs to its option.
void SwingSet::ShowBoxes() {
  text1_->setEnabled(Chosen() == SwingKind::kDays);
  text2_->setEnabled(Chosen() == SwingKind::kPoints);
}

void SwingSet::Save() {
  SwingChoice entered{Chosen(), services_.choice.size};
  QLineEdit* field = entered.kind == SwingKind::kDays     ? text1_
                     : entered.kind == SwingKind::kPoints ? text2_
                                                          : nullptr;
  if (field) {
    const auto size = ReadSwingSize(field->text().toStdString());
    if (!size) {
      services_.dialogs.Message(kSwingMessage, kSwingTitle);
      FocusField(field);
      return;
    }
    entered.size = *size;
  }
  services_.choice = entered;
  accept();
  if (services_.kept) services_.kept();
}

}  // namespace kora
