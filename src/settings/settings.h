#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <map>
#include <string>
#include <string_view>

#include "platform/settings_file.h"
#include "settings/style_period.h"

namespace kora {

class Dialogs;

// The folder values of section KoraPaths and what goes with them. Folders are DOS paths that
// end in "\".
struct Paths {
  std::string WindowsPath;      // where Kora.ini lies
  std::string KoraDrv;          // "C:"
  std::string SystemPath;       // program folder
  std::string CurrentDataPath;  // Names.dat and the .WDT files
  std::string ChartBackupPath;
  std::string PfmDataPath;
  std::string PfmBackupPath;
  std::string ChartMiscPath;  // SystemPath + "chtmisc\": trendlines, notes
  std::string ChartSavePath;  // SystemPath + "chtsave\": saved charts
};

// Section Download.
struct DownloadSettings {
  std::int16_t DataService = 0;  // 1..5; 0 none
  bool DownloadNew = false;
  std::string DLPath;
  std::string InternetDLfmt;
  bool InternetAccess = false;
  bool UpdateAll = true;
  bool NoWarrants = false;
  std::string ServiceSystem, ServiceIn, ServiceOut;  // DataService 1 and 3 only
  std::int32_t VolumeDivisor = 1;                    // 1, 10, 100, 1000 or 10000
};

// Section Charts.
struct ChartSettings {
  std::string Type;          // letter of the last style, "unknown" when never kept
  std::string Period;        // the same
  std::int16_t Spacing = 0;  // chart units from bar to bar, 1 to 20; 0 never kept
  std::int16_t Bands = 0;    // 0 none, 1 percentage, 2 Bollinger
  std::string AutoOsc;       // "True": an oscillator comes with each chart
  std::int16_t List = 0;     // ChartListNo
  bool AvOne = false, AvTwo = false;
  bool AvCalc = false;              // exponential
  bool ScMethod = true;             // automatic scales
  std::int16_t Av1D = 0, Av2D = 0;  // periods of the averages in days, and
  std::int16_t Av1W = 0, Av2W = 0;  // in weeks or months
  double Cw = 0, Ch = 0;            // width and height of the printed chart, twips
  double SW = 0, SH = 0;            // origin of the printed scale, twips: a margin is negative
  double EFact = 0;                 // print enlargement, 1 as on the screen; 0 never kept
  std::int16_t LineWidth = 0;       // of printed lines, dots: see PrintedLineWidth
  std::int16_t BlankSpace = 0;      // chart units behind the last bar
  std::int16_t GridSpace = 0;       // bars between vertical grid lines, 0 to 100
  bool MovingGrid = true;           // GridSpace 0
  bool HalfGrid = false;
  bool GridLines = false;
  std::int16_t VolHeight = 1;  // 1 to 3
  double WeekFactor = 4.75;    // days to a week
  bool StopLoss = false;
  float StopLossPct = 0;   // 0 to 100 percent
  bool DarkPaper = false;  // light colours are printed darker: they don't read on white
  bool Legible = false;    // labels that would not fit are made to: see ChartRequest
  bool FitSide = false;    // a page that was never turned lies as the chart fits it better
};

// Section Chart Fonts.
struct FontSettings {
  std::string Font1Name;  // empty: the surface's own
  double TitleSize = 8;   // CFontSize, points
  std::string Font2Name;
  double Font2Size = 0;  // SFontSize; 0 where the key is missing, see Font2Points()
  bool Font1Bold = false;
  // The size to set texts of Font 2 in: a size of 0 can't be set, so 8 stands in for it.
  double Font2Points() const { return Font2Size > 0 ? Font2Size : 8; }
};

// Section ChtPage: margins of text print-outs in twips.
struct PageSettings {
  std::int32_t PPTop = 0, PPLft = 0;
  float PPBot = 0, PPRht = 0;
  std::int16_t Orient = 0;  // 1 portrait, 2 landscape; otherwise the printer's
};

// One oscillator value: the daily key and its weekly or monthly twin.
struct PeriodPair {
  std::int16_t daily = 0;
  std::int16_t twin = 0;
  // Daily charts take the daily key, weekly and monthly ones the twin.
  std::int16_t For(Period chartPeriod) const {
    return chartPeriod == Period::kDaily ? daily : twin;
  }
};

// The two keys under which an oscillator keeps one of its values, what a new installation has
// there, and what the chart defaults call it.
struct OscKey {
  const char* daily;
  const char* twin;
  std::int16_t defaultDaily;
  std::int16_t defaultTwin;
  const char* caption;

  bool operator==(const OscKey& other) const { return std::string_view(daily) == other.daily; }
};

// Section OscDef.
struct OscSettings {
  // The periods of a key; 0 where none were read.
  PeriodPair& operator[](const OscKey& key) { return periods[key.daily]; }
  PeriodPair operator[](const OscKey& key) const {
    const auto found = periods.find(key.daily);
    return found == periods.end() ? PeriodPair{} : found->second;
  }
  std::map<std::string, PeriodPair, std::less<>> periods;  // by daily key

  std::string CompFile;
  bool BCCalTp = false;                   // bar and candle charts logarithmic: LogBars
  bool LCalTp = false;                    // line charts logarithmic: LogLines
  bool VCalTp = false;                    // volumes logarithmic: LogVolume
  bool CutVols = false;                   // hold volume bars at the top of their panel
  bool ShowOsc = false;                   // the settings box comes before each oscillator
  bool FXRev = false;                     // FX is drawn upside down
  bool FillIn = false;                    // Directional Movement is filled between its two lines
  bool RFAve = false;                     // R/F shows its averages
  std::array<std::int16_t, 12> MMASet{};  // periods of the multiple averages; below 1 none
};

// Command-line words of the program.
struct CommandWords {
  bool StochSignals = false;     // RM, XT
  bool NoDownloads = false;      // A
  bool ScriptPrintMode = false;  // N
  bool OptionXT = false;         // XT
  bool OptionXS = false;         // XS
};

struct Settings {
  Paths paths;
  DownloadSettings download;
  ChartSettings charts;
  FontSettings fonts;
  PageSettings page;
  OscSettings osc;
  CommandWords words;
  std::int16_t Zoom = 100;   // percent, 50 to 200
  std::int16_t AdjDivs = 0;  // Adjustments/Divs
  bool NoShortNames = false;
  // The screen in units of 640 by 480, by which windows that kept no size grow; and whether it
  // is another one than that.
  double ScreenScaleW = 1, ScreenScaleH = 1;
  bool LargeScreen = false;
  bool PathsMissing = false;  // SystemPath was empty at start
};

// The conversions that every reader of a key uses: "unknown" and other texts are 0.
std::int16_t SettingCInt(const std::string& text);  // out of range: 0
std::int32_t SettingCLng(const std::string& text);
bool SettingBool(const std::string& text, bool whenOther = false);  // "True" in any case

// Reads the command-line words ("RM", "A", "N", "XT", "XS", in any case, blanks between).
CommandWords ParseCommandWords(std::string_view commandLine);

// Reads all keys into `settings`, but for the periods of oscillators, which their table reads. Where
// System is "unknown" FindSystemDrive runs, last, since it saves what was read. False when the user
// gave up there, or when the file that is there can't be read, which is told; either ends the
// program, and `settings` is as it was or half read. Other
// folders that were never kept are those of SetDefaultPaths on the drive of System.
bool ReadSettings(SettingsFile& file, const Files& files, Dialogs& dialogs, Settings& settings);

// The folders of the data service: services 1 and 3 have them, of others they are empty.
void ReadServiceFolders(const SettingsFile& file, DownloadSettings& download);

// Writes the folders, DataService, DLPath and the drive.
void SavePaths(SettingsFile& file, Settings& settings);

// Finds the drive the system lies on: that of WindowsPath when \korawin\kora32.exe is there,
// otherwise the user is asked. Sets the default folders on it and saves them. False when the
// answer was empty.
bool FindSystemDrive(SettingsFile& file, const Files& files, Dialogs& dialogs, Settings& settings);

// The default folders under \korawin\ on `drive` ("C:").
void SetDefaultPaths(Paths& paths, const std::string& drive);

// The switches that ease what is hard on the eye; a new installation has them on, and where a key
// is missing the switch is off.
void WriteEasings(SettingsFile& file);

// A new installation's settings, as `init` writes them: the default folders and chart values
// that show a full chart. The periods of the oscillators are their table's to write.
void WriteDefaultSettings(SettingsFile& file);

}  // namespace kora
