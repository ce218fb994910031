#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <string_view>

#include "base/files.h"

namespace kora {

class Dialogs;

// Entries of the colour table. 0 to 15 are the sixteen standard colours; the roles follow.
enum ColourEntry : int {
  kBorder = 16,
  kBackground = 17,
  kChartLines = 18,
  kAverage1 = 19,
  kAverage2 = 20,
  kAverage3 = 21,
  kVolumeBars = 22,
  kTrendlines = 23,
  kAdjustments = 24,
  kMovingGrid = 25,
  kChartTitle = 26,
  kScalesText = 27,
  kCandleDown = 28,  // "C'stick / P+F Dn"
  kReversal = 29,
  kKeyReversal = 30,
  kHookReversal = 31,
  kOpenCloseRev = 32,
  kPivotPoint = 33,
  kEndOfYear = 34,
  kFixedGrid = 35,
  kMacdColour = 36,
  kVolatility1 = 37,
  kOscUp = 38,
  kVolatility2 = 39,
  kOscDown = 40,
  kBands = 41,
  kUnused = 42,
  kMmaShort = 43,
  kMmaLong = 44,
  kOscLine1 = 45,
  kOscLine2 = 46,
  kOscLine3 = 47,
  kOscLine4 = 48,
};

// 51 colours, red in the low byte.
using ChartColours = std::array<std::int32_t, 51>;

// The sixteen standard colours, black to bright white.
const std::array<std::int32_t, 16>& StandardColours();
// The name under which an entry from 16 to 48 shows: "Border", "Background", ...
const char* ColourRoleName(int entry);

// Sets 0 to 15 from the standard colours and the rest from the file of the variant ("Black",
// "White", "Blue": Koraclr.BLK, .WHT, .BLU in `systemPath`), entries 0 to 48; where that file
// is missing, the default roles. Entries 49 and 50 stay.
void LoadColours(const Files& files, const std::string& systemPath, std::string_view variant,
                 ChartColours& colours);

// Writes the tables White and Blue of a new installation, in colours that read on a light and on
// a deep blue ground; one that is there already stays. Errors of Files::WriteAll.
void WriteColourVariants(const Files& files, const std::string& systemPath);

// At start: the user's Koraclr.dat, 50 values, else "Black". A file with fewer lines leaves the
// entries read so far over the defaults; false then.
bool LoadUserColours(const Files& files, const std::string& systemPath, ChartColours& colours);

// Writes entries 0 to 49 to Koraclr.dat. Errors of Files::WriteAll.
void SaveColours(const Files& files, const std::string& systemPath, const ChartColours& colours);

// koraprn.dat, 4 bytes.
struct PrinterColours {
  bool asked = false;              // false: the file is missing or empty
  std::int16_t ColourPrinter = 0;  // 1 colour, 0 black and white
  std::int16_t WhiteAsBlack = 1;   // 1: white prints in black
};
PrinterColours ReadPrinterColours(const Files& files, const std::string& systemPath);
// Puts the two questions of the printer and writes the answers; a cancelled write is passed over.
void AskPrinterColours(const Files& files, const std::string& systemPath, Dialogs& dialogs,
                       PrinterColours& value);
void WritePrinterColours(const Files& files, const std::string& systemPath,
                         const PrinterColours& value);

}  // namespace kora
