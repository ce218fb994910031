#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

// How the choices of a form stand in the per-user store: boxes as 1 and 0, and texts, between
// commas.

namespace kora {

std::string Kept(bool ticked);
// A comma in it is left out.
std::string Kept(std::string text);
std::string JoinKept(const std::vector<std::string>& fields);

// The fields in turn. What the text lacks leaves its place as it is; a text without a comma has
// no fields.
class KeptFields {
 public:
  explicit KeptFields(std::string_view text);
  void Take(bool& ticked);
  void Take(std::string& text);

 private:
  std::vector<std::string_view> fields_;
  size_t next_ = 0;
};

// CInt of a number typed; nothing beyond 16 bits.
std::optional<std::int16_t> WholeOf(std::string_view typed);

}  // namespace kora
