#include "adjust/bulletins.h"

#include "adjust/adjust_list.h"
#include "base/file_set.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/market_folders.h"
#include "store/name_rec.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestBulletin = 64u << 20;
constexpr std::uint64_t kFewestOptions = 10;  // a folder of options has more names than these

bool Has(std::string_view line, std::string_view text) {
  return line.find(text) != std::string_view::npos;
}

// Replaces the first occurrence; false where there is none.
bool Replace(std::string& line, std::string_view text, std::string_view with) {
  const size_t at = line.find(text);
  if (at == std::string::npos) return false;
  line.replace(at, text.size(), with);
  return true;
}

// The word goes with the character behind it, whatever that is.
void ReplaceWord(std::string& line, std::string_view word, std::string_view with) {
  const size_t at = line.find(word);
  if (at != std::string::npos) line.replace(at, word.size() + 1, with);
}

void KeepFieldUnder(std::string& line, std::string_view field, std::string_view kept) {
  const size_t at = UCase(line).find("," + std::string(field) + ",");
  if (at != std::string::npos) line.replace(at + 1, field.size(), kept);
}

// What the fields between two commas say, seen in one pass: a market may have thousands of lines.
struct LineFields {
  bool device = false;                // "AUX" or "PRN"
  bool option = false;                // "OPT"
  bool warrant = false;               // "WNT" or "ASX.WNT"
  size_t market = std::string::npos;  // of kMarkets, the first of the table that is there
  size_t marketAt = 0;                // where it stands
};

struct MarketName {
  std::string_view field, name;  // an empty name: the base name of the bulletin
};
constexpr MarketName kMarkets[] = {{"SUM", ""},        {"ASX.STK", ""},    {"ASX.OPT", "OPT"},
                                   {"ASX.IDX", "IDX"}, {"ASX.WNT", "WNT"}, {"SFE.FUT", "SFE"},
                                   {"WCM.OVS", "OVS"}};

LineFields FieldsOf(std::string_view line) {
  LineFields out;
  size_t comma = line.find(',');
  while (comma != std::string_view::npos) {
    const size_t from = comma + 1;
    comma = line.find(',', from);
    if (comma == std::string_view::npos) break;
    const std::string_view field = line.substr(from, comma - from);
    if (field.size() != 3 && field.size() != 7) continue;
    out.device |= EqualNoCase(field, "AUX") || EqualNoCase(field, "PRN");
    out.option |= field == "OPT";
    out.warrant |= field == "WNT" || field == "ASX.WNT";
    for (size_t i = 0; i < std::size(kMarkets) && i < out.market; ++i)
      if (field == kMarkets[i].field) {
        out.market = i;
        out.marketAt = from;
      }
  }
  return out;
}

// A code of six characters behind an action of two, whose fourth is a letter of warrants.
bool IsWarrantCode(std::string_view line) {
  if (line.find(',') == std::string_view::npos) return false;
  const size_t second = line.find(',', line.find(',') + 1);
  return second == 9 && Has("WIEXDS", line.substr(6, 1));
}

void ShortenName(std::string& line, bool warrant) {
  constexpr std::pair<std::string_view, std::string_view> kShorter[] = {
      {"LIMITED", "LTD "},        {"ENDOWMENT", "ENDOW "}, {"AUSTRALIA", "AUST "},
      {"INSTALMENT", "INSTAL "},  {"EXPLORATION", "EXP "}, {"CORPORATION", "CORP "},
      {"INTERNATIONAL", "INTER "}};
  for (const auto& [word, with] : kShorter) ReplaceWord(line, word, with);
  ReplaceWord(line, "WARRANT", "");
  Replace(line, "WARR ", "");
  // In this order: what one took out the next can't find.
  for (const std::string_view word :
       {"SG AUST", "WARBURG", "ABN AMRO", "CITIBANK", "ANZ BANK", "UBS WARBURG", "BNP PARIBAS",
        "SG AUSTRALIA", "MERRILL LYNCH", "DEUTSCHE BANK", "MACQUARIE BANK", "MACQUARIE",
        "ROBERT FLEMING", "CREDIT SUISSE"})
    ReplaceWord(line, word, "");
  if (!warrant) return;
  size_t comma = line.find(',');
  const std::string code = line.substr(comma + 1, line.find(',', comma + 1) - comma - 1);
  for (int i = 1; i < 5 && comma != std::string::npos; ++i) comma = line.find(',', comma + 1);
  if (comma == std::string::npos) return;
  const std::string underlying = " " + code.substr(0, 3);
  if (const size_t at = line.find(underlying, comma + 4); at != std::string::npos)
    line.erase(at, underlying.size());
}

bool OptionsFolder(const Files& files, const Settings& settings) {
  const WmPaths lines = ReadWmPaths(files, settings.paths.SystemPath);
  const std::string folder(Trim(lines[kWmOptions]));
  if (folder.empty() || folder == "\\KORAWIN\\DATA\\") return false;
  try {
    const std::string names = WithBackslash(folder) + "Names.Dat";
    if (!files.CheckFile(names)) return false;
    return files.Open(names, OpenMode::kRead)->Size() / sizeof(NameRec) > kFewestOptions;
  } catch (const RunTimeError&) {
    return false;
  }
}

}  // namespace

std::optional<std::string> MergeBulletinLine(std::string_view text, const BulletinRules& rules) {
  std::string line(text);
  LineFields fields = FieldsOf(line);
  if (fields.device) {
    KeepFieldUnder(line, "AUX", "1AUX");
    KeepFieldUnder(line, "PRN", "PRNX");
    fields = FieldsOf(line);
  }
  if (fields.market < std::size(kMarkets)) {
    const auto& [field, name] = kMarkets[fields.market];
    line.replace(fields.marketAt, field.size(),
                 name.empty() ? std::string_view(rules.baseName) : name);
    fields.option |= name == "OPT";
  }
  if (fields.option && !rules.OptionsFolderOK) return std::nullopt;
  const bool warrant = fields.warrant || IsWarrantCode(line);
  if (warrant && rules.NoWarrants) return std::nullopt;
  if (line.starts_with("NI") && (rules.NoShortNames || Has(line, "DELETE THIS")))
    return std::nullopt;
  if (line.starts_with("DC")) Replace(line, ",N,", ",Y,");
  if (line.starts_with("NL")) {
    Replace(line, ",N,", ",Y,");
    ShortenName(line, warrant);
  }
  if (line.starts_with("DI")) {
    if (rules.Divs == 1) return std::nullopt;
    if (rules.Divs == 2) Replace(line, ",N,", ",Y,");
    if (rules.Divs == 4) Replace(line, ",N,", ",D,");
  }
  return line;
}

void MergeBulletins(const Files& files, const Settings& settings, const std::string& path,
                    const std::string& baseName, Progress& progress, int& added) {
  const std::string_view in = Trim(settings.download.ServiceIn);
  const std::string_view out = Trim(settings.download.ServiceOut);
  if (in.empty() || in == kUnknown || out.empty() || out == kUnknown) return;
  const BulletinRules rules{baseName, OptionsFolder(files, settings), settings.download.NoWarrants,
                            settings.NoShortNames, settings.AdjDivs};
  progress.Show(ProgressLine::kNote, "Checking and updating adjustments list.");
  constexpr std::pair<const char*, const char*> kBulletins[] = {{".Asx.Btn", ".Asx.Btx"},
                                                                {".Sfe.Btn", ".Sfe.Btx"},
                                                                {".Wcm.Btn", ".Wcm.Btx"},
                                                                {".Btn", ".Btx"}};
  const auto held = files.lock().Hold();
  for (const auto& [input, copy] : kBulletins) {
    const std::string from = WithBackslash(in) + baseName + input;
    const std::string to = WithBackslash(out) + baseName + copy;
    if (!files.CheckFile(from) || files.CheckFile(to)) continue;
    const std::string text = files.ReadAll(from, kLargestBulletin);
    if (text.empty()) continue;
    const std::string listPath = AdjustListPath(path);
    std::string list =
        files.CheckFile(listPath) ? files.ReadAll(listPath, kLargestBulletin) : std::string();
    if (!list.empty() && !list.ends_with('\n')) list += "\r\n";
    int lines = 0;
    LineReader reader(std::string_view(text).substr(text.starts_with("\xEF\xBB\xBF") ? 3 : 0));
    std::string_view line;
    while (reader.Next(line)) {
      if (Trim(line).empty()) continue;
      if (const auto merged = MergeBulletinLine(line, rules)) {
        list += *merged + "\r\n";
        ++lines;
      }
    }
    FileSet changes(files);
    changes.Add(to, text);
    if (lines > 0) changes.Add(listPath, std::move(list));
    changes.Commit();
    added += lines;
  }
  progress.Show(ProgressLine::kNote, "");
}

int CheckBulletins(const Files& files, const Settings& settings, const std::string& path,
                   const std::string& baseName, Progress& progress) {
  int added = 0;
  try {
    MergeBulletins(files, settings, path, baseName, progress, added);
  } catch (const RunTimeError&) {
    progress.Show(ProgressLine::kNote, "");  // the bulletin waits for the next run
  }
  return added;
}

}  // namespace kora
