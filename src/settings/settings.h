#pragma once

#include <array>
#include <cstdint>
#include <string>

#include "platform/settings_file.h"

namespace kora {

class Dialogs;

// The folder values of section KoraPaths and what goes with them. Folders are DOS paths that
// end in "\".
struct Paths {
  std::string WindowsPath;       // where Kora.ini lies
  std::string KoraDrv;           // "C:"
  std::string SystemPath;        // program folder
  std::string CurrentDataPath;   // Names.dat and the .WDT files
  std::string ChartBackupPath;
  std::string PfmDataPath;
  std::string PfmBackupPath;
  std::string ChartMiscPath;     // SystemPath + "chtmisc\": trendlines, notes
  std::string ChartSavePath;     // SystemPath + "chtsave\": saved charts
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
  std::string Type;         // last ChartStyle, "unknown" when never kept
  std::string Period;       // the same
  std::int16_t Spacing = 0;
  std::int16_t Bands = 0;
  std::string AutoOsc;
  std::int16_t List = 0;
  bool AvOne = false, AvTwo = false;
  bool AvCalc = false;      // exponential
  bool ScMethod = true;     // automatic scales
  std::int16_t Av1D = 0, Av2D = 0, Av1W = 0, Av2W = 0;
  double Cw = 0, Ch = 0;    // printed width and height
  double SW = 0, SH = 0;    // print margins
  double EFact = 0;         // print enlargement
  std::int16_t LineWidth = 0;
  std::int16_t BlankSpace = 0;
  std::int16_t GridSpace = 0;
  bool MovingGrid = true;   // GridSpace 0
  bool HalfGrid = false;
  bool GridLines = false;
  std::int16_t VolHeight = 1;  // 1 to 3
  double WeekFactor = 4.75;
  bool StopLoss = false;
  float StopLossPct = 0;
};

// Section Chart Fonts.
struct FontSettings {
  std::string Font1Name;   // empty: the surface's own
  double TitleSize = 8;    // CFontSize, points
  std::string Font2Name;
  double Font2Size = 0;    // SFontSize; 0 where the key is missing, see Font2Points()
  bool Font1Bold = false;
  // The size to set texts of Font 2 in: a size of 0 can't be set, so 8 stands in for it.
  double Font2Points() const { return Font2Size > 0 ? Font2Size : 8; }
};

// Section ChtPage.
struct PageSettings {
  std::int32_t PPTop = 0, PPLft = 0;
  float PPBot = 0, PPRht = 0;
  std::int16_t Orient = 0;
};

// One oscillator value: the daily key and its weekly or monthly twin.
struct PeriodPair {
  std::int16_t daily = 0;
  std::int16_t twin = 0;
  // "A" takes the daily key, anything else the twin.
  std::int16_t For(const std::string& chartPeriod) const {
    return chartPeriod == "A" ? daily : twin;
  }
};

// Section OscDef.
struct OscSettings {
  PeriodPair StochK, StochD, FXF, FXX, RocP, RocA, RsiP, RmoP, RmoA, RmxP, RmxA;
  PeriodPair Md1, Md2, Md3, WmsA, ERA, DMA, DMXA, MMA, CopD, HolyD, VtyD;
  std::string CompFile;
  bool BCCalTp = false;  // bar and candle charts logarithmic: LogBars
  bool LCalTp = false;   // line charts logarithmic: LogLines
  bool VCalTp = false;   // volumes logarithmic: LogVolume
  bool CutVols = false;  // hold volume bars at the top of their panel
  bool ShowOsc = false;
  bool FXRev = false;
  bool FillIn = false;
  bool RFAve = false;
  std::array<std::int16_t, 12> MMASet{};
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
  std::int16_t Zoom = 100;        // percent, 50 to 200
  std::int16_t AdjDivs = 0;       // Adjustments/Divs
  bool NoShortNames = false;
  double ScreenScaleW = 1, ScreenScaleH = 1;
  bool LargeScreen = false;
  bool PathsMissing = false;      // SystemPath was empty at start
};

// One oscillator key pair, for those that list or edit them all.
struct OscKey {
  const char* daily;
  const char* twin;
  std::int16_t defaultDaily;
  std::int16_t defaultTwin;
  PeriodPair OscSettings::*value;
};
// In the order in which the defaults form shows and saves them.
const std::array<OscKey, 22>& OscKeys();

// The conversions that every reader of a key uses: "unknown" and other texts are 0.
std::int16_t SettingCInt(const std::string& text);  // out of range: 0
std::int32_t SettingCLng(const std::string& text);
bool SettingBool(const std::string& text, bool whenOther = false);  // "True" in any case

// Reads the command-line words ("RM", "A", "N", "XT", "XS", in any case, blanks between).
CommandWords ParseCommandWords(std::string_view commandLine);

// Reads all keys into `settings`. Where System is "unknown" FindSystemDrive runs, last, since
// it saves what was read. False when the user gave up there, which ends the program. Other
// folders that were never kept are those of SetDefaultPaths on the drive of System.
bool ReadPaths(SettingsFile& file, const Files& files, Dialogs& dialogs, Settings& settings);

// The folders of the data service: services 1 and 3 have them, of others they are empty.
void ReadServiceFolders(const SettingsFile& file, DownloadSettings& download);

// Writes the folders, DataService, DLPath and the drive.
void SavePaths(SettingsFile& file, Settings& settings);

// Finds the drive the system lies on: that of WindowsPath when \korawin\kora32.exe is there,
// otherwise the user is asked. Sets the default folders on it and saves them. False when the
// answer was empty.
bool FindSystemDrive(SettingsFile& file, const Files& files, Dialogs& dialogs,
                     Settings& settings);

// The default folders under \korawin\ on `drive` ("C:").
void SetDefaultPaths(Paths& paths, const std::string& drive);

// A new installation's settings, as `init` writes them: the default folders, the oscillator
// periods of their table and chart values that show a full chart.
void WriteDefaultSettings(SettingsFile& file);

}  // namespace kora
