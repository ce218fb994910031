#pragma once

#include <cstdint>

namespace kora::demo {

// Random numbers that are the same on every machine: integer steps and exact scaling only.
// Draw once in an expression at most, since the order of two draws is the compiler's choice.
class Random {
 public:
  // Streams of one seed are independent, so that one security's history does not hang on
  // how much another drew.
  Random(std::uint64_t seed, std::uint64_t stream)
      : state_(Mix(seed + 0x9E3779B97F4A7C15u) ^ Mix(stream + 0xD1B54A32D192ED03u)) {}

  std::uint64_t Next() {
    state_ += 0x9E3779B97F4A7C15u;
    return Mix(state_);
  }
  // 0 up to, not including, 1.
  double Unit() { return double(Next() >> 11) / 9007199254740992.0; }
  double Between(double low, double high) { return low + (high - low) * Unit(); }
  // 0 to n - 1.
  int Below(int n) { return int(((Next() >> 32) * std::uint64_t(n)) >> 32); }
  bool Chance(double probability) { return Unit() < probability; }
  // Bell-shaped, mean 0, variance 1, within 3.47: the sum of four 16-bit draws.
  double Noise() {
    const std::uint64_t n = Next();
    const std::uint64_t sum =
        (n & 0xFFFF) + ((n >> 16) & 0xFFFF) + ((n >> 32) & 0xFFFF) + (n >> 48);
    return (double(sum) / 65536.0 - 1.999969482421875) * 1.7320508075688772;
  }

 private:
  static std::uint64_t Mix(std::uint64_t z) {
    z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9u;
    z = (z ^ (z >> 27)) * 0x94D049BB133111EBu;
    return z ^ (z >> 31);
  }

  std::uint64_t state_;
};

}  // namespace kora::demo
