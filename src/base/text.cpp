#include "base/text.h"

#include <cstdint>

namespace kora {
namespace {

// Windows-1252 from 0x80 to 0x9F; 0 where the code page has no character.
constexpr std::uint16_t kHigh[32] = {
    0x20AC, 0,      0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0,      0x017D, 0,      0,      0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0,      0x017E, 0x0178};

void AppendUtf8(std::string& out, std::uint32_t c) {
  if (c < 0x80) {
    out += char(c);
  } else if (c < 0x800) {
    out += char(0xC0 | (c >> 6));
    out += char(0x80 | (c & 0x3F));
  } else {
    out += char(0xE0 | (c >> 12));
    out += char(0x80 | ((c >> 6) & 0x3F));
    out += char(0x80 | (c & 0x3F));
  }
}

char Upper(char c) { return c >= 'a' && c <= 'z' ? char(c - 'a' + 'A') : c; }
char Lower(char c) { return c >= 'A' && c <= 'Z' ? char(c - 'A' + 'a') : c; }

}  // namespace

std::string_view LTrim(std::string_view text) {
  while (!text.empty() && text.front() == ' ') text.remove_prefix(1);
  return text;
}

std::string_view RTrim(std::string_view text) {
  while (!text.empty() && text.back() == ' ') text.remove_suffix(1);
  return text;
}

std::string_view Trim(std::string_view text) { return LTrim(RTrim(text)); }

std::string UCase(std::string_view text) {
  std::string out(text);
  for (char& c : out) c = Upper(c);
  return out;
}

std::string LCase(std::string_view text) {
  std::string out(text);
  for (char& c : out) c = Lower(c);
  return out;
}

bool EqualNoCase(std::string_view a, std::string_view b) {
  if (a.size() != b.size()) return false;
  for (size_t i = 0; i < a.size(); ++i)
    if (Upper(a[i]) != Upper(b[i])) return false;
  return true;
}

bool EndsNoCase(std::string_view text, std::string_view ending) {
  return text.size() >= ending.size() &&
         EqualNoCase(text.substr(text.size() - ending.size()), ending);
}

std::string PadRight(std::string_view text, size_t size) {
  std::string out(text.substr(0, size));
  out.resize(size, ' ');
  return out;
}

std::vector<std::string_view> Split(std::string_view text, char separator) {
  std::vector<std::string_view> fields;
  size_t start = 0;
  for (;;) {
    const size_t end = text.find(separator, start);
    if (end == std::string_view::npos) break;
    fields.push_back(text.substr(start, end - start));
    start = end + 1;
  }
  fields.push_back(text.substr(start));
  return fields;
}

std::string FromAnsi(std::string_view bytes) {
  std::string out;
  out.reserve(bytes.size());
  for (const char b : bytes) {
    const auto c = static_cast<unsigned char>(b);
    if (c < 0x80) {
      out += b;
    } else if (c < 0xA0) {
      AppendUtf8(out, kHigh[c - 0x80] ? kHigh[c - 0x80] : 0xFFFDu);
    } else {
      AppendUtf8(out, c);
    }
  }
  return out;
}

std::string ToAnsi(std::string_view text) {
  std::string out;
  out.reserve(text.size());
  for (size_t i = 0; i < text.size();) {
    const auto c = static_cast<unsigned char>(text[i]);
    const int more = c < 0x80         ? 0
                     : (c >> 5) == 6  ? 1
                     : (c >> 4) == 14 ? 2
                     : (c >> 3) == 30 ? 3
                                      : -1;
    if (more == 0) {
      out += char(c);
      ++i;
      continue;
    }
    if (more < 0 || i + size_t(more) >= text.size()) {
      out += '?';
      ++i;
      continue;
    }
    std::uint32_t code = c & (0x3Fu >> more);
    bool good = true;
    // The least character of each length: a shorter one in a longer form is bad.
    constexpr std::uint32_t kLeast[] = {0, 0x80, 0x800, 0x10000};
    for (int k = 1; k <= more; ++k) {
      const auto b = static_cast<unsigned char>(text[i + size_t(k)]);
      good = good && (b & 0xC0) == 0x80;
      code = (code << 6) | (b & 0x3Fu);
    }
    if (!good || code < kLeast[more]) {
      out += '?';
      ++i;
      continue;
    }
    i += size_t(more) + 1;
    char ansi = '?';
    if (code >= 0xA0 && code <= 0xFF) {
      ansi = char(code);
    } else {
      for (int k = 0; k < 32; ++k)
        if (kHigh[k] == code && code != 0) ansi = char(0x80 + k);
    }
    out += ansi;
  }
  return out;
}

}  // namespace kora
