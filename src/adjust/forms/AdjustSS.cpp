#include "adjust/forms/AdjustSS.h"

namespace kora {

AdjustSS::AdjustSS(FigureFormServices services, QWidget* parent)
    : FigureForm(std::move(services), IssueKind::kSplit,
                 {.name = "AdjustSS",
                  .caption = "Share Splits",
                  .hints = {" Date is the day before Split takes effect",
                            " Enter the Ratio of the Share Split.",
                            " ie 1 New Share/s for every 4 Shares held"},
                  .first = "&No. of New Shares ",
                  .second = "&Old Shares",
                  // Its look-up is that of a bonus issue, whose form holds no date.
                  .tellsTypedDate = false},
                 parent) {}

}  // namespace kora
