#pragma once

#include <QString>
#include <random>
#include <string>
#include <vector>

namespace kora::monkey {

using Generator = std::mt19937_64;

// 0 to `count` - 1. Not a distribution of the library, whose numbers differ from one to another.
inline int Below(Generator& generator, int count) {
  return count <= 1 ? 0 : int(generator() % std::uint64_t(count));
}
inline bool Chance(Generator& generator, double share) {
  return double(generator() % 1'000'000) < share * 1'000'000;
}

// What may be typed into a box: codes of the market, numbers, dates, paths, other scripts, nonsense,
// and texts longer than any box wants.
QString TextToType(Generator& generator, const std::vector<std::string>& codes);
// A name for a file in a dialog: never a path.
QString FileNameToType(Generator& generator);

}  // namespace kora::monkey
