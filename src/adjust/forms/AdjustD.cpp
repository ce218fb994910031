#include "adjust/forms/AdjustD.h"

namespace kora {

AdjustD::AdjustD(FigureFormServices services, QWidget* parent)
    : FigureForm(
          std::move(services), IssueKind::kDividend,
          {.name = "AdjustD", .caption = "Dividends", .amount = "Dividend Amount &per Share"},
          parent) {}

}  // namespace kora
