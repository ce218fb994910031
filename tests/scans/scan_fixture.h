#pragma once

#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "lists/chart_list.h"
#include "scans/scan_filter.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {

// Progress that stops at a step, and keeps what was shown.
struct ScanProgress : Progress {
  int stopAt = 0, steps = 0;
  std::vector<std::string> states;
  void Show(ProgressLine line, std::string_view text) override {
    if (line == ProgressLine::kState) states.emplace_back(text);
  }
  bool Step(int, int) override { return ++steps != stopAt; }
};

// A market of a few securities.
struct ScanMarket : ::testing::Test {
  const std::string kData = "c:\\korawin\\data\\";
  const std::string kHostData = "drive_c/korawin/data/";

  ScanMarket() { home.files().MakeFolder(kData); }

  // A further security with its days.
  void Add(const NameRec& name, const std::vector<PriceRec>& days) {
    names.push_back(name);
    home.Put(kHostData + "Names.dat", Bytes(names));
    home.Put(kHostData + std::string(name.Code.trimmed()) + ".WDT", Bytes(days));
  }
  // A share whose days have these closes and, where no range is told, no other prices.
  void Closes(std::string_view code, const std::vector<float>& closes) {
    Add(Security(code), DaysOf(closes));
  }
  static std::vector<PriceRec> DaysOf(const std::vector<float>& closes, std::int32_t volume = 100) {
    std::vector<PriceRec> days;
    for (const float c : closes)
      days.push_back(Day(std::to_string(20000101 + days.size()), c, c, c, c, volume));
    return days;
  }
  ScanRun Run() { return {home.files(), kData, progress}; }
  std::vector<std::string> ResultCodes() {
    return CodesOf(ReadList(home.files(), kData, kResultList));
  }

  TempHome home;
  ScanProgress progress;
  std::vector<NameRec> names;
};

// A scan of that market with its choices: `Read` makes criteria of them, `Walk` runs the scan.
template <typename Choices, typename Criteria, auto Read, auto Walk>
struct ScanOf : ScanMarket {
  // Text, title and field of what stands against the choices.
  std::vector<std::string> FaultOf() {
    Criteria criteria;
    const auto fault = Read(choices, criteria);
    if (!fault) return {};
    return {fault->text, fault->title, fault->field};
  }
  auto Scan() {
    Criteria criteria;
    EXPECT_FALSE(Read(choices, criteria));
    return Walk(Run(), criteria, {});
  }

  Choices choices;
};

}  // namespace kora::test
