#include "demo/demo_market.h"

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <string>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "demo/company_details.h"
#include "demo/market.h"
#include "demo/names.h"
#include "indicators/osc_settings.h"
#include "looks/colours.h"
#include "settings/settings.h"
#include "store/name_file.h"

namespace kora {
namespace {

using namespace demo;

constexpr int kWaitingDays = 3;

// Categories, which are also the order of the name file. The update gives no flat records to
// those from 90 on, so that what has ended stays ended.
enum Category : std::int16_t {
  kLeaders = 1,
  kIndustrials = 2,
  kResources = 3,
  kSpeculative = 4,
  kIndices = 10,
  kMarketSeries = 11,
  kFunds = 12,
  kWarrants = 84,
  kEndowments = 86,
  kInstalments = 87,
  kOptions = 91,
  kNotQuoted = 98,
};

// How many of each kind stand in the name file.
struct Counts {
  explicit Counts(int securities) {
    sectorIndices = std::min(kSectors, securities / 10);
    advanceDecline = securities >= 8 ? 1 : 0;
    rates = securities >= 10 ? 1 : 0;
    funds = securities >= 10 ? 1 + securities / 150 : 0;
    warrants = securities / 12;
    options = securities / 20;
    shares = securities - 1 - sectorIndices - advanceDecline - rates - funds - warrants - options;
  }
  int sectorIndices, advanceDecline, rates, funds, warrants, options, shares;
};

// A warrant or an option, before its share has prices.
struct RightPlan {
  bool warrant;
  char letter;  // fourth character of a warrant
  bool call;
  bool lapsed;
  int first;  // day
  CalendarDate expiry;
  std::uint64_t stream;
};

// A chart list; the broad index stands in each.
struct List {
  const char* letter;
  const char* name;
  std::vector<std::int16_t> categories;
};
const List kLists[] = {{"A", "Leaders", {kLeaders}},
                       {"B", "Other shares", {kResources, kSpeculative, kIndustrials}}};

CalendarDate LastThursday(int year, int month) {
  const CalendarDate next = AddMonths({year, month, 1}, 1);
  std::int32_t n = DayNumber(next) - 1;
  while (Weekday(DateOfDayNumber(n)) != 5) --n;
  return DateOfDayNumber(n);
}

std::string MonthAndYear(const CalendarDate& date) {
  static const char* const names[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                      "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
  return names[date.month - 1] + FormatFileDate(date).substr(2, 2);
}

// A round price near `price`.
double RoundStrike(double price) {
  const double step = price >= 10 ? 0.5 : price >= 2 ? 0.25 : price >= 0.5 ? 0.05 : 0.01;
  return std::max(1.0, std::floor(price / step + 0.5)) * step;
}

class DemoWriter {
 public:
  DemoWriter(Files& files, Dialogs& dialogs, const DemoOptions& options)
      : files_(files),
        options_(options),
        counts_(options.securities),
        days_(options.years, kWaitingDays),
        progress_(dialogs.StartProgress("Demo market")) {
    SetDefaultPaths(paths_, "c:");
  }

  bool Run(SettingsFile& ini, SettingsFile& user);
  // Takes back what was written.
  void Undo();

 private:
  struct Entry {
    NameRec rec;
    std::vector<PriceRec> waiting;
    float close = 0;  // the last one of the history
  };

  std::string DownloadPath() const { return paths_.SystemPath + "download\\"; }
  std::string SystemPath() const { return paths_.SystemPath + "dlsys\\"; }  // of the service
  std::string InPath() const { return DownloadPath() + "in\\"; }
  std::string OutPath() const { return DownloadPath() + "out\\"; }
  void MakeFolders();
  void WriteFile(const std::string& path, std::string_view bytes);
  // False when the user stopped.
  bool Put(NameRec rec, const Series& series);

  void PlanRights();
  bool PutShares();
  bool PutRights(const Namer::Company& company, const Series& share,
                 const std::vector<RightPlan>& plans);
  bool PutMarket();

  NameRec ShareRecord(int index, const ShareProfile& share, const Namer::Company& company,
                      const Series& series, Random& random) const;
  void WriteDownloads();
  void WriteCompanies();
  void WriteBulletins(const std::string& base, int day);
  void WriteLists();
  void WriteSettings(SettingsFile& ini);

  Files& files_;
  const DemoOptions& options_;
  const Counts counts_;
  const Days days_;
  Paths paths_;
  std::unique_ptr<Progress> progress_;

  std::vector<ShareProfile> profiles_;
  std::vector<Random> randoms_;                 // of the shares
  std::vector<std::vector<RightPlan>> rights_;  // by share
  std::vector<Entry> entries_;
  std::string bulletins_;             // of the days so far
  std::vector<std::string> leaders_;  // the words of their names
  std::vector<std::string> leaderCodes_;
  MarketSums sums_{days_.count()};
  std::vector<std::string> written_;
};

void DemoWriter::MakeFolders() {
  for (const std::string& folder :
       {paths_.SystemPath, paths_.CurrentDataPath, paths_.ChartBackupPath,
        paths_.SystemPath + "chtmisc\\", paths_.SystemPath + "chtsave\\", DownloadPath(), InPath(),
        OutPath(), SystemPath()})
    files_.MakeFolder(folder);
}

void DemoWriter::WriteFile(const std::string& path, std::string_view bytes) {
  written_.push_back(path);
  files_.Open(path, OpenMode::kReplace)->WriteAt(0, bytes.data(), bytes.size());
}

void DemoWriter::Undo() {
  for (const std::string& path : written_) {
    try {
      if (files_.CheckFile(path)) files_.Remove(path);
    } catch (const RunTimeError&) {
      // The failure that led here is the one to tell.
    }
  }
}

bool DemoWriter::Put(NameRec rec, const Series& series) {
  const int kept = std::clamp(days_.history - series.first, 0, int(series.records.size()));
  const auto* bytes = reinterpret_cast<const char*>(series.records.data());
  WriteFile(paths_.CurrentDataPath + CodeFileName(rec.Code.trimmed(), ".WDT"),
            {bytes, size_t(kept) * sizeof(PriceRec)});
  entries_.push_back({rec,
                      {series.records.begin() + kept, series.records.end()},
                      kept > 0 ? series.records[size_t(kept - 1)].Close : 0.0f});
  return progress_->Step(int(entries_.size()), options_.securities);
}

void DemoWriter::PlanRights() {
  std::vector<size_t> underlying;
  for (size_t i = 0; i < profiles_.size(); ++i) {
    const ShareProfile& share = profiles_[i];
    if (share.tier == Tier::kLeader && share.first == 0 && share.last == days_.count() - 1)
      underlying.push_back(i);
  }
  rights_.resize(profiles_.size());
  const CalendarDate last = days_.dates[size_t(days_.history - 1)];
  for (int j = 0; j < counts_.warrants + counts_.options; ++j) {
    RightPlan plan{};
    plan.stream = 1000000 + std::uint64_t(j);
    Random random(options_.seed, plan.stream + 500000);
    plan.warrant = j < counts_.warrants;
    const int n = plan.warrant ? j : j - counts_.warrants;
    plan.letter = n % 5 == 3 ? 'I' : n % 11 == 9 ? 'E' : 'W';
    plan.call = plan.letter != 'W' || n % 3 != 1;
    plan.lapsed = !plan.warrant && n % 3 == 1;
    const int months = plan.warrant  ? 2 + random.Below(12)
                       : plan.lapsed ? -2 - random.Below(5)
                                     : 1 + random.Below(4);
    const CalendarDate month = AddMonths({last.year, last.month, 1}, months);
    plan.expiry = LastThursday(month.year, month.month);
    const int life = plan.warrant ? 240 + random.Below(400) : 150 + random.Below(150);
    const std::int32_t start = std::min(DayNumber(plan.expiry) - life, DayNumber(last) - 60);
    plan.first = int(std::lower_bound(days_.numbers.begin(), days_.numbers.end(), start) -
                     days_.numbers.begin());
    rights_[underlying[size_t(j) % underlying.size()]].push_back(plan);
  }
}

NameRec DemoWriter::ShareRecord(int index, const ShareProfile& share, const Namer::Company& company,
                                const Series& series, Random& random) const {
  NameRec rec = NewNameRec(company.code);
  rec.Name.set(company.name);
  rec.Id.set("A");
  rec.IndClass.set(Format(double(company.classId), "000"));
  const std::string sector = SectorOf(share.sector).name;
  rec.Category = share.tier == Tier::kLeader                ? kLeaders
                 : share.tier == Tier::kPenny               ? kSpeculative
                 : sector == "Mining" || sector == "Energy" ? kResources
                                                            : kIndustrials;
  if (share.last < days_.history - 1) {
    rec.Category = kNotQuoted;
    rec.OtherDetails.set("To " + FormatUserDate(days_.dates[size_t(share.last)]));
  } else if (share.first > 0) {
    rec.OtherDetails.set("Float " + MonthAndYear(days_.dates[size_t(share.first)]));
  }

  // What a user would have set by hand on some.
  const int upTo = std::min(series.last(), days_.history - 1) - series.first;
  float low = series.records[size_t(upTo)].Close, high = low;
  for (int i = std::max(0, upTo - 250); i <= upTo; ++i) {
    const float close = series.records[size_t(i)].Close;
    low = std::min(low, close);
    high = std::max(high, close);
  }
  if (index % 5 == 1) {
    rec.Base = FromThousandths(ToThousandths(double(low) * 0.85));
    rec.Top = FromThousandths(ToThousandths(double(high) * 1.15));
  }
  if (index % 4 == 2) rec.PFInc = FromThousandths(ToThousandths(double(high) / 50));
  if (index % 6 == 0) {
    rec.BandUp = std::int16_t(3 + random.Below(10));
    rec.BandDown = std::int16_t(3 + random.Below(10));
  }
  if (index % 7 == 0) {
    rec.BollPeriods = 20;
    rec.BollWidth = 2;
  }
  return rec;
}

bool DemoWriter::PutShares() {
  for (int i = 0; i < counts_.shares; ++i) {
    randoms_.emplace_back(options_.seed, 1000 + std::uint64_t(i));
    profiles_.push_back(MakeProfile(i, counts_.shares, days_, randoms_.back()));
  }
  PlanRights();
  const Factors factors = MakeFactors(days_, options_.seed);
  Namer namer(options_.seed);
  for (int i = 0; i < counts_.shares; ++i) {
    const ShareProfile& share = profiles_[size_t(i)];
    Random& random = randoms_[size_t(i)];
    const Namer::Company company = namer.Next(share.sector);
    const Series series = SimulateShare(share, factors, days_, random);
    sums_.Add(share, series);
    if (share.tier == Tier::kLeader) {
      leaders_.push_back(company.word);
      leaderCodes_.push_back(company.code);
    }
    if (!Put(ShareRecord(i, share, company, series, random), series)) return false;
    if (!PutRights(company, series, rights_[size_t(i)])) return false;
  }
  return true;
}

bool DemoWriter::PutRights(const Namer::Company& company, const Series& share,
                           const std::vector<RightPlan>& plans) {
  int warrants = 0, options = 0;
  for (const RightPlan& plan : plans) {
    Random random(options_.seed, plan.stream);
    const double spot = double(share.records[size_t(plan.first)].Close);
    Right right;
    right.call = plan.call;
    right.strike =
        RoundStrike(spot * (plan.call ? random.Between(0.8, 1.05) : random.Between(0.95, 1.2)));
    right.expiry = DayNumber(plan.expiry);
    if (plan.warrant && right.strike > 8) right.ratio = 4;
    const Series series = SimulateRight(right, share, plan.first, days_, random);

    const int n = plan.warrant ? warrants++ : options++;
    const std::string pair = {char('A' + n / 26), char('A' + n % 26)};
    NameRec rec = NewNameRec(company.code + (plan.warrant ? plan.letter + pair : pair));
    const std::string side = plan.call ? "Call" : "Put";
    const std::string strike = Format(right.strike, "0.00");
    if (plan.warrant) {
      const char* kind = plan.letter == 'I'   ? "Instalment"
                         : plan.letter == 'E' ? "Endowment"
                                              : "Wts";
      rec.Name.set(company.word + " " + kind + " " + MonthAndYear(plan.expiry));
      rec.OtherDetails.set(side + " " + strike);
      rec.Category = plan.letter == 'I'   ? kInstalments
                     : plan.letter == 'E' ? kEndowments
                                          : kWarrants;
      rec.Id.set("S");
    } else {
      // The texts that the update writes and looks for in a list of options.
      rec.Name.set(plan.lapsed ? "**EXPIRED**"
                               : company.word + " " + side + " " + MonthAndYear(plan.expiry) + " " +
                                     strike);
      rec.OtherDetails.set((plan.call ? "0C" : "0P") + FormatUserDate(plan.expiry));
      rec.Category = kOptions;
      rec.Id.set("P");
    }
    if (!Put(rec, series)) return false;
  }
  return true;
}

bool DemoWriter::PutMarket() {
  const auto record = [](const std::string& code, const std::string& name, std::int16_t type,
                         std::int16_t category, const char* id, const char* industry) {
    NameRec rec = NewNameRec(code);
    rec.Name.set(name);
    rec.RecType = type;
    rec.Category = category;
    rec.Id.set(id);
    rec.IndClass.set(industry);
    return rec;
  };
  const Series broad = sums_.Index(-1, days_);
  if (!Put(record("XBRD", "Broad Market Index", kIndex, kIndices, "X", "911"), broad)) return false;
  for (int s = 0; s < counts_.sectorIndices; ++s) {
    const Sector& sector = SectorOf(s);
    if (!Put(record(sector.indexCode, sector.name + std::string(" Index"), kIndex, kIndices, "X",
                    "911"),
             sums_.Index(s, days_)))
      return false;
  }
  if (counts_.advanceDecline &&
      !Put(record("ADVD", "Advances and Declines", kAdvanceDecline, kMarketSeries, "X", "910"),
           sums_.AdvanceDecline(days_)))
    return false;
  if (counts_.rates) {
    Random random(options_.seed, 3);
    if (!Put(record("BILL", "Bank Bills 90 Days Yield", kCloseOnly, kMarketSeries, "X", "912"),
             SimulateRate(days_, random)))
      return false;
  }
  for (int k = 0; k < counts_.funds; ++k) {
    static const char* const kinds[] = {"Growth Fund", "Balanced Fund", "Income Fund"};
    Random random(options_.seed, 200 + std::uint64_t(k));
    const size_t house = size_t(k) % leaders_.size();
    const std::string code = leaderCodes_[house] + "F";
    if (!Put(record(code, leaders_[house] + " " + kinds[k % 3], kCloseVolume, kFunds, "A", "912"),
             SimulateFund(broad, days_, random)))
      return false;
  }
  return true;
}

// A line of eight fields for each security, traded or not: the service's files have all of them.
void DemoWriter::WriteDownloads() {
  static const char* const months[] = {"JAN", "FEB", "MAR", "APR", "MAY", "JUN",
                                       "JUL", "AUG", "SEP", "OCT", "NOV", "DEC"};
  for (int day = days_.history; day < days_.count(); ++day) {
    const std::string& date = days_.texts[size_t(day)];
    std::string text;
    for (const Entry& entry : entries_) {
      for (const PriceRec& rec : entry.waiting) {
        if (rec.RecDate.raw() != date) continue;
        text += std::string(entry.rec.Code.trimmed()) + "," + date;
        for (const float price : {rec.Open, rec.High, rec.Low, rec.Close}) text += "," + Str(price);
        text += "," + Str(rec.Volume) + ",0\r\n";
      }
    }
    const std::string base =
        date.substr(6, 2) + months[days_.dates[size_t(day)].month - 1] + date.substr(2, 2);
    WriteFile(DownloadPath() + base + ".d", text);
    WriteBulletins(base, day - days_.history);
  }
}

// Facts of the companies that are quoted, a list for the snapshot, and a program that answers it.
void DemoWriter::WriteCompanies() {
  std::vector<Company> companies;
  std::string snapshot;
  int listed = 0;
  for (const Entry& entry : entries_) {
    const NameRec& rec = entry.rec;
    if (rec.RecType == kShare && rec.Category <= kSpeculative && entry.close > 0)
      companies.push_back({rec, entry.close});
    if (rec.Category == kLeaders && listed < 8) {
      const std::string code(rec.Code.trimmed());
      snapshot += code + ",S,";
      if (++listed <= 3)
        snapshot +=
            Str(std::int32_t(500 * listed)) + "," + Format(entry.close * 0.9, "0.00") + ",0.25";
      else
        snapshot += ",,";
      snapshot += "\r\n";
    }
  }
  snapshot += "XBRD,I,,,\r\n";
  const CompanyFiles details =
      MakeCompanyDetails(companies, days_.dates[size_t(days_.history - 1)], options_.seed);
  WriteFile(SystemPath() + "STKHeader.txt", details.header);
  WriteFile(SystemPath() + "SecurityDetails.Stx", details.store);
  WriteFile(SystemPath() + "Sdix1.inx", details.index);
  WriteFile(paths_.SystemPath + "Snapshot.Dat", snapshot);
  const std::string program = paths_.SystemPath + "Quickcomm.exe";
  WriteFile(program, CommsProgram());
  std::error_code ignored;  // where it can't be run the snapshot says so
  std::filesystem::permissions(files_.HostPath(program), std::filesystem::perms::owner_exec,
                               std::filesystem::perm_options::add, ignored);
}

// What the exchange told about the days that wait: every kind of event, about securities of the
// market. The new codes and figures are invented.
void DemoWriter::WriteBulletins(const std::string& base, int day) {
  std::vector<std::string> shares;
  for (const Entry& entry : entries_)
    if (entry.rec.RecType == kShare && entry.rec.Code.trimmed().size() == 3)
      shares.emplace_back(entry.rec.Code.trimmed());
  const auto share = [&](int number) {
    return shares.empty() ? std::string("AAA") : shares[size_t(number) % shares.size()];
  };
  const auto name = [&](const std::string& code) {
    for (const Entry& entry : entries_)
      if (entry.rec.Code.trimmed() == code) return std::string(Trim(entry.rec.Name.trimmed()));
    return code;
  };
  const auto line = [](const char* act, const std::string& code, const char* mark,
                       const std::string& rest, const char* market = "ASX.STK") {
    return std::string(act) + "," + code + "," + market + ",," + mark + "," + rest + "\r\n";
  };
  std::string text;
  switch (day) {
    case 0:
      text = line("BI", share(2), "Y", base + ",1,4") +
             line("DI", share(0), "N", base + ",,,12.5") +
             line("NI", share(5), "Y", UCase(name(share(5))) + " GROUP,011");
      break;
    case 1:
      text = line("SP", share(3), "Y", base + ",1,1") +
             line("PC", share(1), "Y", base + ",V:250000") +
             line("NL", share(6), "N", UCase(name(share(6))) + " HOLDINGS,012") +
             line("EN", share(4), "N", base);
      break;
    default:
      text = line("NC", share(7), "Y", base + ",ZNEW") + line("DC", share(8), "N", base) +
             line("DI", share(2), "N", base + ",,,4");
      break;
  }
  WriteFile(InPath() + base + ".Asx.Btn", text);
  // The service of mainfiles has one bulletin, without a day in its name.
  bulletins_ += text;
  WriteFile(InPath() + ".Asx.Btn", bulletins_);
}

void DemoWriter::WriteLists() {
  for (const List& list : kLists) {
    std::string bytes;
    const auto add = [&bytes](size_t recordNumber, const NameRec& rec) {
      bytes += char(recordNumber & 0xFF);
      bytes += char(recordNumber >> 8);
      bytes += rec.Code.raw();
    };
    for (size_t i = 0; i < entries_.size(); ++i) {
      const NameRec& rec = entries_[i].rec;
      if (std::find(list.categories.begin(), list.categories.end(), rec.Category) !=
              list.categories.end() ||
          rec.Code.trimmed() == "XBRD")
        add(i + 1, rec);
    }
    WriteFile(paths_.CurrentDataPath + "SubList" + list.letter + ".Dat", bytes);
  }
}

void DemoWriter::WriteSettings(SettingsFile& ini) {
  SettingsFile::Batch batch(ini);
  WriteDefaultSettings(ini);
  WriteDefaultOscPeriods(ini);
  ini.PutSetting("Download", "DataService", "1");
  ini.PutSetting("Download", "System", SystemPath());
  ini.PutSetting("Download", "DLPath", DownloadPath());
  ini.PutSetting("Download", "In", InPath());
  ini.PutSetting("Download", "Out", OutPath());
  ini.PutSetting("Download", "InternetDLfmt", "DDMMMYY.D");
  ini.PutSetting("Download", "Volume divisor", "1");
  ini.PutSetting("Download", "UpdateAll", "True");
  ini.PutSetting("Download", "NoWarrants", "False");
  ini.PutSetting("OscDef", "CompFile", paths_.CurrentDataPath + "XBRD.WDT");
}

bool DemoWriter::Run(SettingsFile& ini, SettingsFile& user) {
  MakeFolders();
  if (!PutShares() || !PutMarket()) return false;

  std::sort(entries_.begin(), entries_.end(), [](const Entry& a, const Entry& b) {
    return SortKey(a.rec, NameSort::kCategory) < SortKey(b.rec, NameSort::kCategory);
  });
  std::string classes;
  for (const IndustryClass& c : IndustryClasses())
    classes += Format(double(c.id), "000") + "," + c.text + "\r\n";
  WriteFile(paths_.SystemPath + "IndClass.dat", classes);
  for (const char* table : {"BLK", "WHT", "BLU"})
    written_.push_back(paths_.SystemPath + "Koraclr." + table);
  WriteColourVariants(files_, paths_.SystemPath);
  written_.push_back(paths_.SystemPath + "koraprn.dat");
  PrinterColours printer;
  printer.ColourPrinter = 1;
  printer.WhiteAsBlack = 1;
  WritePrinterColours(files_, paths_.SystemPath, printer);
  WriteDownloads();
  WriteCompanies();
  WriteLists();

  // Last, what makes the home an installation.
  std::string names;
  for (const Entry& entry : entries_)
    names.append(reinterpret_cast<const char*>(&entry.rec), sizeof entry.rec);
  written_.push_back(NameFilePath(paths_.CurrentDataPath));
  files_.WriteAll(written_.back(), names);
  written_.push_back(ini.path());
  WriteSettings(ini);
  if (!ini.Exists()) throw RunTimeError(kPathAccess, "the settings file can't be written");
  for (const List& list : kLists)
    user.PutSetting("KORA Charting System", std::string("SubList") + list.letter, list.name);
  return true;
}

// A home with a market of its own is never written over.
void RefuseUsedHome(const Files& files, const SettingsFile& ini) {
  Paths paths;
  SetDefaultPaths(paths, "c:");
  bool used = ini.Exists() || files.CheckFile(NameFilePath(paths.CurrentDataPath));
  if (!used && files.IsFolder(paths.CurrentDataPath))
    for (const std::string& name : files.List(paths.CurrentDataPath))
      used = used || (name.size() > 4 && EqualNoCase(name.substr(name.size() - 4), ".WDT"));
  if (used) throw RunTimeError(kPathAccess, "there is an installation in this home already");
}

}  // namespace

bool MakeDemo(Files& files, SettingsFile& ini, SettingsFile& user, Dialogs& dialogs,
              const DemoOptions& options) {
  if (options.securities < 5 || options.securities > 5000 || options.years < 1 ||
      options.years > 40)
    throw RunTimeError(kBadCall, "5 to 5000 securities, 1 to 40 years");
  RefuseUsedHome(files, ini);
  files.MakeFolder("c:\\");  // a home that is not there yet can't be locked
  const auto held = files.lock().Hold();
  DemoWriter writer(files, dialogs, options);
  try {
    if (writer.Run(ini, user)) return true;
  } catch (const RunTimeError&) {
    writer.Undo();
    throw;
  }
  writer.Undo();
  return false;
}

}  // namespace kora
