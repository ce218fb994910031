#pragma once

#include <sstream>
#include <string>
#include <vector>

#include "base/numbers.h"
#include "tests/indicators/osc_fixture.h"
#include "tests/indicators/real_prices.h"

namespace kora::test {

struct Bar {
  float high, low, close;
  std::int32_t volume = 0;
};

// Bars of days with a range; the open is the close.
inline void SetBars(OscFixture& f, const std::vector<Bar>& bars) {
  f.chart.Bars.bars.clear();
  f.chart.Bars.BarCount = -1;
  for (const Bar& b : bars) {
    ChartBar bar{};
    bar.Open = bar.Close = b.close;
    bar.High = b.high;
    bar.Low = b.low;
    bar.Volume = b.volume;
    f.AddBar(bar);
  }
}

// Every oscillator period at one value.
inline void SetAllPeriods(OscFixture& f, std::int16_t period) {
  for (const OscKey& key : OscKeys()) f.settings.osc.*key.value = {period, period};
}

// A price map of `perY` a unit above `bottom`, from 0 up.
inline void SetPriceMap(OscFixture& f, float perY, std::int16_t bottom = 290) {
  f.chart.Price = PriceMap{};
  f.chart.Price.PricePerY = perY;
  f.chart.Price.ChartBottom = bottom;
}

// Real prices, volumes in thousands. False where there are none on this machine.
inline bool SetRealBars(OscFixture& f, const std::string& code) {
  const std::vector<ChartBar> days = RealBars(code + ".csv");
  std::vector<Bar> bars;
  for (const ChartBar& day : days)
    bars.push_back({day.High, day.Low, day.Close, day.Volume / 1000});
  SetBars(f, bars);
  return !bars.empty();
}

// The numbers of a script line behind its letter.
inline std::vector<double> Numbers(const std::string& line) {
  std::vector<double> out;
  std::stringstream fields(line.substr(line.find(',') + 1));
  for (std::string field; std::getline(fields, field, ',');) out.push_back(Val(field));
  return out;
}

// The script's lines of a letter in a colour, as x1, y1, x2, y2 with y on the panel.
inline std::vector<std::vector<double>> Drawn(const OscFixture& f, char letter, int colour,
                                              double offset = 308) {
  std::vector<std::vector<double>> out;
  for (const std::string& line : f.Lines(letter)) {
    std::vector<double> n = Numbers(line);
    if (int(n.back()) != colour) continue;
    n.pop_back();
    for (size_t i = 1; i < n.size(); i += 2) n[i] -= offset;
    out.push_back(n);
  }
  return out;
}

inline std::vector<std::string> Texts(const OscFixture& f) { return f.Lines('T'); }

}  // namespace kora::test

#define EXPECT_SEGMENT(actual, x1, y1, x2, y2)                           \
  do {                                                                   \
    const std::vector<double> segment_ = (actual);                       \
    ASSERT_EQ(segment_.size(), 4u);                                      \
    EXPECT_NEAR(segment_[0], x1, 1e-3);                                  \
    EXPECT_NEAR(segment_[1], y1, 1e-3);                                  \
    EXPECT_NEAR(segment_[2], x2, 1e-3);                                  \
    EXPECT_NEAR(segment_[3], y2, 1e-3);                                  \
  } while (false)
