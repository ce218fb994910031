#include <algorithm>
#include <cmath>

#include "adjust/adjust_list.h"
#include "adjust/bulletins.h"
#include "adjust/make_adjustments.h"
#include "base/dates.h"
#include "base/host_file_set.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "companies/snapshot.h"
#include "companies/stock_details.h"
#include "fuzz/readers.h"
#include "fuzz/small_home.h"
#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/error_of.h"
#include "update/download_update.h"
#include "update/import_history.h"
#include "update/master_list.h"
#include "update/security_details.h"
#include "update/update_journal.h"

namespace kora::test {
namespace {

const std::string kEntry = "download/15SEP98.d";

// Every file of records is whole, but for one that was torn before.
void CheckRecords(const SmallHome& home) {
  for (const auto& [path, bytes] : home.io.Store()) {
    if (EndsNoCase(path, ".WDT"))
      Promise(bytes.size() % sizeof(PriceRec) == 0, "price records are whole");
    if (EndsNoCase(path, "Names.dat"))
      Promise(bytes.size() % sizeof(NameRec) == 0, "name records are whole");
  }
}

struct DownloadRun {
  SmallHome home;
  UpdateEnd end = UpdateEnd::kNotBegun;
  std::map<std::string, std::string> before;
};

// A day taken in, with as many bytes held as told.
void TakeDay(std::string_view bytes, size_t mostHeld, DownloadRun& run) {
  Input input(bytes);
  const unsigned choice = input.Byte();
  SmallHome& home = run.home;
  home.PutMarket();
  DownloadSettings& download = home.settings.download;
  download.DataService = std::int16_t(choice % 5 + 1);
  const unsigned more = input.Byte();
  download.UpdateAll = (more & 1) == 0;
  download.NoWarrants = (more & 2) != 0;
  download.VolumeDivisor = more & 4 ? 100 : 1;
  if (more & 8) home.dialogs.answers.assign(8, Answer::kCancel);
  home.Put("Update.Lst", "ORE,1,Ore\r\nNEW,1,New\r\n");
  home.Put(kEntry, input.Rest());
  if (download.DataService == 3) {
    home.Put("WMPaths.lst",
             "c:\\korawin\\data\\\r\nc:\\korawin\\idx\\\r\nc:\\korawin\\sfe\\\r\n"
             "c:\\korawin\\ovs\\\r\nc:\\korawin\\opt\\\r\n0\r\nc:\\korawin\\sum\\\r\n");
    for (const char* folder : {"idx/", "sfe/", "ovs/", "opt/", "sum/"})
      home.Put(std::string(folder) + "Names.dat", "");
    for (const char* extension : {".dsu", ".dix", ".dop"})
      home.Put("download/15SEP98" + std::string(extension), input.Rest());
  }
  run.before = home.io.Store();
  CurrentName current;
  const FixedClock clock;
  const UpdateRun update{home.files, home.settings, current, home.dialogs,
                         clock,      home.progress, {},      mostHeld};
  DownloadEntries entries{"15SEP98.d"};
  run.end = UpdateOneDay(update, entries, 0);
  Promise(entries.empty() == IsTaken(run.end), "what was taken leaves the list");
}

ImportOptions OptionsOf(unsigned choice) {
  ImportOptions options;
  options.Dates = ImportDates(choice & 3);
  options.SkipBad = (choice & 4) != 0;
  if (choice & 8) options.Code = "ORE";
  if (choice & 16) options.Type = std::int16_t((choice >> 5) % 5 + 1);
  return options;
}

}  // namespace

// Two bytes of choices, and the file.
void ReadDownloadBody(std::string_view bytes) {
  DownloadRun whole, pieces;
  TakeDay(bytes, 32u << 20, whole);
  TakeDay(bytes, 1, pieces);
  CheckRecords(whole.home);
  whole.home.OnlyChanged(whole.before,
                         {"data/*.WDT", "data/Names.dat", "idx/*.WDT", "idx/Names.dat", "sum/*.WDT",
                          "opt/*.WDT", "opt/Names.dat", "download/*"});
  Promise(whole.end == pieces.end && whole.home.io.Store() == pieces.home.io.Store(),
          "a day held in pieces is the day held whole");
  if (whole.end != UpdateEnd::kAbandoned || whole.home.settings.download.DataService >= 3) return;
  Promise(whole.home.io.Store() == whole.before, "a file that was refused changes nothing");
}

// The plain text of a list, and behind marks a list, its index and its table.
void ReadMasterBody(std::string_view bytes) {
  Input input(bytes);
  const std::string_view plain = input.Part(), list = input.Part(), index = input.Part();
  SmallHome home;
  if (!input.Rest().empty()) home.Put("KoraName.Tab", input.Rest());
  home.Put("KoraName.Mas", list);
  home.Put("KoraName.idx", index);
  std::vector<EditorRow> rows(3);
  rows[0].code = "ORE";
  rows[1].code = "zap";
  rows[1].name = "Name";
  const auto look = [&](const MasterList& master) {
    for (size_t i = 0; i < master.Records.size(); ++i) {
      const MasterEntry entry = master.Entry(std::int32_t(i + 1));
      FindMaster(master, entry.code, master.StartOf(entry.code));
      FindMaster(master, entry.code, LookUpStart(std::int32_t(i)));
    }
  };
  ErrorOf([&] { look(ReadMasterList(home.files, home.system)); });
  UpdateFromMaster(home.files, home.system, rows, {true, false, true, false, false}, home.dialogs);

  home.io.Put("home/list.csv", plain);
  const auto before = home.io.Store();
  const auto count = MakeMasterList(home.files, home.system, "home/list.csv", home.dialogs);
  if (!count) {
    Promise(!home.dialogs.said.empty(), "a list that is not made is told");
    Promise(home.io.Store() == before, "a list that is refused changes nothing");
    return;
  }
  home.OnlyChanged(before, {"KoraName.Mas", "KoraName.idx"});
  const MasterList master = ReadMasterList(home.files, home.system);
  Promise(master.Records.size() == size_t(*count), "a code a record");
  look(master);
  for (size_t i = 0; i < master.Records.size(); ++i) {
    const MasterEntry entry = master.Entry(std::int32_t(i + 1));
    const std::int32_t start = master.StartOf(entry.code);
    if (start == 0) continue;
    const MasterEntry found = FindMaster(master, entry.code, start);
    Promise(found.code == entry.code && found.name == entry.name, "a code is found");
    Promise(entry.name.find_first_of("\r\n") == std::string::npos, "a name is one line");
  }
  Promise(UpdateFromMaster(home.files, home.system, rows, {}, home.dialogs), "a list can be used");
}

// The service's file, and behind marks labels, records and index of a store.
void ReadDetailsBody(std::string_view bytes) {
  Input input(bytes);
  const std::string_view service = input.Part(), labels = input.Part(), index = input.Part();
  SmallHome home;
  const DownloadSettings& download = home.settings.download;
  const auto look = [&] {
    const CompanyStore store(home.files, download);
    Promise(store.codes().size() <= 200'000, "codes of the index");
    size_t looked = 0;
    for (const std::string& code : store.codes()) {
      if (++looked > 50) break;
      const std::int32_t first = store.Find(ToAnsi(code));
      if (first != 0) Promise(store.CountFrom(first) >= 1, "a code has a record");
      Promise(store.Fields(first).size() == store.labels().size(), "a field a label");
      GetStockDetails(store, ToAnsi(code));
      const Dividends dividends = DividendsOf(store, ToAnsi(code));
      Promise(!std::isnan(dividends.interim) && !std::isnan(dividends.final), "numbers");
    }
    store.Fields(0);
    store.CountFrom(0);
  };
  home.Put("service/STKHeader.txt", labels);
  home.Put("service/SecurityDetails.Stx", input.Rest());
  home.Put("service/Sdix1.inx", index);
  ErrorOf(look);

  home.Put("in/SecurityDetails.Asx.Stk", service);
  const auto before = home.io.Store();
  UpdateSecurityDetails(home.files, download);
  home.OnlyChanged(before, {"service/STKHeader.txt", "service/SecurityDetails.Stx",
                            "service/Sdix1.inx", "in/SecurityDetails.Asx.*"});
  if (home.io.Store() == before) return;
  Promise(home.Get("service/SecurityDetails.Stx").size() % sizeof(DetailsRec) == 0,
          "records are whole");
  look();
}

// A byte of choices, and the file.
void ReadImportBody(std::string_view bytes) {
  Input input(bytes);
  const ImportOptions options = OptionsOf(input.Byte());
  SmallHome home;
  home.PutMarket();
  home.Put("data/SubListA.Dat", std::string("\3\0ORE   ", 8));
  home.io.Put("home/BHP.csv", input.Rest());
  const auto before = home.io.Store();
  const std::string path[] = {"home/BHP.csv"};
  ImportCounts counts;
  const bool all = ImportHistory(home.files, home.data, path, options, home.dialogs, counts);
  CheckRecords(home);
  home.OnlyChanged(before, {"data/*.WDT", "data/Names.dat", "data/SubListA.Dat"});
  Promise(all || !home.dialogs.said.empty(), "what was not taken is told");
  if (counts.Codes.empty()) Promise(home.io.Store() == before, "a refused file changes nothing");
  if (all)
    Promise((options.SkipBad || counts.Refused == 0) && counts.Added + counts.Replaced > 0,
            "rows were taken");
  for (const std::string& code : counts.Codes) {
    NameRec rec;
    FindNameByCode(home.files, home.data, PadRight(code, 6), rec);
    Promise(rec.Code.trimmed() == code, "a code has its name");
    std::string last;
    for (const PriceRec& day : PriceFile(home.files, home.data + code + ".WDT").ReadAll()) {
      const std::string date(day.RecDate.raw());
      Promise(ParseFileDate(date).has_value() && last < date, "days are in order");
      Promise(std::isfinite(float(day.Close)), "a close is a number");
      last = date;
    }
  }
  const auto once = home.io.Store();
  ImportCounts again;
  ImportHistory(home.files, home.data, path, options, home.dialogs, again);
  Promise(again.Added == 0 && home.io.Store() == once, "a second import is the first");
}

// A byte of choices, and the bulletin.
void ReadBulletinsBody(std::string_view bytes) {
  Input input(bytes);
  const unsigned choice = input.Byte();
  BulletinRules rules{"15SEP98", (choice & 1) != 0, (choice & 2) != 0, (choice & 4) != 0,
                      std::int16_t(choice >> 3 & 7)};
  SmallHome home;
  home.PutMarket();
  home.settings.download.NoWarrants = rules.NoWarrants;
  home.settings.NoShortNames = rules.NoShortNames;
  home.settings.AdjDivs = rules.Divs;
  home.Put("in/15SEP98.Asx.Btn", input.Rest());
  home.Put("in/15SEP98.Btn", input.Rest());
  home.Put("data/Adjust.Lst", "BI,ORE,15SEP98,,N,15SEP98,1,4");
  const auto before = home.io.Store();
  int expected = 0;
  LineReader lines(input.Rest());
  std::string_view line;
  while (lines.Next(line)) {
    if (Trim(line).empty()) continue;
    const auto merged = MergeBulletinLine(line, rules);
    if (!merged) continue;
    ++expected;
    Promise(merged->find('\n') == std::string::npos, "a line stays one");
  }
  int added = 0;
  MergeBulletins(home.files, home.settings, home.data, "15SEP98", home.progress, added);
  home.OnlyChanged(before, {"data/Adjust.Lst", "out/*.Btx"});
  if (!rules.OptionsFolderOK && input.Rest().rfind("\xEF\xBB\xBF", 0) != 0)
    Promise(added == 2 * expected, "each line that is taken is added");
  const auto once = home.io.Store();
  Promise(CheckBulletins(home.files, home.settings, home.data, "15SEP98", home.progress) == 0 &&
              home.io.Store() == once,
          "a bulletin is taken once");
}

// A byte of choices, and the list.
void ReadAdjustmentsBody(std::string_view bytes) {
  Input input(bytes);
  const unsigned choice = input.Byte();
  SmallHome home;
  home.PutMarket();
  home.settings.download.DataService = choice & 1 ? 3 : 1;
  const std::string folder = "c:\\korawin\\data\\\r\n";
  home.Put("WMPaths.lst", folder + folder + folder + folder + folder + "0\r\n" + folder);
  home.Put("service/WMDef.Lst", choice & 2 ? "1,x,2\r\n1,x,-1\r\n" : "0,x,1\r\n");
  home.Put("chtmisc/ORE.Txt", "T,8.25,19980911,1.50,Text,255\r\n");
  home.Put("data/Adjust.Lst", input.Rest());
  const auto before = home.io.Store();
  LineReader lines(input.Rest());
  std::string_view line;
  while (lines.Next(line)) Promise(AdjustLine(ParseAdjustLine(line)) == line, "a line reads back");
  AdjustRows rows = ReadAdjustList(home.files, home.data);
  const std::string text = AdjustListText(rows);
  if (choice & 4) SortAdjustments(rows);
  if (choice & 8) MarkAll(rows, 'Y');
  if (choice & 16) MarkOptions(rows);
  if (choice & 32) MarkWarrants(rows);
  Promise(choice & 60 || AdjustListText(rows) == text, "rows stay as they are");
  std::vector<std::string> a, b;
  for (const AdjustRow& row : rows) a.push_back(AdjustLine(row));
  WriteAdjustList(home.files, home.data, rows);
  for (const AdjustRow& row : ReadAdjustList(home.files, home.data)) b.push_back(AdjustLine(row));
  std::erase_if(a, [](const std::string& one) { return Trim(one).empty(); });
  Promise(a == b, "a list reads back");

  const size_t listed = rows.size();
  const AdjustResult result =
      MakeAdjustments({home.files, home.settings, 255, home.progress}, rows, home.data);
  CheckRecords(home);
  home.OnlyChanged(before, {"data/*.WDT", "data/*.OLD", "data/Names.dat", "data/Names.bak",
                            "data/Adjust.Lst", "data/SubList*.Dat", "chtmisc/*.Txt"});
  Promise(result.failures.size() <= listed && rows.size() <= listed, "a row is done once");
  FailuresText(result);
  for (const auto& [path, stored] : home.io.Store()) {
    if (!path.ends_with(".WDT") || before.at("home/drive_c/korawin/data/ORE.WDT") == stored)
      continue;
    for (size_t at = 0; at + sizeof(PriceRec) <= stored.size(); at += sizeof(PriceRec)) {
      PriceRec rec;
      std::copy_n(stored.data() + at, sizeof rec, reinterpret_cast<char*>(&rec));
      Promise(std::isfinite(float(rec.Close)), "a price stays a number");
    }
  }
  if (!result.begun) return;
  Promise(AdjustListText(ReadAdjustList(home.files, home.data)) == AdjustListText(rows),
          "what is left stays listed");
}

// A list, and behind marks an answer and the counter.
void ReadSnapshotBody(std::string_view bytes) {
  Input input(bytes);
  const std::string_view list = input.Part(), answer = input.Part();
  SmallHome home;
  home.Put("Snapshot.Dat", list);
  home.Put("service/Snap.Lct", input.Rest());
  auto rows = ReadSnapshot(home.files, home.system, 1);
  Promise(rows.size() <= kMostSnapshotRows, "no more rows than have room");
  UpdateGrid(answer, rows);
  for (const SnapshotRow& row : rows) {
    Promise(!row.code.empty(), "a row has a code");
    if (const auto holding = HoldingOf(row)) Promise(!std::isnan(holding->units), "a number");
  }
  Totals(rows);
  const auto before = home.io.Store();
  SaveSnapshot(home.files, home.system, 1, rows);
  const auto kept = ReadSnapshot(home.files, home.system, 1);
  SaveSnapshot(home.files, home.system, 1, kept);
  const auto twice = ReadSnapshot(home.files, home.system, 1);
  Promise(twice.size() == kept.size(), "rows read back");
  for (size_t i = 0; i < kept.size(); ++i)
    Promise(kept[i].code == twice[i].code && kept[i].kind == twice[i].kind &&
                kept[i].units == twice[i].units && kept[i].cost == twice[i].cost &&
                kept[i].dividend == twice[i].dividend,
            "rows read back as they were written");
  home.OnlyChanged(before, {"Snapshot.Dat"});
  const FixedClock clock;
  const SnapshotServices services{home.files,   home.settings.paths, home.settings.download,
                                  home.dialogs, MachineProcesses(),  clock};
  Promise(SnapshotAccesses(services) >= 0, "a count");
}

// A byte of choices, and what a run that died might have left.
void ReadJournalsBody(std::string_view bytes) {
  Input input(bytes);
  const unsigned choice = input.Byte();
  SmallHome home;
  home.PutMarket();
  home.Put(kEntry, "ORE,19980915,1,1,1,1,1,0\r\n");
  if (choice & 1) {
    home.io.Put("home/Kora.set~", input.Rest());
    FinishSet(home.io, "home/Kora.set~");
    Promise(!home.io.Status("home/Kora.set~").exists, "a set is finished once");
    return;
  }
  const auto before = home.io.Store();
  home.io.confined = false;  // the folders of prices may be on any drive
  // A journal that is none is no journal; one with the right end is what it says.
  home.Put("Update.Jnl", input.Rest());
  UpdateReport report;
  std::string inHand;
  ErrorOf([&] { UpdateJournal(home.files, home.system).Finish(report, inHand); });
  std::vector<FileEdit> edits;
  const std::string_view note = input.Part();
  while (!input.Rest().empty() && edits.size() < 20) {
    FileEdit edit;
    edit.path = input.Part();
    edit.existed = (input.Byte() & 1) == 0;
    edit.before = input.Byte();
    ByteChange change;
    change.offset = input.Byte();
    change.old = input.Part();
    change.fresh = input.Part();
    edit.changes.push_back(change);
    edits.push_back(edit);
  }
  ErrorOf([&] {
    WriteEditJournal(home.files, home.system + "Update.Jnl", note, edits);
    if (const auto read = ReadEditJournal(home.files, home.system + "Update.Jnl"))
      Promise(read->note == note && read->edits.size() == edits.size(), "a journal reads back");
    UpdateJournal(home.files, home.system).Finish(report, inHand);
  });
  report.Text();
  // Besides the journal and the entry, whose name tells that it was taken, prices and names alone.
  const auto after = home.io.Store();
  for (const auto& [path, stored] : after) {
    const auto old = before.find(path);
    if (old != before.end() && old->second == stored) continue;
    Promise(EndsNoCase(path, ".WDT") || EndsNoCase(path, "/Names.dat") ||
                EndsNoCase(path, "/Update.Jnl") || path.ends_with('X'),
            "an update's journal changes what an update does");
  }
}

}  // namespace kora::test
