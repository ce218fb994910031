#include "shell/main_menu.h"

#include <algorithm>
#include <array>

#include "base/numbers.h"
#include "base/version.h"

namespace kora {
namespace {

constexpr MenuEntry kMenu[] = {
    {"mnuFile", "&File", ""},
    {"mnuChartDisplay", "&CHARTS", "mnuFile"},
    {"mnuViewNames", "&Name File", "mnuFile"},
    {"mnuViewData", "&Data File", "mnuFile"},
    {"mnuChartDefaults", "Chart De&faults List", "mnuFile"},
    {"mnuFundamtl", "&ASX Company Details", "mnuFile"},
    {"mnuPaths", "&Folder Locations", "mnuFile"},
    {"mnFnts", "&Fonts", "mnuFile"},
    {"mnTPSU", "&Page Setup (Text)", "mnuFile"},
    {"mnPrSU", "Printer &Setup", "mnuFile"},
    {"mnuBackupData", "&Backup Chart Data", "mnuFile"},
    {"mnuRestoreData", "&Restore Data from Backup", "mnuFile"},
    {"mnuExit", "E&XIT", "mnuFile"},
    {"mnuData", "&Edit", ""},
    {"mnuKBUpdate", "Data Entry via &Keyboard", "mnuData"},
    {"mnuLists", "Edit Chart &Lists", "mnuData"},
    {"mnuListsUte", "Chart List &Utilities", "mnuData"},
    {"mnuRenameCL", "Rename Chart Lists", "mnuData"},
    {"nmIndCl", "&Industry Classifications", "mnuData"},
    {"mnuAComms", "&Download", ""},
    {"mnuTARVO", "&KORA Download", "mnuAComms"},
    {"mnuSnap", "&Market Snapshot", "mnuAComms"},
    {"mnuBourse", "&Bourse Data (via Internet)", "mnuAComms"},
    {"mnuEIS", "&EIS / Just data", "mnuAComms"},
    {"mnuDDetails", "Modify &Download Details", "mnuAComms"},
    {"mnuModem", "&Update with Downloaded Data", "mnuAComms"},
    {"mnTools", "&Tools", ""},
    {"mnuAdjustData", "Adjust Data for &Issues", "mnTools"},
    {"mnuAdjExBtn", "&Auto Adjustments from Downloaded Bulletin Files", "mnuAdjustData"},
    {"mnuManAdjust", "&Manual Adjustment", "mnuAdjustData"},
    {"mnuCodeChanged", "&ASX Code Changed", "mnTools"},
    {"mnuDataCk", "Check &Data for Errors and Stocks Stopped Tradin", "mnTools"},
    {"mnuMveData", "&Move data from one folder to another", "mnTools"},
    {"mnuTextFile", "Create &text file of closing prices", "mnTools"},
    {"mnuTFD", "Create te&xt file of data (OHLCV)", "mnTools"},
    {"mnuCDupDts", "&Remove data for a specific date", "mnTools"},
    {"mnuChkNameData", "Check &Name File - Data Files", "mnTools"},
    {"mnuADCheck", "&Check Advance-Decline Totals", "mnTools"},
    {"mnuPntCol", "&Printer Colour", "mnTools"},
    {"mnuAnalysis", "&Chart Scans", ""},
    {"mnuChartScan", "Chart Scan &1 - Prices / Oscillators", "mnuAnalysis"},
    {"mnuChartScan2", "Chart Scan &2 - Volume", "mnuAnalysis"},
    {"mnuChtScan3", "Chart Scan &3 - Parabolic", "mnuAnalysis"},
    {"mnuMMAScan", "Chart Scan &4 - Multiple Moving Averages", "mnuAnalysis"},
    {"mnStats", "Market S&tatistics", "mnuAnalysis"},
    {"mnuHelp", "&Help", ""},
    {"mnSHlp", "KORA Charting Help", "mnuHelp"},
    {"mnuAboutKora", "&About KORA", "mnuHelp"},
};

int SizeOr(std::string_view text, int standing, bool& kept) {
  const double value = Val(text);
  kept = value >= 3000 && value <= 1e6;
  return kept ? CLng(value) : standing;
}

}  // namespace

std::span<const MenuEntry> MainMenu() { return kMenu; }

EntryState MenuEntryState(std::string_view name, const DownloadSettings& download,
                          const CommandWords& words) {
  const int service = download.DataService;
  const bool tarvo = service == 1 || service == 3;
  if (name == "mnuTARVO" || name == "mnuSnap") return {tarvo && !words.NoDownloads, tarvo};
  if (name == "mnuBourse") return {service == 2, service == 2};
  if (name == "mnuEIS") return {service == 5, service == 5};
  if (name == "mnuMveData") return {service == 3, true};
  return {};
}

bool DisabledByLongTask(std::string_view menu) {
  constexpr std::array kMenus{"mnuFile", "mnuData", "mnuAComms", "mnTools", "mnuAnalysis"};
  return std::find(kMenus.begin(), kMenus.end(), menu) != kMenus.end();
}

std::string MainTitle(const Paths& paths) {
  return std::string(kProgramTitle) + "   -   Current Data Folder " + paths.CurrentDataPath;
}

MainSize MainWindowSize(std::string_view height, std::string_view width) {
  MainSize size;
  size.height = SizeOr(height, size.height, size.heightKept);
  size.width = SizeOr(width, size.width, size.widthKept);
  return size;
}

FormPlace CentreForm(double screenWidth, double screenHeight, double width, double height) {
  return {CLng(screenWidth / 2 - width / 2), CLng(0.97 * screenHeight / 2 - height / 2)};
}

}  // namespace kora
