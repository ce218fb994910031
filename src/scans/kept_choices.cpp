#include "scans/kept_choices.h"

#include "base/numbers.h"
#include "base/text.h"

namespace kora {

std::string Kept(bool ticked) { return ticked ? "1" : "0"; }

std::string Kept(std::string text) {
  std::erase(text, ',');
  return std::string(Trim(text));
}

std::string JoinKept(const std::vector<std::string>& fields) {
  std::string out;
  for (size_t i = 0; i < fields.size(); ++i) out += (i == 0 ? "" : ",") + fields[i];
  return out;
}

KeptFields::KeptFields(std::string_view text) {
  if (text.find(',') != std::string_view::npos) fields_ = Split(text, ',');
}

void KeptFields::Take(bool& ticked) {
  if (next_ < fields_.size()) ticked = Trim(fields_[next_]) == "1";
  ++next_;
}

void KeptFields::Take(std::string& text) {
  if (next_ < fields_.size()) text = Trim(fields_[next_]);
  ++next_;
}

std::optional<std::int16_t> WholeOf(std::string_view typed) {
  const double rounded = RoundHalfEven(Val(typed));
  if (!(rounded >= -32768 && rounded <= 32767)) return std::nullopt;
  return CInt(rounded);
}

}  // namespace kora
