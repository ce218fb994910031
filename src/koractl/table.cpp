#include "koractl/table.h"

#include <algorithm>
#include <cerrno>
#include <cstdio>
#include <cstring>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {

Table::Table(std::string_view columns) : text_(columns) {
  std::replace(text_.begin(), text_.end(), ' ', '\t');
  text_ += '\n';
}

Table::Table(const std::vector<std::string>& columns) {
  for (const std::string& column : columns) Text(ToAnsi(column));
  EndRow();
}

void Table::Separate() {
  if (!first_) text_ += '\t';
  first_ = false;
}

Table& Table::Text(std::string_view ansi) {
  Separate();
  std::string clean(ansi);
  for (char& c : clean)
    if (static_cast<unsigned char>(c) < 0x20 || c == 0x7F) c = ' ';
  text_ += FromAnsi(RTrim(clean));
  return *this;
}

Table& Table::Number(std::int32_t value) {
  Separate();
  AppendStr(text_, value);
  return *this;
}

Table& Table::Number(float value) {
  Separate();
  text_ += Str(value);
  return *this;
}

void Table::EndRow() {
  text_ += '\n';
  first_ = true;
}

void Table::Note(std::string_view text) {
  text_ += "# ";
  text_ += text;
  text_ += '\n';
}

void Table::Print() const { WriteOut(text_); }

void WriteOut(std::string_view bytes) {
  errno = 0;
  if (std::fwrite(bytes.data(), 1, bytes.size(), stdout) == bytes.size() &&
      std::fflush(stdout) == 0)
    return;
  const int error = errno;
  throw RunTimeError(error == ENOSPC ? kDiskFull : kDeviceError, std::strerror(error));
}

}  // namespace kora
