#include "adjust/forms/AdjustCC.h"

namespace kora {

AdjustCC::AdjustCC(FigureFormServices services, QWidget* parent)
    : FigureForm(std::move(services), IssueKind::kCall,
                 {.name = "AdjustCC",
                  .caption = "Calls on Contributing Shares",
                  .amount = "Amount of Call &per share"},
                 parent) {}

}  // namespace kora
