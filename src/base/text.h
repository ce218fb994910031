#pragma once

#include <string>
#include <string_view>
#include <vector>

// Plain text work. Inside the program text is UTF-8; in the files it is ANSI (Windows-1252).

namespace kora {

std::string_view LTrim(std::string_view text);  // blanks only, as all of these
std::string_view RTrim(std::string_view text);
std::string_view Trim(std::string_view text);

// Upper and lower case of the letters A to Z; others stay.
std::string UCase(std::string_view text);
std::string LCase(std::string_view text);
bool EqualNoCase(std::string_view a, std::string_view b);
bool EndsNoCase(std::string_view text, std::string_view ending);

// Pads with blanks on the right, or cuts, to `size` bytes.
std::string PadRight(std::string_view text, size_t size);

// Splits at every `separator`; an empty text is one empty field.
std::vector<std::string_view> Split(std::string_view text, char separator);

// Windows-1252 to UTF-8. The five bytes with no character become U+FFFD.
std::string FromAnsi(std::string_view bytes);
// UTF-8 to Windows-1252; a character that it lacks, and a bad byte, becomes "?".
std::string ToAnsi(std::string_view text);

// A fixed text field of a record: blank padded, no terminator, ANSI.
template <size_t N>
struct FixedText {
  char bytes[N];

  std::string_view raw() const { return {bytes, N}; }
  // Right blanks (and NULs that foreign writers leave) cut.
  std::string_view trimmed() const {
    std::string_view s = raw();
    while (!s.empty() && (s.back() == ' ' || s.back() == '\0')) s.remove_suffix(1);
    return s;
  }
  void set(std::string_view text) {
    for (size_t i = 0; i < N; ++i) bytes[i] = i < text.size() ? text[i] : ' ';
  }
  friend bool operator==(const FixedText& a, const FixedText& b) { return a.raw() == b.raw(); }
};

}  // namespace kora
