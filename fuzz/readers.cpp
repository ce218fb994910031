#include "fuzz/readers.h"

namespace kora::test {

std::span<const Reader> Readers() {
  static constexpr Reader readers[] = {
      {"names", ReadNamesBody},           {"prices", ReadPricesBody},
      {"settings", ReadSettingsBody},     {"colours", ReadColoursBody},
      {"lists", ReadListsBody},           {"classes", ReadClassesBody},
      {"tables", ReadTablesBody},         {"script", ReadScriptBody},
      {"trendlines", ReadTrendlinesBody}, {"texts", ReadTextsBody},
      {"daylines", ReadDayLinesBody},     {"download", ReadDownloadBody},
      {"bulletins", ReadBulletinsBody},   {"adjustments", ReadAdjustmentsBody},
      {"master", ReadMasterBody},         {"details", ReadDetailsBody},
      {"import", ReadImportBody},         {"snapshot", ReadSnapshotBody},
      {"journals", ReadJournalsBody},     {"formats", ReadFormatsBody},
      {"numbers", ReadNumbersBody},       {"dates", ReadDatesBody},
      {"charts", DrawPricesBody},         {"scans", ScanPricesBody},
  };
  return readers;
}

const Reader* FindReader(std::string_view name) {
  for (const Reader& reader : Readers())
    if (reader.name == name) return &reader;
  return nullptr;
}

}  // namespace kora::test
