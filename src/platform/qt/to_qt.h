#pragma once

#include <QString>
#include <string_view>

namespace kora {

// UTF-8 as Qt keeps text; bytes that are no UTF-8 show as the replacement character.
inline QString ToQt(std::string_view text) {
  return QString::fromUtf8(text.data(), qsizetype(text.size()));
}

}  // namespace kora
