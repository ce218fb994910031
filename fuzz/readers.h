#pragma once

#include <span>
#include <string_view>

// What the readers must hold whatever bytes they meet. A body takes the bytes of a file, or of a
// text, in the place where the program reads them, in a home in memory, and ends the process where
// a promise is broken; no other exception than those that the reader names may leave it. Each is
// the body of a fuzz target, of a replay of its corpus and of a mutation test.

namespace kora::test {

struct Reader {
  std::string_view name;  // of its corpus and its dictionary, too
  void (*body)(std::string_view bytes);
};

std::span<const Reader> Readers();
// Null for a name that none has.
const Reader* FindReader(std::string_view name);

// fuzz/store_bodies.cpp
void ReadNamesBody(std::string_view bytes);       // Names.dat
void ReadPricesBody(std::string_view bytes);      // a price file
void ReadListsBody(std::string_view bytes);       // a chart list
void ReadTrendlinesBody(std::string_view bytes);  // .TND
void ReadTextsBody(std::string_view bytes);       // texts of a chart
void ReadClassesBody(std::string_view bytes);     // IndClass.dat
void ReadTablesBody(std::string_view bytes);      // WMPaths.lst, WMDef.Lst, Mainfile, Update.Lst

// fuzz/text_bodies.cpp
void ReadNumbersBody(std::string_view bytes);
void ReadFormatsBody(std::string_view bytes);
void ReadDatesBody(std::string_view bytes);
void ReadDayLinesBody(std::string_view bytes);  // lines of a downloaded file

// fuzz/settings_bodies.cpp
void ReadSettingsBody(std::string_view bytes);  // Kora.ini
void ReadColoursBody(std::string_view bytes);   // Koraclr.*, koraprn.dat

// fuzz/update_bodies.cpp
void ReadDownloadBody(std::string_view bytes);     // a downloaded file
void ReadMasterBody(std::string_view bytes);       // KoraName.*, and the text it is made from
void ReadDetailsBody(std::string_view bytes);      // details of companies
void ReadImportBody(std::string_view bytes);       // price history
void ReadBulletinsBody(std::string_view bytes);    // *.Btn
void ReadAdjustmentsBody(std::string_view bytes);  // Adjust.Lst
void ReadSnapshotBody(std::string_view bytes);     // Snapshot.Dat and its answer
void ReadJournalsBody(std::string_view bytes);     // Update.Jnl, Kora.set~

// fuzz/chart_bodies.cpp
void ReadScriptBody(std::string_view bytes);  // a chart script
void DrawPricesBody(std::string_view bytes);  // a chart of any price file
void ScanPricesBody(std::string_view bytes);  // the scans of any price file

}  // namespace kora::test
