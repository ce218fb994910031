#include "update/security_details.h"

#include <algorithm>
#include <vector>

#include "base/file_set.h"
#include "base/numbers.h"
#include "base/runtime_error.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestDetails = 64u << 20;
constexpr std::int32_t kMostRecords = 200'000;
constexpr std::string_view kStore = "SecurityDetails.Stx";
constexpr std::string_view kIndexName = "Sdix1.inx";

constexpr std::pair<std::string_view, std::string_view> kLabels[] = {
    {"SHORTDESCRIPTION", "Description"},
    {"SECURITYTYPE", "Type"},
    {"FIRSTACTIVEDATE", "First Active"},
    {"FIRSTQUOTEDDATE", "First Quoted"},
    {"LASTQUOTEDATE", "Last Quoted"},
    {"SUSPENSIONSTARTDATE", "Suspension Start"},
    {"SUSPENSIONENDDATE", "Suspension End"},
    {"TOTALCLASSISSUE", "Total Issued"},
    {"PARVALUE", "Par Value"},
    {"PAIDUPVALUE", "Paid Value"},
    {"ASSETBACKING", "Asset backing"},
    {"DIVENDRATEPERSHARE", "DPS"},
    {"DIVIDENDSPAIDMONTHS", "Div. Mths"},
    {"CURRENTDIVIDENDAMOUNT", "Current Div"},
    {"DIVIDENTTYPE", "Div. Type"},
    {"DIVIDENDPAYABLEDATE", "Div. Payable  "},
    {"EXDATE", "Ex Div Date"},
    {"FRANKINGPERCENT", "Franking %"},
    {"CLASSAFRANKEDAMOUNT", "Class A Franked $"},
    {"CLASSBFRANKEDAMOUNT", "Class B Franked $"},
    {"CLASSCFRANKEDAMOUNT", "Class C Franked $"},
    {"GROSSDIVIDENDAMOUNT", "Gross Div."},
    {"MINAPPLICATIONMONEY", "Min. Applic.Money"},
    {"MAXAPPLICATIONMONEY", "Max Applic. Money"},
    {"APPLICATIONCLOSEDATE", "Applic.Close"},
    {"QUOTEDSECURITYINDICATOR", "Security Ind."},
    {"STAMPDUTYINDICATOR", "Stamp Duty Ind."},
    {"SHORTSELLINDICATOR", "Short Sell Ind."},
    {"PARIPASSUINDICATOR", "Pari Passu Ind."},
    {"ANNUALDIVIDENDRATE", "Annual Dividend"},
};

// The delimiter of a header; 0 when it has none, as a header in another alphabet.
char DelimiterOf(std::string_view header) {
  for (const char c : header) {
    const bool name = (c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z') ||
                      c == ' ' || c == '_';
    if (!name) return c == '\t' || (c > ' ' && c < '\x7F') ? c : 0;
  }
  return 0;
}

std::string HeaderText(std::string_view header, char delimiter) {
  const auto names = Split(header, delimiter);
  std::string text = Str(std::int32_t(names.size())) + "\r\n";
  for (const std::string_view name : names) {
    const std::string upper = UCase(name);
    const auto known = std::find_if(std::begin(kLabels), std::end(kLabels),
                                    [&](const auto& label) { return label.first == Trim(upper); });
    text += known == std::end(kLabels) ? upper : std::string(known->second);
    text += "\r\n";
  }
  return text;
}

bool IsFolderSet(std::string_view folder) { return !Trim(folder).empty() && folder != kUnknown; }

}  // namespace

bool KoraDetailsReady(const Files& files, const DownloadSettings& download) {
  if (!IsFolderSet(download.ServiceSystem)) return false;
  const std::string folder = WithBackslash(Trim(download.ServiceSystem));
  return files.CheckFile(folder + std::string(kStore)) &&
         files.CheckFile(folder + std::string(kIndexName));
}

void UpdateSecurityDetails(const Files& files, const DownloadSettings& download) {
  if (!IsFolderSet(download.ServiceSystem) || !IsFolderSet(download.ServiceIn)) return;
  const std::string system = WithBackslash(Trim(download.ServiceSystem));
  const std::string in = WithBackslash(Trim(download.ServiceIn));
  const std::string input = in + "SecurityDetails.Asx.Stk";
  try {
    if (!files.CheckFile(input)) return;
    const std::string text = files.ReadAll(input, kLargestDetails);
    LineReader lines(text.starts_with("\xEF\xBB\xBF") ? std::string_view(text).substr(3) : text);
    std::string_view line;
    if (!lines.Next(line)) return;
    const char delimiter = DelimiterOf(line);
    if (delimiter == 0) return;
    const std::string header = HeaderText(line, delimiter);

    std::string store, index;
    std::string last;
    std::int32_t count = 0;
    while (lines.Next(line)) {
      const size_t split = line.find(delimiter);
      if (split == std::string_view::npos || split < 2) continue;  // no code of two letters
      const std::string_view code = Trim(line.substr(0, split));
      if (code.empty()) continue;
      DetailsRec rec;
      rec.Code.set(code);
      rec.Details.set(line.substr(split + 1));
      store.append(reinterpret_cast<const char*>(&rec), sizeof(rec));
      if (++count > kMostRecords) return;
      if (const std::string now(rec.Code.trimmed()); now != last) {
        index += now + "," + Str(count) + "\r\n";
        last = now;
      }
    }
    FileSet set(files);
    set.Add(system + "STKHeader.txt", header);
    set.Add(system + std::string(kStore), std::move(store));
    set.Add(system + std::string(kIndexName), std::move(index));
    set.Commit();
    files.Rename(input, in + "SecurityDetails.Asx.Bak");
  } catch (const RunTimeError&) {
    // Reference data: the update stands without them, and the input waits for the next run.
  }
}

}  // namespace kora
