#include "looks/colours.h"

#include <algorithm>
#include <cstring>
#include <iterator>

#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestFile = 1u << 20;
constexpr int kFirstRole = kBorder;
constexpr int kLastRole = kOscLine4;
constexpr int kFileEntries = 50;     // Koraclr.dat
constexpr int kVariantEntries = 49;  // its variants

struct Role {
  const char* name;
  int standard;  // entry of the standard colours
};

constexpr Role kRoles[] = {
    {"Border", 3},
    {"Background", 0},
    {"Chart lines", 15},
    {"Average 1", 14},
    {"Average 2", 10},
    {"Average 3", 12},
    {"Volume bars", 14},
    {"Trendlines", 2},
    {"Adjustments", 6},
    {"Moving grid", 13},
    {"Chart title", 14},
    {"Scales / text", 7},
    {"C'stick / P+F Dn", 4},
    {"Reversal", 12},
    {"Key reversal", 10},
    {"Hook reversal", 11},
    {"Open-close rev", 14},
    {"Pivot point", 2},
    {"End of year marker", 11},
    {"Fixed grid lines", 8},
    {"MACD", 10},
    {"Volatility 1", 11},
    {"Osc/Indicator UP", 10},
    {"Volatility 2", 11},
    {"Osc/Indicator DOWN", 14},
    {"Bands", 14},
    {"unused", 6},
    {"MMA (Short)", 12},
    {"MMA (Long)", 10},
    {"Oscillator Line 1", 11},
    {"Oscillator Line 2", 12},
    {"Oscillator Line 3", 11},
    {"Oscillator Line 4", 10},
};
static_assert(std::size(kRoles) == kLastRole - kFirstRole + 1);

void SetStandard(ChartColours& colours) {
  std::copy(StandardColours().begin(), StandardColours().end(), colours.begin());
}

void SetDefaults(ChartColours& colours) {
  SetStandard(colours);
  for (int entry = kFirstRole; entry <= kLastRole; ++entry)
    colours[size_t(entry)] = StandardColours()[size_t(kRoles[entry - kFirstRole].standard)];
}

// Reads the first `count` lines over the table. False when reading stops before them; what was
// read by then stays.
bool ReadTable(const Files& files, const std::string& path, int count, ChartColours& colours) {
  bool whole = true;
  try {
    const std::string text = files.ReadAll(path, kLargestFile);
    LineReader lines(text);
    std::string_view line;
    for (int entry = 0; entry < count && whole; ++entry) {
      whole = lines.Next(line);
      if (whole) colours[size_t(entry)] = CLng(Val(line));
    }
  } catch (const RunTimeError&) {
    whole = false;
  }
  // The first sixteen are no one's to change.
  SetStandard(colours);
  return whole;
}

std::string_view VariantFile(std::string_view variant) {
  if (variant == "White") return "Koraclr.WHT";
  if (variant == "Blue") return "Koraclr.BLU";
  return "Koraclr.BLK";
}

#pragma pack(push, 1)
struct PrinterRec {
  std::int16_t ColourPrinter;
  std::int16_t WhiteAsBlack;
};
#pragma pack(pop)
static_assert(sizeof(PrinterRec) == 4);

std::string PrinterFilePath(const std::string& systemPath) { return systemPath + "koraprn.dat"; }

}  // namespace

const std::array<std::int32_t, 16>& StandardColours() {
  static constexpr std::array<std::int32_t, 16> colours{
      0x000000, 0x800000, 0x008000, 0x808000, 0x000080, 0x800080, 0x008080, 0xC0C0C0,
      0x808080, 0xFF0000, 0x00FF00, 0xFFFF00, 0x0000FF, 0xFF00FF, 0x00FFFF, 0xFFFFFF};
  return colours;
}

const char* ColourRoleName(int entry) {
  return entry < kFirstRole || entry > kLastRole ? "" : kRoles[entry - kFirstRole].name;
}

void LoadColours(const Files& files, const std::string& systemPath, std::string_view variant,
                 ChartColours& colours) {
  SetDefaults(colours);
  const std::string path = systemPath + std::string(VariantFile(variant));
  if (files.CheckFile(path)) ReadTable(files, path, kVariantEntries, colours);
}

void WriteColourVariants(const Files& files, const std::string& systemPath) {
  struct Variant {
    const char* name;
    std::array<std::int32_t, std::size(kRoles)> roles;  // in the order of the table
  };
  // 0xBBGGRR.
  static constexpr Variant kVariants[] = {
      {"White",
       {0x808080, 0xFFFFFF, 0x000000, 0x0000C0, 0x800000, 0x006000, 0xA06020, 0x008000, 0x004080,
        0xC0C0C0, 0x600000, 0x303030, 0x2020C0, 0x0000D0, 0x007000, 0xA04000, 0x007090, 0x008000,
        0x906000, 0xD8D8D8, 0x007000, 0x906000, 0x007000, 0x0060C0, 0x2020C0, 0x0060A0, 0x004080,
        0x2020C0, 0x006000, 0x904000, 0x2020C0, 0x007000, 0x800080}},
      {"Blue",
       {0xC0A080, 0x500000, 0xFFFFFF, 0x60FFFF, 0x80FF80, 0x9090FF, 0x60E0FF, 0x80FF80, 0xFFC080,
        0x905050, 0x80FFFF, 0xE8E8E8, 0x8080FF, 0x9090FF, 0x80FF80, 0xFFFF80, 0x80FFFF, 0x80FF80,
        0xFFFF80, 0x804040, 0x80FF80, 0xFFFF80, 0x80FF80, 0x80C0FF, 0x8080FF, 0x60FFFF, 0xFFC080,
        0x9090FF, 0x80FF80, 0xFFFF80, 0x9090FF, 0x80FF80, 0xFF90FF}},
  };
  for (const Variant& variant : kVariants) {
    const std::string path = systemPath + std::string(VariantFile(variant.name));
    if (files.CheckFile(path)) continue;
    ChartColours colours{};
    SetStandard(colours);
    std::copy(variant.roles.begin(), variant.roles.end(), colours.begin() + kFirstRole);
    std::string text;
    for (int entry = 0; entry < kVariantEntries; ++entry)
      text += Str(colours[size_t(entry)]) + "\r\n";
    files.WriteAll(path, text);
  }
}

bool LoadUserColours(const Files& files, const std::string& systemPath, ChartColours& colours) {
  const std::string path = systemPath + "Koraclr.dat";
  if (!files.CheckFile(path)) {
    LoadColours(files, systemPath, "Black", colours);
    return true;
  }
  SetDefaults(colours);
  return ReadTable(files, path, kFileEntries, colours);
}

void SaveColours(const Files& files, const std::string& systemPath, const ChartColours& colours) {
  std::string text;
  for (int entry = 0; entry < kFileEntries; ++entry) text += Str(colours[size_t(entry)]) + "\r\n";
  files.WriteAll(systemPath + "Koraclr.dat", text);
}

PrinterColours ReadPrinterColours(const Files& files, const std::string& systemPath) {
  PrinterColours value;
  try {
    const RecordFile<PrinterRec> file(files, PrinterFilePath(systemPath));
    if (file.count() == 0) return value;
    const PrinterRec rec = file.Read(1);
    value.asked = true;
    value.ColourPrinter = rec.ColourPrinter;
    value.WhiteAsBlack = rec.WhiteAsBlack;
  } catch (const RunTimeError&) {
    // What can't be read was not asked.
  }
  return value;
}

void AskPrinterColours(const Files& files, const std::string& systemPath, Dialogs& dialogs,
                       PrinterColours& value) {
  value.ColourPrinter = 0;
  value.WhiteAsBlack = 1;
  if (dialogs.Ask("  Do you have a Colour Printer ?", "Printer", Buttons::kYesNo) == Answer::kYes) {
    value.ColourPrinter = 1;
    if (dialogs.Ask("Print the colour WHITE as BLACK ?", "Chart Printing", Buttons::kYesNo) !=
        Answer::kYes)
      value.WhiteAsBlack = 0;
  }
  value.asked = true;
  try {
    WritePrinterColours(files, systemPath, value);
  } catch (const RunTimeError&) {
    // The answers hold for this run.
  }
}

void WritePrinterColours(const Files& files, const std::string& systemPath,
                         const PrinterColours& value) {
  const PrinterRec rec{value.ColourPrinter, value.WhiteAsBlack};
  char bytes[sizeof rec];
  std::memcpy(bytes, &rec, sizeof rec);
  files.WriteAll(PrinterFilePath(systemPath), std::string_view(bytes, sizeof bytes));
}

}  // namespace kora
