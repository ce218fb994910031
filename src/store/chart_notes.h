#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"

namespace kora {

// The texts that the user put on a security's charts: a text file in the folder of chart notes,
// one note a line, "T,8.25,yyyymmdd,price,text,colour". Fields are kept as the file has them,
// blanks around them cut; those that a line lacks are empty, those behind the sixth are dropped.
struct ChartNote {
  std::string Kind = "T";
  std::string Size = "8.25";  // of the letters
  std::string Date;           // "yyyymmdd"
  std::string Price;          // at which it stands
  std::string Text;           // ANSI as in the file, without commas
  std::string Colour;         // a colour's value
};

// "c:\korawin\chtmisc\ORE.Txt". Error 52 for a code that can be no file name.
std::string ChartNotesPath(const std::string& ChartMiscPath, std::string_view code);

// The notes of a file, blank lines passed over; none where there is no file. Error 7 for a file
// larger than any that the program writes, others as Files::Open.
std::vector<ChartNote> ReadChartNotes(const Files& files, const std::string& path);

// The bytes of a file of these notes.
std::string ChartNotesText(const std::vector<ChartNote>& notes);

// One line of such a file, for those who show the texts: a line that is none shows nothing and is
// kept as it stands.
struct NoteLine {
  std::string line;       // as it stands in the file, without its end
  bool readable = false;  // what follows is filled from the line
  std::string Date;       // "yyyymmdd"; an x in chart units where the bar had no date
  double Price = 0;
  std::string Text;  // UTF-8
  std::int32_t Colour = 0;
};

// A text as it is kept. Its price is written in the form "#.00".
NoteLine MakeNoteLine(std::string_view date, double price, std::string_view text,
                      std::int32_t colour);
// What a line of the file says.
NoteLine ParseNoteLine(std::string_view line);

// All lines but empty ones, in their order; none where there is no file. Errors of
// Files::ReadAll; 7 for a file of more than 16 MB.
std::vector<NoteLine> ReadNoteLines(const Files& files, const std::string& path);
// Puts the file in place whole, by the lines. Errors of Files::WriteAll; the file stays as it was
// then.
void WriteNoteLines(const Files& files, const std::string& path,
                    const std::vector<NoteLine>& notes);
// Adds a line behind what is there, which stays byte for byte.
void AppendNoteLine(const Files& files, const std::string& path, const NoteLine& note);
// Removes the file; nothing where there is none.
void RemoveNotes(const Files& files, const std::string& path);

}  // namespace kora
