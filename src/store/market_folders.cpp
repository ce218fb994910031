#include "store/market_folders.h"

#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestList = 1u << 20;

}  // namespace

std::string WmPathsFile(const std::string& systemPath) { return systemPath + "WMPaths.lst"; }

WmPaths ReadWmPaths(const Files& files, const std::string& systemPath) {
  WmPaths out;
  try {
    const std::string text = files.ReadAll(WmPathsFile(systemPath), kLargestList);
    LineReader lines(text);
    std::string_view line;
    for (std::string& value : out) {
      if (!lines.Next(line)) break;
      value = FromAnsi(Trim(line));
    }
  } catch (const RunTimeError&) {
    // Read as if nothing had been defined, which the user is told where it matters.
  }
  return out;
}

void WriteWmPaths(const Files& files, const std::string& systemPath, const WmPaths& lines) {
  const auto held = files.lock().Hold();
  std::string text;
  for (const std::string& line : lines) text += ToAnsi(line) + "\r\n";
  files.WriteAll(WmPathsFile(systemPath), text);
}

bool WmPathsComplete(const WmPaths& lines) {
  for (size_t i = 0; i < lines.size(); ++i)
    if (i != kWmChosen && Trim(lines[i]).empty()) return false;
  return true;
}

std::string WmChosenFolder(const WmPaths& lines) {
  const std::string_view text = Trim(lines[kWmChosen]);
  if (text.size() != 1 || text[0] < '0' || text[0] > '5') return {};
  const size_t index = size_t(text[0] - '0');
  return WithBackslash(Trim(lines[index == 5 ? size_t(kWmSum) : index]));
}

}  // namespace kora
