#include "adjust/forms/AdjustB.h"

namespace kora {

AdjustB::AdjustB(FigureFormServices services, QWidget* parent)
    : FigureForm(std::move(services), IssueKind::kBonus,
                 {.name = "AdjustB",
                  .caption = "Bonus Issue",
                  .hints = {" Date is the day before the equity is Ex Bonus",
                            " Enter the Ratio of the Bonus Issue.",
                            " ie 1 Bonus Share/s for every 4 Shares held"},
                  .first = "&Bonus Shares for every",
                  .second = "&Shares held",
                  .lineSetsDate = true},
                 parent) {}

}  // namespace kora
