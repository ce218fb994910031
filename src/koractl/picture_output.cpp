#include "koractl/picture_output.h"

#include <algorithm>
#include <charconv>

#include "base/host_files.h"
#include "base/text.h"
#include "koractl/table.h"

namespace kora {

static constexpr double kMostPixels = 100e6;  // of a picture

PictureSize ReadSize(const std::string& text, int scale) {
  int width = 0, height = 0;
  const char* end = text.data() + text.size();
  auto r = std::from_chars(text.data(), end, width);
  const bool two = r.ec == std::errc() && r.ptr != end && (*r.ptr == 'x' || *r.ptr == 'X');
  if (two) r = std::from_chars(r.ptr + 1, end, height);
  if (!two || r.ec != std::errc() || r.ptr != end || std::min(width, height) < kSmallestSide ||
      std::max(width, height) > kLargestSide)
    throw UsageError("--size: \"" + text + "\" is no WIDTHxHEIGHT from 100x100 to 10000x10000");
  PictureSize size;
  size.width = width;
  size.height = height;
  size.dpr = scale;
  if (size.width * size.height * size.dpr * size.dpr > kMostPixels)
    throw UsageError("--scale: a picture of " + text + " at scale " + std::to_string(scale) +
                     " is too large");
  return size;
}

Output OutputOf(const std::string& out) {
  if (out == "-") return Output::kStandardOutput;
  const std::string name = LCase(out);
  const auto ends = [&name](std::string_view ending) {
    return name.size() > ending.size() && name.ends_with(ending);
  };
  if (ends(".cht")) return Output::kScript;
  if (ends(".png") || ends(".svg") || ends(".pdf")) return Output::kPicture;
  throw UsageError("--out: \"" + out + "\" ends in none of .cht, .png, .svg, .pdf");
}

void WriteOutput(Run& run, const std::string& out, const std::string& bytes) {
  if (OutputOf(out) == Output::kStandardOutput) {
    WriteOut(bytes);
    return;
  }
  try {
    WriteHostFile(run.session.files.io(), out, bytes);
  } catch (const RunTimeError& e) {
    run.Abandon(out + ": " + e.what(), "KORA");
  }
}

}  // namespace kora
