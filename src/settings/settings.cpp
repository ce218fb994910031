#include "settings/settings.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "platform/dialogs.h"

namespace kora {
namespace {

constexpr const char* kPathsSection = "KoraPaths";

// One section of the file, read key by key in the types of the settings.
class Section {
 public:
  Section(const SettingsFile& file, std::string_view name) : file_(file), name_(name) {}

  // As it stands: "unknown" where it is missing.
  std::string Raw(std::string_view key) const { return file_.GetSetting(name_, key); }
  std::string Text(std::string_view key, std::string_view whenMissing = "") const {
    std::string value = Raw(key);
    return value == kUnknown ? std::string(whenMissing) : value;
  }
  std::int16_t Short(std::string_view key) const { return SettingCInt(Raw(key)); }
  std::int32_t Long(std::string_view key) const { return SettingCLng(Raw(key)); }
  double Number(std::string_view key, std::string_view whenMissing = "") const {
    const double value = Val(Text(key, whenMissing));
    return std::isfinite(value) ? value : 0;
  }
  float Single(std::string_view key) const {
    const double value = Number(key);
    return std::fabs(value) <= double(std::numeric_limits<float>::max()) ? static_cast<float>(value)
                                                                         : 0;
  }
  bool Flag(std::string_view key, bool whenOther = false) const {
    return SettingBool(Raw(key), whenOther);
  }
  std::string Folder(std::string_view key, const std::string& whenMissing) const {
    return WithBackslash(Text(key, whenMissing));
  }

 private:
  const SettingsFile& file_;
  std::string_view name_;
};

void ReadDownload(const SettingsFile& file, DownloadSettings& download) {
  const Section section(file, "Download");
  download.DataService = section.Short("DataService");
  download.DownloadNew = section.Flag("DownloadNew");
  download.DLPath = section.Text("DLPath");
  download.InternetDLfmt = section.Text("InternetDLfmt");
  download.InternetAccess = section.Flag("Internet Access");
  download.UpdateAll = section.Flag("UpdateAll", true);
  download.NoWarrants = section.Flag("NoWarrants");
  ReadServiceFolders(file, download);
  download.VolumeDivisor = 1;
  const double divisor = section.Number("Volume divisor");
  for (const std::int32_t allowed : {10, 100, 1000, 10000})
    if (divisor == allowed) download.VolumeDivisor = allowed;
}

void ReadCharts(const SettingsFile& file, ChartSettings& charts) {
  const Section section(file, "Charts");
  charts.Type = section.Raw("Type");
  charts.Period = section.Raw("Period");
  charts.Spacing = section.Short("Spacing");
  charts.Bands = section.Short("Bands");
  charts.AutoOsc = section.Text("AutoOsc");
  charts.List = section.Short("List");
  charts.AvOne = section.Flag("AvOne");
  charts.AvTwo = section.Flag("AvTwo");
  charts.AvCalc = section.Flag("AvCalc");
  charts.ScMethod = section.Flag("ScMethod", true);
  charts.Av1D = section.Short("Av1D");
  charts.Av2D = section.Short("Av2D");
  charts.Av1W = section.Short("Av1W");
  charts.Av2W = section.Short("Av2W");
  charts.Cw = section.Number("Cw");
  charts.Ch = section.Number("Ch");
  charts.SW = section.Number("SW");
  charts.SH = section.Number("SH");
  charts.EFact = section.Number("EFact");
  charts.LineWidth = section.Short("Line Width");
  charts.BlankSpace = section.Short("DBlank");
  charts.GridSpace = section.Short("VGSpace");
  charts.MovingGrid = charts.GridSpace == 0;
  charts.HalfGrid = section.Flag("MidGrid");
  charts.GridLines = section.Flag("Grid");
  charts.VolHeight = std::clamp<std::int16_t>(section.Short("VHeight"), 1, 3);
  charts.WeekFactor = section.Number("WeekFactor");
  if (charts.WeekFactor < 4 || charts.WeekFactor > 5.2) charts.WeekFactor = 4.75;
  charts.StopLoss = section.Flag("StopLoss");
  charts.DarkPaper = section.Flag("DarkPaper");
  charts.FitSide = section.Flag("FitSide");
  charts.Legible = section.Flag("Legible");
  charts.StopLossPct = section.Single("SL Percent");
}

void ReadFonts(const SettingsFile& file, FontSettings& fonts) {
  const Section section(file, "Chart Fonts");
  fonts.Font1Name = section.Text("CFont");
  fonts.TitleSize = section.Number("CFontSize", "8");
  fonts.Font2Name = section.Text("SFont");
  fonts.Font2Size = section.Number("SFontSize");  // no default of its own
}

void ReadPage(const SettingsFile& file, PageSettings& page) {
  const Section section(file, "ChtPage");
  page.PPTop = section.Long("PPTop");
  page.PPLft = section.Long("PPLft");
  page.PPBot = section.Single("PPBot");
  page.PPRht = section.Single("PPRht");
  page.Orient = section.Short("Orient");
}

// Each slot takes its number; one that is no number keeps the value it had.
void ReadMovingAverageSet(std::string_view list, std::array<std::int16_t, 12>& set) {
  const std::vector<std::string_view> slots = Split(list, ',');
  for (size_t i = 0; i < std::min(slots.size(), set.size()); ++i) {
    const std::string_view digits = Trim(slots[i]);
    if (digits.empty() || digits.find_first_not_of("0123456789") != std::string_view::npos)
      continue;
    const double value = Val(digits);
    if (value <= std::numeric_limits<std::int16_t>::max()) set[i] = CInt(value);
  }
}

void ReadOscillators(const SettingsFile& file, OscSettings& osc) {
  const Section section(file, "OscDef");
  osc.CompFile = section.Text("CompFile");
  osc.BCCalTp = section.Flag("BCCalTp");
  osc.LCalTp = section.Flag("LCalTp");
  osc.VCalTp = section.Flag("VCalTp");
  osc.CutVols = section.Flag("CutVols");
  osc.ShowOsc = section.Flag("ShowOsc");
  osc.FXRev = section.Flag("FXRev");
  osc.FillIn = section.Flag("FillIn");
  osc.RFAve = section.Flag("RFAve");
  ReadMovingAverageSet(section.Raw("MMASet"), osc.MMASet);
}

// What follows from the program folder.
void DeriveFolders(Paths& paths) {
  paths.KoraDrv = paths.SystemPath.substr(0, 2);
  paths.ChartMiscPath = paths.SystemPath + "chtmisc\\";
  paths.ChartSavePath = paths.SystemPath + "chtsave\\";
}

void WritePaths(SettingsFile& file, const Paths& paths) {
  file.PutSetting(kPathsSection, "System", paths.SystemPath);
  file.PutSetting(kPathsSection, "ChtData", paths.CurrentDataPath);
  file.PutSetting(kPathsSection, "ChtBackUp", paths.ChartBackupPath);
  file.PutSetting(kPathsSection, "PFMData", paths.PfmDataPath);
  file.PutSetting(kPathsSection, "PFMBackUp", paths.PfmBackupPath);
  file.PutSetting("KoraDisk", "KoraDrv", paths.KoraDrv);
}

}  // namespace

void ReadServiceFolders(const SettingsFile& file, DownloadSettings& download) {
  const Section section(file, "Download");
  const bool has = download.DataService == 1 || download.DataService == 3;
  download.ServiceSystem = has ? section.Text("System") : "";
  download.ServiceIn = has ? section.Text("In") : "";
  download.ServiceOut = has ? section.Text("Out") : "";
}

std::int16_t SettingCInt(const std::string& text) {
  try {
    return CInt(Val(text));
  } catch (const RunTimeError&) {
    return 0;
  }
}

std::int32_t SettingCLng(const std::string& text) {
  try {
    return CLng(Val(text));
  } catch (const RunTimeError&) {
    return 0;
  }
}

bool SettingBool(const std::string& text, bool whenOther) {
  const std::string_view word = Trim(text);
  if (EqualNoCase(word, "True")) return true;
  if (EqualNoCase(word, "False")) return false;
  return whenOther;
}

CommandWords ParseCommandWords(std::string_view commandLine) {
  CommandWords words;
  for (const std::string_view part : Split(commandLine, ' ')) {
    const std::string word = UCase(part);
    if (word == "RM") words.StochSignals = true;
    if (word == "A") words.NoDownloads = true;
    if (word == "N") words.ScriptPrintMode = true;
    if (word == "XT") words.OptionXT = words.StochSignals = true;
    if (word == "XS") words.OptionXS = true;
  }
  return words;
}

bool ReadSettings(SettingsFile& file, const Files& files, Dialogs& dialogs, Settings& settings) {
  if (const std::string fault = file.Fault(); !fault.empty()) {
    // Without its settings the program would work on, on the data of some other folder.
    dialogs.Message("Kora.ini in " + files.home() + " can't be read: " + fault, "KORA");
    return false;
  }
  ReadDownload(file, settings.download);
  ReadCharts(file, settings.charts);
  ReadFonts(file, settings.fonts);
  ReadPage(file, settings.page);
  ReadOscillators(file, settings.osc);
  settings.Zoom = Section(file, "ChartForms").Short("Zoom");
  if (settings.Zoom < 50 || settings.Zoom > 200) settings.Zoom = 100;
  settings.AdjDivs = Section(file, "Adjustments").Short("Divs");
  settings.NoShortNames = Section(file, "Adjustments").Flag("NoShortNames");

  const Section section(file, kPathsSection);
  Paths& paths = settings.paths;
  const std::string system = section.Folder("System", "");
  if (system.empty()) {
    // Last, since what it saves includes values of the other sections.
    if (!FindSystemDrive(file, files, dialogs, settings)) return false;
  } else {
    // A folder that was never kept is where a new installation has it.
    Paths standing;
    SetDefaultPaths(standing, system.substr(0, 2));
    paths.SystemPath = system;
    paths.CurrentDataPath = section.Folder("ChtData", standing.CurrentDataPath);
    paths.ChartBackupPath = section.Folder("ChtBackUp", standing.ChartBackupPath);
    paths.PfmDataPath = section.Folder("PFMData", standing.PfmDataPath);
    paths.PfmBackupPath = section.Folder("PFMBackUp", standing.PfmBackupPath);
    DeriveFolders(paths);
  }
  settings.PathsMissing = paths.SystemPath.empty();
  return true;
}

void SavePaths(SettingsFile& file, Settings& settings) {
  DeriveFolders(settings.paths);
  const SettingsFile::Batch batch(file);
  WritePaths(file, settings.paths);
  file.PutSetting("Download", "DataService", Str(std::int32_t(settings.download.DataService)));
  file.PutSetting("Download", "DLPath", settings.download.DLPath);
}

bool FindSystemDrive(SettingsFile& file, const Files& files, Dialogs& dialogs, Settings& settings) {
  std::string drive = settings.paths.WindowsPath.substr(0, 2);
  if (!files.CheckFile(drive + "\\korawin\\kora32.exe")) {
    do {
      const auto entered = dialogs.Prompt(
          "There is a path problem.\nEnter the drive on which KORA is located", "Drive", "C:");
      drive = Trim(entered.value_or(""));
      if (drive.empty()) return false;
      if (drive.size() == 1) drive += ':';
      drive.resize(2);
      // What is no drive is asked again.
    } while (drive[1] != ':' || UCase(drive) < "A:" || UCase(drive) > "Z:");
  }
  SetDefaultPaths(settings.paths, drive);
  SavePaths(file, settings);
  return true;
}

void SetDefaultPaths(Paths& paths, const std::string& drive) {
  paths.SystemPath = drive + "\\korawin\\";
  paths.CurrentDataPath = paths.SystemPath + "data\\";
  paths.ChartBackupPath = paths.SystemPath + "backup\\";
  paths.PfmDataPath = paths.SystemPath + "pfmdata\\";
  paths.PfmBackupPath = paths.SystemPath + "pfmback\\";
  DeriveFolders(paths);
}

void WriteEasings(SettingsFile& file) {
  const SettingsFile::Batch batch(file);
  for (const char* key : {"DarkPaper", "FitSide", "KeepOsc", "Legible"})
    file.PutSetting("Charts", key, "True");
}

void WriteDefaultSettings(SettingsFile& file) {
  const SettingsFile::Batch batch(file);
  WriteEasings(file);
  Paths paths;
  SetDefaultPaths(paths, "c:");
  WritePaths(file, paths);

  struct Default {
    const char* section;
    const char* key;
    const char* value;
  };
  static constexpr Default kDefaults[] = {
      {"Download", "DataService", "4"},
      {"Download", "DownloadNew", "False"},
      {"Download", "DLPath", "c:\\korawin\\download\\"},
      {"Download", "InternetDLfmt", "YYYYMMDD.D"},
      {"Download", "Internet Access", "False"},
      {"Download", "UpdateAll", "True"},
      {"Download", "NoWarrants", "False"},
      {"Download", "Volume divisor", "1"},
      {"Charts", "Type", "B"},
      {"Charts", "Period", "A"},
      {"Charts", "Spacing", "2"},
      {"Charts", "Bands", "0"},
      {"Charts", "AutoOsc", "False"},
      {"Charts", "List", "1"},
      {"Charts", "AvOne", "False"},
      {"Charts", "AvTwo", "False"},
      {"Charts", "Av1D", "21"},
      {"Charts", "Av2D", "55"},
      {"Charts", "Av1W", "10"},
      {"Charts", "Av2W", "30"},
      {"Charts", "AvCalc", "False"},
      {"Charts", "ScMethod", "True"},
      {"Charts", "Cw", "0"},
      {"Charts", "Ch", "0"},
      {"Charts", "SW", "0"},
      {"Charts", "SH", "0"},
      {"Charts", "EFact", "1.5"},
      {"Charts", "Line Width", "2"},
      {"Charts", "DBlank", "10"},
      {"Charts", "VGSpace", "0"},
      {"Charts", "MidGrid", "False"},
      {"Charts", "Grid", "True"},
      {"Charts", "VHeight", "2"},
      {"Charts", "WeekFactor", "4.75"},
      {"Charts", "StopLoss", "False"},
      {"Charts", "SL Percent", "0"},
      {"Chart Fonts", "CFont", ""},
      {"Chart Fonts", "CFontSize", "9.75"},
      {"Chart Fonts", "SFont", ""},
      {"Chart Fonts", "SFontSize", "6"},
      {"ChartForms", "Zoom", "100"},
      {"Adjustments", "Divs", "0"},
      {"Adjustments", "NoShortNames", "False"},
  };
  for (const Default& d : kDefaults) file.PutSetting(d.section, d.key, d.value);

  for (const char* flag :
       {"BCCalTp", "LCalTp", "VCalTp", "CutVols", "ShowOsc", "FXRev", "FillIn", "RFAve"})
    file.PutSetting("OscDef", flag, "False");
  file.PutSetting("OscDef", "MMASet", "3,5,8,10,12,15,30,35,40,45,50,60");
}

}  // namespace kora
