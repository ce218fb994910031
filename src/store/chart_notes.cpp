#include "store/chart_notes.h"

#include <array>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargest = 16u << 20;
constexpr size_t kLongestLine = 4096;  // a script's own limit
constexpr size_t kFields = 6;

bool IsNumber(std::string_view text) { return ParseFloat(Trim(text)).has_value(); }

}  // namespace

std::string ChartNotesPath(const std::string& ChartMiscPath, std::string_view code) {
  return ChartMiscPath + CodeFileName(code, ".Txt");
}

std::vector<ChartNote> ReadChartNotes(const Files& files, const std::string& path) {
  std::vector<ChartNote> notes;
  if (!files.CheckFile(path)) return notes;
  const std::string text = files.ReadAll(path, kLargest);
  LineReader lines(text);
  std::string_view line;
  while (lines.Next(line)) {
    if (Trim(line).empty()) continue;
    const auto fields = Split(line, ',');
    ChartNote note;
    const std::array targets{&note.Kind,  &note.Size, &note.Date,
                             &note.Price, &note.Text, &note.Colour};
    for (size_t i = 0; i < targets.size(); ++i)
      *targets[i] = i < fields.size() ? Trim(fields[i]) : std::string_view();
    notes.push_back(std::move(note));
  }
  return notes;
}

std::string ChartNotesText(const std::vector<ChartNote>& notes) {
  std::string out;
  for (const ChartNote& note : notes) {
    for (const std::string* field : {&note.Kind, &note.Size, &note.Date, &note.Price, &note.Text}) {
      out += *field;
      out += ',';
    }
    out += note.Colour;
    out += "\r\n";
  }
  return out;
}

NoteLine MakeNoteLine(std::string_view date, double price, std::string_view text,
                      std::int32_t colour) {
  return ParseNoteLine("T,8.25," + std::string(date) + "," + Format(price, "#.00") + "," +
                       ToAnsi(text) + "," + Str(colour));
}

NoteLine ParseNoteLine(std::string_view line) {
  NoteLine note;
  note.line = line;
  if (line.size() > kLongestLine) return note;
  const auto fields = Split(line, ',');
  if (fields.size() != kFields || !EqualNoCase(Trim(fields[0]), "T")) return note;
  if (!IsNumber(fields[1]) || !IsNumber(fields[2]) || !IsNumber(fields[3]) ||
      !IsNumber(fields[5]) || Trim(fields[4]).empty())
    return note;
  try {
    note.Colour = CLng(Val(fields[5]));
  } catch (const RunTimeError&) {
    return note;
  }
  note.Date = Trim(fields[2]);
  note.Price = Val(fields[3]);
  note.Text = FromAnsi(fields[4]);
  note.readable = true;
  return note;
}

std::vector<NoteLine> ReadNoteLines(const Files& files, const std::string& path) {
  std::vector<NoteLine> notes;
  if (!files.CheckFile(path)) return notes;
  const std::string text = files.ReadAll(path, kLargest);
  LineReader reader(text);
  std::string_view line;
  while (reader.Next(line))
    if (!Trim(line).empty()) notes.push_back(ParseNoteLine(line));
  return notes;
}

void WriteNoteLines(const Files& files, const std::string& path,
                    const std::vector<NoteLine>& notes) {
  const auto held = files.lock().Hold();
  std::string text;
  for (const NoteLine& note : notes) text += note.line + "\r\n";
  files.WriteAll(path, text);
}

void AppendNoteLine(const Files& files, const std::string& path, const NoteLine& note) {
  const auto held = files.lock().Hold();
  std::string text;
  if (files.CheckFile(path)) text = files.ReadAll(path, kLargest);
  if (!text.empty() && text.back() != '\n') text += "\r\n";
  files.WriteAll(path, text + note.line + "\r\n");
}

void RemoveNotes(const Files& files, const std::string& path) {
  const auto held = files.lock().Hold();
  if (files.CheckFile(path)) files.Remove(path);
}

}  // namespace kora
