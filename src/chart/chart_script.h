#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

#include "base/files.h"

namespace kora {

// The chart script: a display list in text, one command a line, a letter and up to five fields
// behind commas. It records coordinates, colours and fonts, and holds no market data.
//
// Lines are gathered while a composition lasts and written in one go at its end.
class ChartScript {
 public:
  // A script that lives in memory alone.
  ChartScript() = default;
  // A script in a file: TCht.Tmp of the data folder.
  ChartScript(const Files& files, std::string path);

  // Begins a composition: empties the script, or goes on behind what is there.
  void Open(bool append);
  bool IsOpen() const { return open_; }
  // Writes what was gathered. Errors of the file system leave the script closed.
  void Close();

  // Forgets what was gathered since Open; nothing is written.
  void Abandon();

  // Lines gathered since Open; for a script in memory, the whole script.
  const std::string& text() const { return buffer_; }
  // Where a line is put together: the writer appends letter, fields and "\r\n".
  std::string& buffer() { return buffer_; }

 private:
  const Files* files_ = nullptr;
  std::string path_;
  std::string buffer_;
  bool open_ = false;
  bool append_ = false;
  size_t opened_ = 0;  // length of the buffer then
};

// A line split into its six fields. text[0] is the letter as it stands in the file.
struct ScriptLine {
  std::array<std::string, 6> text;

  char letter() const;                  // upper case, 0 for an empty first field
  double number(int field) const;       // fields from 1, as the letter is field 1
  std::int32_t whole(int field) const;  // rounded half to even; error 6 out of 32 bits
};

// Splits at commas. In the text field of a line that begins with "T" blanks stay; from every
// other field they vanish. Error 9 for a seventh field. A line too long to be a script's
// (over 4,096 bytes) is error 14.
void SplitScriptLine(std::string_view line, ScriptLine& out);

}  // namespace kora
