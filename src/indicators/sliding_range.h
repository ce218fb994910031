#pragma once

#include <cstdint>
#include <functional>
#include <vector>

namespace kora {

// Highest and lowest price of a window that moves along the bars, at a constant cost a bar.
struct PriceRange {
  float Highest, Lowest;
};

// The best price of the bars since a given one. A price that is no better than a later one can
// never be the answer again and is dropped at once, so that those kept stand in order. Zeros
// and NaNs don't count.
template <typename Better>
class SlidingBest {
 public:
  // Room for `bars` prices: nothing is allocated afterwards.
  explicit SlidingBest(int bars) { kept_.reserve(static_cast<size_t>(bars)); }

  // Takes the price of a bar; bars come in rising order.
  void Add(int bar, float price) {
    if (price == 0 || price != price) return;
    while (kept_.size() > first_ && !better_(kept_.back().price, price)) kept_.pop_back();
    kept_.push_back({price, bar});
  }
  // The best of the bars from `oldest` on, `start` where none is better. `oldest` never falls.
  float Best(int oldest, float start) {
    while (first_ < kept_.size() && kept_[first_].bar < oldest) ++first_;
    if (first_ == kept_.size() || !better_(kept_[first_].price, start)) return start;
    return kept_[first_].price;
  }

 private:
  struct Kept {
    float price;
    int bar;
  };
  Better better_;
  std::vector<Kept> kept_;
  size_t first_ = 0;
};

class SlidingRange {
 public:
  explicit SlidingRange(int bars) : highest_(bars), lowest_(bars) {}
  void Add(int bar, float high, float low) {
    highest_.Add(bar, high);
    lowest_.Add(bar, low);
  }
  // Of the bars from `oldest` on, looked for from the values of `start`.
  PriceRange Since(int oldest, PriceRange start) {
    return {highest_.Best(oldest, start.Highest), lowest_.Best(oldest, start.Lowest)};
  }

 private:
  SlidingBest<std::greater<float>> highest_;
  SlidingBest<std::less<float>> lowest_;
};

}  // namespace kora
