#pragma once

#include <fstream>
#include <sstream>
#include <string>
#include <vector>

#include "store/chart_bars.h"

namespace kora::test {

// The days of a file of real prices ("code,yyyymmdd,open,high,low,close,volume,..."), nothing
// where there are no such files on this machine.
inline std::vector<ChartBar> RealBars(const std::string& name) {
  std::vector<ChartBar> bars;
  std::ifstream file(std::string(KORA_DATA_DIR) + "/" + name);
  std::string line;
  while (std::getline(file, line)) {
    std::istringstream fields(line);
    std::string code, date, rest;
    std::getline(fields, code, ',');
    std::getline(fields, date, ',');
    ChartBar bar{};
    char comma;
    if (date.size() != 8 || !(fields >> bar.Open >> comma >> bar.High >> comma >> bar.Low >>
                              comma >> bar.Close >> comma >> bar.Volume))
      continue;
    date.copy(bar.Date, 8);
    bars.push_back(bar);
  }
  return bars;
}

}  // namespace kora::test
