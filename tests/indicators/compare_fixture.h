#pragma once

#include <string>
#include <vector>

#include "store/price_rec.h"
#include "tests/indicators/osc_fixture.h"
#include "tests/support/failing_io.h"

namespace kora::test {

// An oscillator's fixture with price files: the security TEST.WDT and the compare file INDEX.WDT
// in the data folder.
struct CompareFixture : OscFixture {
  static constexpr const char* kIndex = "c:\\korawin\\data\\index.wdt";

  CompareFixture() {
    settings.paths.CurrentDataPath = "C:\\korawin\\data\\";
    settings.osc.CompFile = kIndex;
  }
  void PutPrices(const std::string& name, const std::vector<float>& closes) {
    std::string bytes;
    for (size_t i = 0; i < closes.size(); ++i) {
      PriceRec record = NewPriceRec(FormatFileDate(DateOfDayNumber(10959 + std::int32_t(i))));
      record.Open = record.High = record.Low = record.Close = closes[i];
      bytes.append(reinterpret_cast<const char*>(&record), sizeof record);
    }
    home.Put("drive_c/korawin/data/" + name, bytes);
  }
  // The security's file and chart, and the compare file.
  void Put(const std::vector<float>& security, const std::vector<float>& compare) {
    PutPrices("TEST.WDT", security);
    PutPrices("INDEX.WDT", compare);
    Closes(security);
  }
};

// The compare file is seen, and gone when it is opened.
struct GoneIo : FailingIo {
  std::unique_ptr<HostFile> Open(const std::string& path, OpenMode mode) override {
    if (path.ends_with("INDEX.WDT")) throw RunTimeError(kFileNotFound);
    return FailingIo::Open(path, mode);
  }
};

constexpr const char* kBadCompareFile =
    "RMX/RMO Compare file path/file details are invalid. Reset details in Chart Defaults "
    "available from the Chart Select window";

}  // namespace kora::test
