#include "store/price_rec.h"

namespace kora {

PriceRec NewPriceRec(std::string_view yyyymmdd) {
  PriceRec rec{};
  rec.RecDate.set(yyyymmdd);
  rec.AdjDesc.set("");
  rec.RecSpare.set("");
  return rec;
}

}  // namespace kora
