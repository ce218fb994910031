#pragma once

#include <string>

#include "koractl/run.h"
#include "platform/picture.h"

// Where a chart goes: the options --size, --scale and --out.

namespace kora {

inline constexpr int kSmallestSide = 100, kLargestSide = 10000;  // chart units

// "638x452" at `scale` pixels to the unit. Usage error for what is no size or is too large.
PictureSize ReadSize(const std::string& text, int scale);

enum class Output { kStandardOutput, kScript, kPicture };
// What the name of the file asks for; "-" is standard output. Usage error for another ending.
Output OutputOf(const std::string& out);

// Writes the file whole or not at all; a failure is told and ends the operation.
void WriteOutput(Run& run, const std::string& out, const std::string& bytes);

}  // namespace kora
