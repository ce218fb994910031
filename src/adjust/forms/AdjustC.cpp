#include "adjust/forms/AdjustC.h"

namespace kora {

AdjustC::AdjustC(FigureFormServices services, QWidget* parent)
    : FigureForm(std::move(services), IssueKind::kCash,
                 {.name = "AdjustC",
                  .caption = "Cash Issues",
                  .hints = {" Date is the day before the exercise date ",
                            " Enter the Ratio of the Cash Issue.",
                            " and the cost per share of the New Shares",
                            " ie 1 New Share/s for every 4 Shares held"},
                  .first = "&New Shares for every",
                  .second = "&Shares held",
                  .amount = "Cost &per New Share",
                  .lineSetsDate = true},
                 parent) {}

}  // namespace kora
