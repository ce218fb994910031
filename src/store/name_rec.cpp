#include "store/name_rec.h"

namespace kora {

NameRec NewNameRec(std::string_view code) {
  NameRec rec{};
  rec.Code.set(UCase(Trim(code)));
  rec.RecType = kShare;
  rec.Name.set("");
  rec.OtherDetails.set("");
  rec.MinMove = 0.05f;
  rec.Category = 1;
  rec.Id.set("");
  rec.IndClass.set("");
  rec.NameSpare.set("");
  return rec;
}

}  // namespace kora
