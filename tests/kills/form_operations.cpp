// What forms write, done by the routines that they call; and commands that need a scene of their
// own.

#include <algorithm>
#include <cstring>

#include "adjust/adjust_list.h"
#include "adjust/adjust_options.h"
#include "base/text.h"
#include "chart/chart_printing.h"
#include "chartwindow/chart_window.h"
#include "companies/company_grid.h"
#include "companies/snapshot.h"
#include "companies/stock_details.h"
#include "indicators/chart_defaults.h"
#include "indicators/overlay_settings.h"
#include "lists/chart_list.h"
#include "looks/look_settings.h"
#include "maintenance/backup.h"
#include "maintenance/data_checks.h"
#include "maintenance/note_list.h"
#include "names/name_editor.h"
#include "platform/headless/headless_surface.h"
#include "platform/progress.h"
#include "platform/qt/qt_printer.h"
#include "scans/result_list.h"
#include "store/industry_classes.h"
#include "store/market_folders.h"
#include "store/price_edit.h"
#include "tests/kills/operations.h"
#include "tests/support/records.h"
#include "update/download_list.h"
#include "update/download_settings.h"
#include "update/security_details.h"

namespace kora::test {
namespace {

const std::string kOther = "drive_c/korawin/other/";

NameEditor Editor(Session& s) {
  NameEditor editor({s.files, s.settings.paths.CurrentDataPath, s.settings.paths.SystemPath,
                     s.dialogs, s.ini, s.settings.download});
  editor.Load();
  return editor;
}

// The editor over the name file with more records, put there as another program would.
Step WithNames(std::vector<NameRec> more) {
  return Do([more](Session& s) {
    std::vector<NameRec> names = ReadNames(s.files, s.settings.paths.CurrentDataPath);
    names.insert(names.end(), more.begin(), more.end());
    WriteNames(s.files, NameFilePath(s.settings.paths.CurrentDataPath), names);
    return true;
  });
}

NameRec Named(const char* code, const char* name, std::int16_t category = 1) {
  NameRec rec = Security(code, category);
  rec.Name.set(name);
  return rec;
}

bool Locate(Session& s, const char* code) {
  s.current.CurrentCode = code;
  return LocateCurrentCode(s.files, s.settings.paths.CurrentDataPath, s.dialogs, s.current);
}

// Days of a price file, a day of 2020 each, as "a file of another folder" needs them.
std::string Days(int first, int last, float close) {
  std::vector<PriceRec> days;
  for (int day = first; day <= last; ++day) {
    const std::string date = "202001" + std::string(day < 10 ? "0" : "") + std::to_string(day);
    days.push_back(Day(date, close, close + 1, close - 1, close, 100));
  }
  return Bytes(days);
}

// A move of a file of ten days, from the 10th to the 19th, over one of other days.
Operation Move(const char* name, int first, int last) {
  const std::vector<NameRec> names{Named("MOV", "Moved")};
  return {name,
          {},
          Cmd("move", "MOV", "--from", "c:\\korawin\\from\\", "--to", "c:\\korawin\\other\\"),
          kWhole,
          {{"drive_c/korawin/from/Names.dat", Bytes(names)},
           {"drive_c/korawin/from/MOV.WDT", Days(10, 19, 5)},
           {kOther + "Names.dat", ""},
           {kOther + "MOV.WDT", Days(first, last, 9)},
           {kOther + "MOV.OLD", Days(1, 2, 1)}}};
}

// A chart on show in the window, on surfaces without a screen.
bool SaveChart(Session& s, const char* path) {
  HeadlessSurface price(638, 452), panel(638, 144);
  ChartWindow window({.files = s.files,
                      .dialogs = s.dialogs,
                      .settings = s.settings,
                      .ini = s.ini,
                      .user = s.user,
                      .colours = s.colours,
                      .current = s.current,
                      .state = s.charts,
                      .price = price,
                      .panel = panel});
  window.Load();
  if (!window.ShowAt(1)) return false;
  window.StartSaving();
  window.SaveChartAs(path, {});
  // "CHART SAVED" and "CHART NOT SAVED" are both told; what became of it shows in the file.
  return s.files.CheckFile(path) && s.files.ReadAll(path) == s.files.ReadAll(window.ScriptOnShow());
}

// Without the day and the mark that a printed document bears.
std::string WithoutDate(std::string pdf) {
  for (const char* key : {"/CreationDate (", "<xmp:CreateDate>", "<xmp:ModifyDate>",
                          "<xmp:MetadataDate>", "/ID [ <", "uuid:"})
    for (size_t at = pdf.find(key); at != std::string::npos; at = pdf.find(key, at + 1))
      for (size_t i = at + std::strlen(key);
           i < pdf.size() && std::strchr(")<>", pdf[i]) == nullptr; ++i)
        pdf[i] = '0';
  return pdf;
}

bool PrintSaved(Session& s) {
  const std::string out = "c:\\korawin\\chart.pdf";
  QtPrinter printer([&](const std::string& bytes) { s.files.WriteAll(out, WithoutDate(bytes)); });
  printer.SetDevice(QtPrinter::kPdfPrinter);
  const ChartPrintServices services{s.files, s.dialogs, printer, s.settings.fonts, s.colours, {}};
  PrintSetup setup = PrintSetupFrom(s.settings, s.printer);
  return PrintChart(services, setup, {638, 452}, "c:\\korawin\\chtsave\\a.cht");
}

// A list in two boxes, one security moved from the first to the second.
bool MoveBetweenLists(Session& s) {
  const std::string& data = s.settings.paths.CurrentDataPath;
  ListSide a{2, CodesOf(ReadList(s.files, data, 2)), false};
  ListSide b{3, CodesOf(ReadList(s.files, data, 3)), false};
  const std::vector<size_t> first{0};
  if (!MoveItems(a, b, first).empty()) return false;
  const std::vector<ListSide> sides{a, b};
  SaveSides(s.files, data, sides);
  return true;
}

}  // namespace

const std::vector<Operation>& FormOperations() {
  static const std::vector<Operation> operations = {
      // ---- Names
      {"name editor saved", {}, Do([](Session& s) {
         NameEditor editor = Editor(s);
         if (editor.Put(0, NameColumn::kName, "Another Name")) return false;
         editor.Delete(2, 1);
         editor.Insert(1);
         if (editor.Put(1, NameColumn::kCode, "ZED")) return false;
         if (editor.Put(1, NameColumn::kType, "4")) return false;
         return editor.SaveNames().saved;
       })},
      {"warrants removed from the names",
       {WithNames({Named("BHPWAB", "A warrant", 81), Named("ORE", "None", 2)})},
       Cmd("--answer", "yes", "edit-names", "remove-warrants"),
       kFileByFile},
      {"duplicate names removed",
       {WithNames({Named("CJQ", "Again", 5)})},
       Cmd("--answer", "ok", "edit-names", "remove-duplicates")},
      {"classes of options filled",
       {WithNames({Named("CJQAB", "An option", 70)})},
       Cmd("edit-names", "fill-classes")},
      {"expired names removed",
       {WithNames({Named("OLDAB", "**EXPIRED**", 70)})},
       Cmd("edit-names", "remove-expired")},
      {"names taken from the master list",
       {Cmd("master", "{home}/list.csv")},
       Cmd("edit-names", "from-master"),
       kWhole,
       {{"list.csv", "CJQ,4,3,122,Another,x\nCXQ,4,3,122,One more,y\n"}}},
      {"master list made",
       {Cmd("master", "{home}/old.csv")},
       Cmd("master", "{home}/list.csv"),
       kWhole,
       {{"old.csv", "AAA,4,3,122,Another,x\nBBB,4,3,122,One more,y\n"},
        {"list.csv", "CJQ,4,3,122,Another,x\nCXQ,4,3,122,One more,y\n"}}},
      {"details transferred to the name file", {}, Do([](Session& s) {
         return TransferDetails(s.files, s.settings.paths.CurrentDataPath,
                                {{"CJQ", "1.00"}, {"CXQ", "2.00"}}) == 2;
       })},
      {"scales of a security",
       {},
       Do([](Session& s) {
         if (!Locate(s, "CJQ")) return false;
         SaveScales(s.files, s.settings.paths.CurrentDataPath, s.current, "1", "20", "0.5");
         return true;
       }),
       kInPlace},
      {"bands of a security",
       {},
       Do([](Session& s) {
         return Locate(s, "CJQ") && SaveBands(s.files, s.settings.paths.CurrentDataPath, s.current,
                                              BandForm::kBollinger, "25", "3");
       }),
       kInPlace},

      // ---- Prices by hand
      {"data form saved", {}, Cmd("edit", "CJQ", "set", "3", "Close", "9.99")},
      {"data form saved again",
       {Cmd("edit", "CJQ", "set", "4", "Close", "8.88")},
       Cmd("edit", "CJQ", "set", "3", "Close", "9.99")},
      {"records deleted in the data form", {}, Cmd("edit", "CJQ", "delete", "3-9")},
      {"records scaled in the data form",
       {},
       Cmd("edit", "CJQ", "scale", "1-50", "--items", "open,high,low,close", "--by", "x10")},

      // ---- Adjustments
      {"cash issue",
       {},
       Cmd("adjust", "cash", "CJQ", "--date", "{day}", "--new", "1", "--held", "4", "--cost",
           "0.50")},
      {"call", {}, Cmd("adjust", "call", "CJQ", "--date", "{day}", "--amount", "0.10")},
      {"dividend",
       {Cmd("adjust", "split", "CJQ", "--date", "{day}", "--new", "2", "--old", "1")},
       Cmd("adjust", "dividend", "CJQ", "--date", "{day}", "--amount", "0.10")},
      {"done adjustments removed from the list",
       {Cmd("bulletins", "02NOV26"), Cmd("adjustments", "set", "D"), Cmd("bulletins", "03NOV26")},
       Cmd("adjustments", "remove-done")},
      {"adjustments marked", {Cmd("bulletins", "02NOV26")}, Do([](Session& s) {
         const std::string& folder = s.settings.paths.CurrentDataPath;
         AdjustRows rows = ReadAdjustList(s.files, folder);
         MarkAll(rows, 'Y');
         WriteAdjustList(s.files, folder, rows);
         return true;
       })},
      {"options of adjustments",
       {},
       Do([](Session& s) {
         SaveAdjustOptions(s.ini, s.settings, 4, true);
         return true;
       }),
       kPassedOver},

      // ---- Lists and classes
      {"codes added to a list", {}, Cmd("list", "A", "add", "NQZ", "VKQ")},
      {"list cleared", {}, Cmd("list", "A", "clear")},
      {"code moved between two lists", {}, Do(MoveBetweenLists)},
      {"lists checked",
       {Do([](Session& s) {
         // A name file in another order, as another program leaves it.
         const std::string& data = s.settings.paths.CurrentDataPath;
         std::vector<NameRec> names = ReadNames(s.files, data);
         std::reverse(names.begin(), names.end());
         WriteNames(s.files, NameFilePath(data), names);
         return true;
       })},
       Cmd("list", "check"),
       kFileByFile},
      {"names of lists", {}, Do([](Session& s) {
         UserListNames names = GetSubLists(s.user);
         for (std::string& name : names) name += " of mine";
         if (SaveSLNames(s.user, names)) return true;
         s.dialogs.Message("Unable to save data", "Sub-List Names");
         return false;
       })},
      {"results of a scan kept", {}, Do([](Session& s) {
         SaveScan(s.files, s.settings.paths.CurrentDataPath, {{"CJQ", 3}, {"CXQ", 1}});
         return true;
       })},
      {"industry classes", {}, Do([](Session& s) {
         const std::string& system = s.settings.paths.SystemPath;
         std::vector<IndustryClass> rows = ReadIndustryClasses(s.files, system);
         rows.push_back({"999", "Odds"});
         WriteIndustryClasses(s.files, system, rows);
         return true;
       })},

      // ---- Settings
      {"chart defaults",
       {},
       Do([](Session& s) {
         ChartDefaults typed = DefaultsFromSettings(s.settings);
         for (auto& [daily, twin] : typed.periods) daily = "7", twin = "8";
         typed.average1 = {"11", "12"};
         typed.FillIn = typed.RFAve = typed.CutVols = true;
         return SaveChartDefaults(s.ini, s.files, s.dialogs, typed, s.settings) ==
                DefaultsSaved::kAll;
       }),
       kPassedOver},
      {"colours", {}, Do([](Session& s) {
         s.colours[kBorder] = 0x123456;
         SaveColours(s.files, s.settings.paths.SystemPath, s.colours);
         return true;
       })},
      {"printer colours", {}, Do([](Session& s) {
         WritePrinterColours(s.files, s.settings.paths.SystemPath, {true, 1, 0});
         return true;
       })},
      {"folders",
       {},
       Do([](Session& s) {
         s.settings.paths.ChartBackupPath = "c:\\korawin\\kept\\";
         SavePaths(s.ini, s.settings);
         return true;
       }),
       kPassedOver},
      {"fonts",
       {},
       Do([](Session& s) {
         return SaveFonts(s.ini, s.settings, {"Serif", 12}, {"Sans", 7});
       }),
       kPassedOver},
      {"grid, spaces and lines of charts",
       {},
       Do([](Session& s) {
         return SaveGridSpacing(s.ini, s.settings, "10", true) &&
                SaveStopLoss(s.ini, s.settings, true, "5");
       }),
       kPassedOver | kFileByFile | kKeyByKey},
      {"page set up",
       {},
       Do([](Session& s) {
         PrintSetup setup = PrintSetupFrom(s.settings, s.printer);
         setup.PrintEnlarge = 1.25f;
         setup.PrintLeft = 7;
         SavePrintSetup(s.ini, s.settings, setup);
         return true;
       }),
       kPassedOver},
      {"data service",
       {},
       Do([](Session& s) {
         ServiceChoice choice;
         choice.index = 2;
         choice.DLPath = "c:\\korawin\\download\\in\\";
         return SaveServiceChoice(choice, s.ini, s.settings.download, s.dialogs);
       }),
       kPassedOver},

      // ---- Taking data in
      {"update of service 3",
       {Do([](Session& s) {
         WmPaths lines;
         for (size_t i = 0; i < lines.size(); ++i)
           lines[i] = "c:\\korawin\\m" + std::to_string(i) + "\\";
         lines[kWmChosen] = "0";
         WriteWmPaths(s.files, s.settings.paths.SystemPath, lines);
         return true;
       })},
       Cmd("--set", "Download.DataService=3", "update", "09SEP26.d"),
       kDayByDay,
       {{"drive_c/korawin/download/09SEP26.d", ""},
        {"drive_c/korawin/download/09SEP26.das",
         "SUM,20260909,1,1,1,1,1,0\nNEW,20260909,1,1,1,1,1,0\n"},
        {"drive_c/korawin/download/09SEP26.dix", "XAO,20260909,2,2,2,2,2,0\n"},
        {"drive_c/korawin/download/09SEP26.dov", "DJI,20260909,3,3,3,3,3,0\n"},
        {"drive_c/korawin/download/09SEP26.dsf", "SPI,20260909,5,5,5,5,5,0\n"},
        {"drive_c/korawin/download/09SEP26.dop", "BHPAA,20260909,6,6,6,6,6,10,P\n"},
        {"drive_c/korawin/m0/Names.dat", Bytes(std::vector<NameRec>{Named("SUM", "One")})},
        {"drive_c/korawin/m0/SUM.WDT", Days(1, 20, 4)},
        {"drive_c/korawin/m1/Names.dat", ""},
        {"drive_c/korawin/m2/Names.dat", ""},
        {"drive_c/korawin/m3/Names.dat", ""},
        {"drive_c/korawin/m4/Names.dat", ""},
        {"drive_c/korawin/m6/Names.dat", ""}}},
      {"details of securities taken in",
       {},
       Do([](Session& s) {
         UpdateSecurityDetails(s.files, s.settings.download);
         return !s.files.CheckFile(s.settings.download.ServiceIn + "SecurityDetails.Asx.Stk");
       }),
       kFileByFile | kQuiet,
       {{"drive_c/korawin/download/in/SecurityDetails.Asx.Stk",
         "Code|ShortDescription|PARVALUE\r\nCJQ|Big Hole|1.00\r\nORE|Ore|3\r\n"}}},
      {"update list",
       {Do([](Session& s) {
         s.files.WriteAll(UpdateListFile(s.settings.paths.SystemPath), "OLD,1,Old\r\n");
         return true;
       })},
       Do([](Session& s) {
         UpdateChoice choice = UpdateChoice::kListed;
         const std::vector<UpdateRow> rows{{"CJQ", 3, "Some"}, {"CXQ", 1, "Other"}};
         return SaveUpdateList(s.files, s.settings.paths.SystemPath, rows, choice, s.ini,
                               s.settings.download, s.dialogs);
       }),
       kFileByFile | kPassedOver},
      {"folders of the whole market",
       {},
       Do([](Session& s) {
         const std::array<std::string, 6> folders{"c:\\a\\", "c:\\b\\", "c:\\c\\",
                                                  "c:\\d\\", "c:\\e\\", "c:\\f\\"};
         return SaveWmPaths(s.files, s.settings.paths.SystemPath, folders, 2, s.dialogs);
       }),
       kFileByFile},
      {"download removed", {}, Do([](Session& s) {
         DownloadEntries entries;
         return BuildDownloadList(s.files, s.settings.download, s.dialogs, entries) ==
                    ListResult::kFilled &&
                RemoveDownload(s.files, s.settings.download.DLPath, entries[0], s.dialogs, entries);
       })},
      {"downloads renamed",
       {},
       Do([](Session& s) {
         RenameInternetFiles(s.files, s.settings.download.DLPath, 1, s.dialogs);
         return !s.files.CheckFile(s.settings.download.DLPath + "261107.D");
       }),
       kFileByFile,
       {{"drive_c/korawin/download/261106.D", "CJQ,20261106,1,1,1,1,1,0\r\n"},
        {"drive_c/korawin/download/261107.D", "CJQ,20261107,1,1,1,1,1,0\r\n"}}},

      // ---- Charts
      {"chart saved",
       {},
       Do([](Session& s) { return SaveChart(s, "c:\\korawin\\chtsave\\a.cht"); }),
       kScript},
      {"chart saved over another",
       {},
       Do([](Session& s) { return SaveChart(s, "c:\\korawin\\chtsave\\a.cht"); }),
       kScript,
       {{"drive_c/korawin/chtsave/a.cht", "an older chart\r\n"}}},
      {"chart printed to a PDF",
       {Do([](Session& s) { return SaveChart(s, "c:\\korawin\\chtsave\\a.cht"); })},
       Do(PrintSaved)},
      {"trendlines compacted",
       {Cmd("lines", "CJQ", "add", "--at", "100,100,300,200"),
        Cmd("lines", "CJQ", "add", "--at", "120,100,300,220"), Cmd("lines", "CJQ", "delete", "1")},
       Cmd("lines", "CJQ", "compact")},
      {"trendlines cleared",
       {Cmd("lines", "CJQ", "add", "--at", "100,100,300,200")},
       Cmd("lines", "CJQ", "clear")},
      {"texts cleared",
       {Cmd("notes", "CJQ", "add", "--at", "300,200", "a note")},
       Cmd("notes", "CJQ", "clear")},
      {"text list saved",
       {Cmd("notes", "CJQ", "add", "--at", "300,200", "a note"),
        Cmd("notes", "CJQ", "add", "--at", "320,200", "another")},
       Do([](Session& s) {
         const std::string& misc = s.settings.paths.ChartMiscPath;
         auto notes = OpenNotes(s.files, misc, "CJQ", s.dialogs);
         if (!notes) return false;
         notes->lines.erase(notes->lines.begin());
         return SaveNotes(s.files, misc, "CJQ", *notes, s.dialogs);
       })},
      {"a history exported over texts",
       {Cmd("notes", "CJQ", "add", "--at", "300,200", "a note")},
       Cmd("--answer", "yes", "export", "history", "CJQ", "--columns")},

      // ---- Checks and copies
      {"totals checked",
       {Cmd("edit", "ADVD", "set", "3", "High", "77")},
       Cmd("check", "totals", "ADVD", "--base", "100")},
      {"listed securities removed", {}, Do([](Session& s) {
         return RemoveListed(s.files, s.settings.paths.CurrentDataPath, {"CJQ", "CXQ", "GONE"},
                             s.dialogs);
       })},
      {"names without files removed",
       {WithNames({Named("NOFILE", "One"), Named("NONE", "Two")})},
       Cmd("--answer", "yes", "check", "names")},
      {"selected file copied",
       {},
       Do(
           [](Session& s) {
             NoProgress progress;
             return CopySelectedFile(s.files, s.settings.paths.CurrentDataPath,
                                     s.settings.paths.ChartBackupPath, "CJQ.WDT", progress,
                                     s.dialogs);
           }),
       kFileByFile},
      {"latest record of a date removed",
       {},
       Cmd("remove-date", "{last}", "--latest"),
       kFileByFile},
      Move("a file moved to one that begins later", 15, 25),
      Move("a file moved to one that begins earlier", 5, 12),
      Move("a file moved to one that it covers", 12, 15),
      Move("a file moved to one that covers it", 5, 25),
      {"two codes combined of which one is longer",
       {Cmd("enter", "FVQ", "--date", "5/11/26", "--open", "2.4", "--high", "2.6", "--low", "2.3",
            "--close", "2.5")},
       Cmd("change-code", "FVQ", "CJQ")},

      // ---- Companies
      {"snapshot row removed",
       {Cmd("snapshot", "2", "add", "CJQ")},
       Cmd("snapshot", "2", "remove", "CJQ")},
      {"companies to the list of results", {}, Do([](Session& s) {
         const CompanyStore store(s.files, s.settings.download);
         const std::string& data = s.settings.paths.CurrentDataPath;
         WriteCompanyList(s.files, data, LoadCompanies(store, s.files, data));
         return true;
       })},
  };
  return operations;
}

}  // namespace kora::test
