#include "adjust/forms/AdjustR.h"

#include <QLabel>
#include <QVBoxLayout>

#include "platform/qt/form_parts.h"

namespace kora {

AdjustR::AdjustR(FigureFormServices services, QWidget* parent)
    : QDialog(parent), services_(std::move(services)) {
  setObjectName("AdjustR");
  setWindowTitle("Remove Adjustment");
  auto* column = new QVBoxLayout(this);
  column->addWidget(
      NewNote(this, "This procedure removes the most recent adjustment made to the security."));
  column->addWidget(
      NewNote(this,
              "The corrected trading figures may vary from the original by fractions of a cent due "
              "to rounding during calculation"));
  column->addStretch();
  auto* buttons = new ButtonRow(this);
  buttons->Add("Command1", "&Proceed", [this] { Proceed(); });
  buttons->Add("Command2", "&Close", [this] { reject(); });
  column->addLayout(buttons);
}

void AdjustR::Proceed() {
  const RemoveEnd end = RemoveAdjustments(services_.adjust, services_.code());
  if (end == RemoveEnd::kFailed) return;
  const auto adjusted = services_.adjusted;
  accept();
  if (end == RemoveEnd::kRemoved && adjusted) adjusted();
}

}  // namespace kora
