#include <algorithm>
#include <cmath>
#include <cstring>

#include "adjust/adjust_date.h"
#include "adjust/adjustment.h"
#include "base/dates.h"
#include "base/file_set.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "chartwindow/tools/saved_marks.h"
#include "fuzz/readers.h"
#include "fuzz/small_home.h"
#include "lists/chart_list.h"
#include "maintenance/data_checks.h"
#include "maintenance/data_rows.h"
#include "maintenance/note_list.h"
#include "maintenance/text_exports.h"
#include "names/name_editor.h"
#include "platform/settings_file.h"
#include "store/chart_bars.h"
#include "store/chart_notes.h"
#include "store/definition_file.h"
#include "store/industry_classes.h"
#include "store/market_folders.h"
#include "store/name_file.h"
#include "store/price_edit.h"
#include "store/trendline_file.h"
#include "store/volume_unit.h"
#include "tests/support/error_of.h"
#include "update/download_settings.h"
#include "update/staged_folder.h"

namespace kora::test {
namespace {

bool IsOneOf(int error, std::initializer_list<int> errors) {
  return error == 0 || std::find(errors.begin(), errors.end(), error) != errors.end();
}

// What every file of fixed records is.
template <typename T>
std::vector<T> ReadRecords(const Files& files, const std::string& path, std::string_view bytes) {
  const RecordFile<T> file(files, path);
  Promise(size_t(file.count()) == bytes.size() / sizeof(T), "the count truncates");
  const std::vector<T> all = file.ReadAll();
  Promise(BytesOf(all) == bytes.substr(0, all.size() * sizeof(T)), "records are the file's bytes");
  for (const int n : {0, -1, file.count() + 1})
    Promise(ErrorOf([&] { file.Read(n); }) == kBadRecordNumber, "error 63 outside the file");
  return all;
}

template <typename T>
std::vector<std::string> Sorted(const std::vector<T>& records) {
  std::vector<std::string> out;
  for (const T& rec : records) out.push_back(BytesOf(rec));
  std::sort(out.begin(), out.end());
  return out;
}

void CheckSorts(std::span<const NameRec> names) {
  for (const NameSort mode : {NameSort::kCategory, NameSort::kCode, NameSort::kIndClass}) {
    const std::vector<NameRec> sorted = SortedNames(names, mode);
    std::vector<NameRec> living;
    for (const NameRec& rec : names)
      if (rec.NameStatus != 1) living.push_back(rec);
    Promise(Sorted(sorted) == Sorted(living), "a sort loses and adds no name");
    for (size_t i = 1; i < sorted.size(); ++i)
      Promise(SortKey(sorted[i - 1], mode) <= SortKey(sorted[i], mode), "a sort sorts");
  }
}

void CheckNameCells(const std::vector<NameRec>& names) {
  for (const NameRec& rec : names) {
    for (int i = 0; i < kNameColumns; ++i) {
      NameRec row = rec;
      const std::string cell = NameCell(row, NameColumn(i));
      Promise(!PutNameCell(row, NameColumn(i), cell) && BytesOf(row) == BytesOf(rec),
              "the text of a cell leaves its record");
      for (const NameRec& other : names) {
        const std::string typed = NameCell(other, NameColumn(i));
        NameRec changed = rec;
        if (PutNameCell(changed, NameColumn(i), typed))
          Promise(BytesOf(changed) == BytesOf(rec), "a refused text changes nothing");
      }
    }
  }
}

}  // namespace

void ReadNamesBody(std::string_view bytes) {
  SmallHome home;
  home.Put("data/Names.dat", bytes);
  home.Put("data/ORE.WDT", BytesOf(NewPriceRec("19980914")));
  const auto names = ReadRecords<NameRec>(home.files, NameFilePath(home.data), bytes);
  Promise(BytesOf(ReadNames(home.files, home.data)) == BytesOf(names), "names are the records");
  CheckSorts(names);
  if (names.size() <= 8) CheckNameCells(names);

  CurrentName current;
  for (const NameRec& rec : names) {
    current.CurrentCode = rec.Code.raw();
    current.PriceFileName.clear();
    const bool found = LocateCurrentCode(home.files, home.data, home.dialogs, current);
    const std::string& file = current.PriceFileName;
    Promise(found == !file.empty(), "who is found has a file");
    Promise(file.find_first_of(std::string_view("/\\:\0", 4)) == std::string::npos &&
                (file.empty() || file[0] != '.'),
            "a code names a file of the folder");
    NameRec byCode;
    FindNameByCode(home.files, home.data, rec.Code.raw(), byCode);
  }
  {
    StagedFolder folder(home.files, home.data);
    for (size_t i = 0; i < folder.names().size(); ++i)
      Promise(folder.PlaceOf(std::string(Trim(folder.names()[i].Code.trimmed()))) <= i,
              "the first with a code is found");
  }
  CheckNameData(home.files, home.data, home.progress, home.dialogs);

  home.Put("data/Names.dat", bytes);
  SettingsFile ini(home.files, "C:\\WINDOWS\\Kora.ini");
  NameEditor editor(
      {home.files, home.data, home.system, home.dialogs, ini, home.settings.download});
  editor.Load();
  Promise(BytesOf(editor.rows()) == BytesOf(names), "a row a record");
  editor.FillClasses();
  editor.TitleCase();
  editor.RemoveExpired();
  editor.Dupnames();
  editor.CleanOptional();
  editor.Sort(NameSort::kIndClass);
  editor.DeleteWarrants();
  const auto end = editor.SaveNames();
  if (end.saved) {
    const auto kept = ReadNames(home.files, home.data);
    Promise(BytesOf(kept) == BytesOf(editor.rows()), "what was saved reads back");
    for (const NameRec& rec : kept)
      Promise(rec.NameStatus == 0 && !rec.Code.trimmed().empty(), "a saved name has a code");
    editor.SaveNames();
    Promise(BytesOf(ReadNames(home.files, home.data)) == BytesOf(kept),
            "a second save is the first");
  }
  SortNameFile(home.files, home.data, NameSort::kCode);
}

void ReadPricesBody(std::string_view bytes) {
  SmallHome home;
  home.PutMarket();
  home.Put("data/ORE.WDT", bytes);
  const std::string path = home.data + "ORE.WDT";
  const auto records = ReadRecords<PriceRec>(home.files, path, bytes);
  const auto count = std::int32_t(records.size());

  const PriceFile file(home.files, path);
  for (const Period period : {Period::kDaily, Period::kWeekly, Period::kMonthly}) {
    for (std::int16_t type = kCloseVolume; type <= kIndex; ++type) {
      ChartBars bars;
      bars.FirstDataRec = 1;
      bars.LastDataRec = std::int16_t(std::min(count, 32767));
      const int error = ErrorOf([&] { LoadChartBars(file, period, true, type, bars); });
      Promise(IsOneOf(error, {kBadCall, kOverflow, kBadRecordNumber}), "errors of a load");
      if (error == 0)
        Promise(bars.BarCount >= 0 && size_t(bars.BarCount) < bars.bars.size(), "bars are there");
    }
  }
  ChartBars daily;
  ErrorOf([&] { LoadDailyBars(records, 1, kShare, daily); });

  for (const PriceRec& rec : records) {
    ParseFileDate(rec.RecDate.raw());
    DateToDisplay(rec.RecDate.raw());
  }
  const std::string wanted =
      records.empty() ? "19980914" : std::string(records.back().RecDate.raw());
  const AdjustmentDates dates = FindAdjustmentDate(records, wanted);
  Promise(dates.empty() || dates.Selected < dates.Lines.size(), "the line chosen is one");
  OtherDateText(records, dates, wanted, "14/9/98");

  std::vector<PriceRec> changed = records;
  const int adjusted = ErrorOf([&] {
    AdjustRecords(changed, std::int16_t(std::min(count, 32767)), {0.5f, "bi1:1"});
  });
  Promise(IsOneOf(adjusted, {kOverflow, kBadRecordNumber}), "errors of an adjustment");
  Promise(IsOneOf(ErrorOf([&] { RemoveLatestAdjustment(changed); }),
                  {kIndexOutOfRange, kOverflow, kDivisionByZero}),
          "errors of a removal");

  {
    PriceEdit edit(home.files, path);
    FileSet set(home.files);
    edit.KeepOld(set);
    edit.Save(set);
    set.Commit();
    Promise(home.Get("data/ORE.WDT") == BytesOf(records), "a saved file has its records");
    Promise(home.Get("data/ORE.OLD") == bytes, "the old file is kept");
  }
  DataRows rows(home.files, path);
  if (rows.ShowData("ORE", home.progress, home.dialogs)) {
    for (int row = 0; row < std::min(rows.RowCount(), 20); ++row) {
      for (int column = 0; column < kDataColumns; ++column) {
        const std::string text = rows.Text(row, column);
        rows.Shade(row, column);
        rows.SetText(row, column, text);
        if (column != kDataRec && !rows.SetText(0, column, text))
          Promise(rows.Text(0, column).size() <= 400, "a cell has an end");
      }
    }
    rows.Scale({0, rows.RowCount() - 1}, {true, true, true, true, true}, ScaleBy::kTimes10);
    rows.SortByDate();
    const std::string wantedBytes = BytesOf(rows.records());
    if (rows.SaveData(home.progress, home.dialogs))
      Promise(home.Get("data/ORE.WDT") == wantedBytes, "the grid's rows are the file's");
  }
  home.Put("data/ORE.WDT", bytes);
  const auto before = home.io.Store();
  ExportHistory(home.files, home.data, home.settings.paths.ChartMiscPath, "ORE",
                ExportForm::kCommas, home.dialogs);
  ExportCloses(home.files, home.data, home.settings.paths.ChartMiscPath, std::nullopt,
               ExportForm::kColumns, home.progress, home.dialogs);
  home.OnlyChanged(before, {"chtmisc/*.txt"});
  DataCheckPlan plan;
  plan.types = {false, true, true, false, true, true};
  CheckDataFiles(home.files, home.data, plan, home.progress, home.dialogs);
  CheckTotals(home.files, home.data, "ORE", "100", home.dialogs);
  home.OnlyChanged(before, {"chtmisc/*.txt", "data/*.WDT", "data/SubListZ.Dat"});
  for (const auto& [name, stored] : home.io.Store())
    if (name.ends_with(".WDT"))
      Promise(stored.size() % sizeof(PriceRec) == 0 || stored == bytes, "records are whole");
}

void ReadListsBody(std::string_view bytes) {
  SmallHome home;
  home.PutMarket();
  home.Put("data/SubListA.Dat", bytes);
  const auto before = home.io.Store();
  const auto records =
      ReadRecords<ListRec>(home.files, ListFilePath(home.data, kFirstChartList), bytes);
  Promise(BytesOf(ReadList(home.files, home.data, kFirstChartList)) == BytesOf(records),
          "a list is its records");
  const ListCodes codes = CodesOf(records);
  for (const std::string& code : codes)
    Promise(!code.empty() && code.size() <= 6, "a code of a list fits its field");
  CheckAllLists(home.files, home.data);
  const auto checked = ReadList(home.files, home.data, kFirstChartList);
  const auto names = ReadNames(home.files, home.data);
  for (const ListRec& rec : checked) {
    const std::int16_t number = rec.ListRecNo;
    Promise(number >= 1 && size_t(number) <= names.size() &&
                names[size_t(number) - 1].Code == rec.ListCode,
            "a checked list points at its codes");
  }
  const ListCodes dropped = SaveSubList(home.files, home.data, kFirstChartList, codes);
  Promise(BytesOf(ReadList(home.files, home.data, kFirstChartList)) == BytesOf(checked),
          "a save is a check");
  Promise(dropped.size() + checked.size() == codes.size(), "codes are kept or dropped");
  ListSide a{kFirstChartList, codes, false}, b{kFirstChartList + 1, {}, false};
  std::vector<size_t> places;
  for (size_t i = 0; i < codes.size() + 2; i += 2) places.push_back(i);
  MoveItems(a, b, places);
  Promise(a.Codes.size() + places.size() >= codes.size(), "no more than was chosen moves");
  const ListSide sides[] = {a, b};
  SaveSides(home.files, home.data, sides);
  home.OnlyChanged(before, {"data/SubListA.Dat", "data/SubListB.Dat"});
}

void ReadTrendlinesBody(std::string_view bytes) {
  SmallHome home;
  home.Put("chtmisc/ORE.TND", bytes);
  const auto before = home.io.Store();
  const std::string path = TrendlinePath(home.settings.paths.ChartMiscPath, "ORE");
  const auto lines = ReadTrendlines(home.files, path);
  Promise(BytesOf(lines) == bytes.substr(0, lines.size() * sizeof(TrendlineRec)) &&
              lines.size() == bytes.size() / sizeof(TrendlineRec),
          "records are the file's bytes");
  TrendlineRec line = lines.empty() ? EmptyTrendline() : lines.back();
  line.TLSpacing = 3;
  line.TLPeriod.set("A");
  const std::int32_t slot = SaveTrendline(home.files, path, line);
  auto saved = ReadTrendlines(home.files, path);
  Promise(slot >= 1 && size_t(slot) <= saved.size() &&
              BytesOf(saved[size_t(slot) - 1]) == BytesOf(line),
          "a saved line reads back");
  Promise(saved.size() == std::max(lines.size(), size_t(slot)), "others stay");
  for (size_t i = 0; i < lines.size(); ++i)
    if (i + 1 != size_t(slot)) Promise(BytesOf(saved[i]) == BytesOf(lines[i]), "others stay");
  DeleteTrendline(home.files, path, slot);
  Promise(ReadTrendlines(home.files, path)[size_t(slot) - 1].Empty(), "a deleted line is gone");
  Promise(ErrorOf([&] { DeleteTrendline(home.files, path, 0); }) == kBadRecordNumber, "error 63");
  CompactTrendlines(home.files, path);
  const std::string compact = home.Get("chtmisc/ORE.TND");
  CompactTrendlines(home.files, path);
  Promise(home.Get("chtmisc/ORE.TND") == compact, "compact stays compact");
  ReadSavedMarks(home.files, home.settings.paths.ChartMiscPath, "ORE");
  home.OnlyChanged(before, {"chtmisc/ORE.TND"});
}

void ReadTextsBody(std::string_view bytes) {
  SmallHome home;
  home.Put("chtmisc/ORE.Txt", bytes);
  const std::string folder = home.settings.paths.ChartMiscPath;
  const std::string path = ChartNotesPath(folder, "ORE");
  auto notes = ReadChartNotes(home.files, path);
  home.Put("chtmisc/ORE2.Txt", ChartNotesText(notes));
  const auto again = ReadChartNotes(home.files, ChartNotesPath(folder, "ORE2"));
  Promise(again.size() == notes.size() && ChartNotesText(again) == ChartNotesText(notes),
          "notes read back");
  AdjustNotes(notes, "19980914", 0.5f, 255);

  auto lines = ReadNoteLines(home.files, path);
  for (const NoteLine& line : lines) {
    if (!line.readable) continue;
    Promise(std::isfinite(line.Price), "a price is a number");
    const NoteLine made = MakeNoteLine(line.Date, line.Price, line.Text, line.Colour);
    Promise(!made.readable || (made.Colour == line.Colour && made.Date == line.Date),
            "a made text says the same");
  }
  const auto before = home.io.Store();
  WriteNoteLines(home.files, path, lines);
  const auto kept = ReadNoteLines(home.files, path);
  Promise(kept.size() == lines.size(), "lines stay");
  for (size_t i = 0; i < kept.size(); ++i)
    Promise(kept[i].line == lines[i].line, "lines stay byte for byte");
  const NoteLine added = MakeNoteLine("19980914", 1.5, "Text", 255);
  Promise(added.readable, "a made text is one");
  AppendNoteLine(home.files, path, added);
  const auto more = ReadNoteLines(home.files, path);
  Promise(more.size() == lines.size() + 1 && more.back().line == added.line, "a text is added");
  if (auto list = OpenNotes(home.files, folder, "ORE", home.dialogs)) {
    for (const NoteLine& line : list->lines) NoteListText(line);
    if (!list->lines.empty()) list->lines.pop_back();
    Promise(SaveNotes(home.files, folder, "ORE", *list, home.dialogs), "a list is saved");
  }
  home.Put("chtmisc/ORE.Txt", bytes);
  AppendNoteLine(home.files, path, added);
  Promise(home.Get("chtmisc/ORE.Txt").rfind(bytes, 0) == 0, "what was there stays byte for byte");
  ReadSavedMarks(home.files, folder, "ORE");
  home.OnlyChanged(before, {"chtmisc/ORE.Txt"});
}

void ReadClassesBody(std::string_view bytes) {
  SmallHome home;
  home.Put("IndClass.dat", bytes);
  auto rows = ReadIndustryClasses(home.files, home.system);
  for (IndustryClass& row : rows) {
    Promise(!row.id.empty(), "a class has an id");
    IndustryClass typed = row;
    if (!PutClassId(typed, row.id)) Promise(typed.id.size() == 3, "an id has three digits");
    PutClassDescription(typed, row.description);
    MatchesIndClass(row.id, row.description);
    MatchesIndClass(row.description, row.id);
  }
  SortIC(rows);
  WriteIndustryClasses(home.files, home.system, rows);
  const auto again = ReadIndustryClasses(home.files, home.system);
  Promise(again.size() == rows.size(), "classes read back");
  WriteIndustryClasses(home.files, home.system, again);
  const std::string once = home.Get("IndClass.dat");
  WriteIndustryClasses(home.files, home.system, ReadIndustryClasses(home.files, home.system));
  Promise(home.Get("IndClass.dat") == once, "classes read back as they were written");
}

void ReadTablesBody(std::string_view bytes) {
  SmallHome home;
  home.Put("WMPaths.lst", bytes);
  home.Put("Update.Lst", bytes);
  home.Put("BdaPaths.Dat", bytes);
  home.Put("service/WMDef.Lst", bytes);
  home.Put("service/Mainfile.asx", bytes);
  const WmPaths lines = ReadWmPaths(home.files, home.system);
  WmPathsComplete(lines);
  WmChosenFolder(lines);
  WriteWmPaths(home.files, home.system, lines);
  const WmPaths again = ReadWmPaths(home.files, home.system);
  for (size_t i = 0; i < lines.size(); ++i)
    Promise(ToAnsi(again[i]) == Trim(ToAnsi(lines[i])), "folders read back");

  auto rows = ReadUpdateList(home.files, home.system);
  for (const UpdateRow& row : rows)
    Promise(!row.code.empty() && row.category >= 0 && row.category <= 99, "a row has a code");
  SettingsFile ini(home.files, "C:\\WINDOWS\\Kora.ini");
  UpdateChoice choice = UpdateChoice::kListed;
  if (SaveUpdateList(home.files, home.system, rows, choice, ini, home.settings.download,
                     home.dialogs)) {
    const auto kept = ReadUpdateList(home.files, home.system);
    SaveUpdateList(home.files, home.system, kept, choice, ini, home.settings.download,
                   home.dialogs);
    const auto twice = ReadUpdateList(home.files, home.system);
    Promise(twice.size() == kept.size(), "rows read back");
    for (size_t i = 0; i < kept.size(); ++i)
      Promise(kept[i].code == twice[i].code && kept[i].category == twice[i].category &&
                  kept[i].name == twice[i].name,
              "rows read back as they were written");
  }
  const auto [general, index] =
      ReadMarketVolumeFactors(home.files, home.settings.download.ServiceSystem);
  Promise(general >= 0 && general <= 1e4 && index >= 0 && index <= 1e4, "factors are powers");
  for (const std::string_view code : {"ORE", "", "BHP"})
    if (const auto one =
            FindDefinition(home.files, home.settings.download.ServiceSystem + "Mainfile.asx", code))
      for (const auto power : {one->pricePower, one->volumePower})
        if (power) PowerOfTen(*power);
  home.settings.download.DataService = 1;
  VolumeUnitText(home.files, home.settings, "ORE");
  home.settings.download.DataService = 3;
  VolumeUnitText(home.files, home.settings, "ORE");
  for (const int service : {1, 2, 4, 5})
    ProposedDownloadFolder(home.files, std::int16_t(service), home.system);
}

}  // namespace kora::test
