#include "demo/names.h"

#include <string_view>

#include "base/files.h"
#include "base/text.h"

namespace kora::demo {

const Sector& SectorOf(int sector) {
  static const Sector sectors[kSectors] = {{"Mining", "XMIN", 110},   {"Finance", "XFNC", 310},
                                           {"Energy", "XNRG", 120},   {"Consumer", "XCSM", 220},
                                           {"Industry", "XNDS", 210}, {"Technology", "XTKN", 410},
                                           {"Health", "XHLT", 230},   {"Materials", "XMTL", 130}};
  return sectors[sector];
}

const std::vector<IndustryClass>& IndustryClasses() {
  static const std::vector<IndustryClass> classes = {
      {110, "Mining", {}},
      {111, "Gold", {"Gold NL", "Gold Mines Ltd", "Goldfields NL"}},
      {112, "Base metals", {"Copper Ltd", "Zinc NL", "Nickel NL", "Metals Ltd"}},
      {113, "Iron ore and steel", {"Iron Ltd", "Steel Ltd", "Ore Ltd"}},
      {114, "Mineral sands and others", {"Sands NL", "Minerals NL", "Exploration NL"}},
      {120, "Energy", {}},
      {121, "Oil and gas", {"Petroleum NL", "Oil & Gas Ltd", "Energy Ltd"}},
      {122, "Coal", {"Coal Ltd", "Collieries Ltd"}},
      {123, "Power and gas supply", {"Power Ltd", "Gas Supply Ltd", "Renewables Ltd"}},
      {130, "Materials", {}},
      {131, "Building materials", {"Cement Ltd", "Timber Ltd", "Bricks Ltd"}},
      {132, "Chemicals", {"Chemicals Ltd", "Fertilisers Ltd"}},
      {133, "Paper and packaging", {"Paper Ltd", "Packaging Ltd"}},
      {210, "Industry", {}},
      {211, "Engineering", {"Engineering Ltd", "Industries Ltd", "Constructions Ltd"}},
      {212, "Transport", {"Transport Ltd", "Shipping Ltd", "Airfreight Ltd"}},
      {213, "Infrastructure", {"Tollways Ltd", "Ports Ltd", "Infrastructure Group"}},
      {220, "Consumer", {}},
      {221, "Food and beverages", {"Foods Ltd", "Wines Ltd", "Dairies Ltd"}},
      {222, "Retail", {"Stores Ltd", "Retail Ltd", "Trading Ltd"}},
      {223, "Media and leisure", {"Media Ltd", "Resorts Ltd", "Gaming Ltd"}},
      {230, "Health", {}},
      {231, "Health care", {"Hospitals Ltd", "Health Care Ltd", "Pathology Ltd"}},
      {232, "Biotechnology", {"Biotech Ltd", "Therapeutics Ltd", "Vaccines Ltd"}},
      {310, "Finance", {}},
      {311, "Banks", {"Bank Ltd", "Banking Group"}},
      {312, "Insurance", {"Insurance Ltd", "Assurance Ltd"}},
      {313, "Property trusts", {"Property Trust", "Office Trust", "Retail Trust"}},
      {314, "Investment", {"Investments Ltd", "Capital Ltd"}},
      {410, "Technology", {}},
      {411, "Software and services", {"Software Ltd", "Systems Ltd", "Data Ltd"}},
      {412, "Telecommunications", {"Telecom Ltd", "Networks Ltd"}},
      {910, "Market series", {}},
      {911, "Indices", {}},
      {912, "Funds and rates", {}},
  };
  return classes;
}

Namer::Namer(std::uint64_t seed) : random_(seed, 1) {
  // Two halves that make a word of no language.
  static const char* const heads[] = {
      "Tarr", "Belm", "Kinj", "Yand", "Morv",  "Wex",  "Quill", "Dunt", "Farl", "Garb",
      "Holv", "Jint", "Lomb", "Narv", "Orrb",  "Pelt", "Ravk",  "Selk", "Tulv", "Ulm",
      "Verr", "Warb", "Yarv", "Zebr", "Brint", "Cald", "Dorv",  "Ellk", "Fenj", "Gild",
      "Hask", "Irv",  "Jorv", "Kelb", "Lask",  "Mund", "Nork",  "Ostr", "Pyrm", "Rusk",
      "Stav", "Tryl", "Undr", "Vosk", "Wynd",  "Zant", "Drav",  "Burr"};
  static const char* const tails[] = {"owin",   "umurra", "ajarra", "endool", "abindi",
                                      "orrick", "ulmere", "istow",  "angong", "ovalla",
                                      "undary", "ecambe", "itarra", "ellup",  "ondine",
                                      "aquay",  "urrin",  "ismar",  "ogarth", "entha"};
  for (const char* head : heads)
    for (const char* tail : tails) words_.push_back(std::string(head) + tail);
  for (size_t i = words_.size() - 1; i > 0; --i)
    words_[i].swap(words_[size_t(random_.Below(int(i) + 1))]);
}

Namer::Company Namer::Next(int sector) {
  std::vector<const IndustryClass*> choice;
  const int group = SectorOf(sector).group;
  for (const IndustryClass& c : IndustryClasses())
    if (c.id / 10 == group / 10 && !c.endings.empty()) choice.push_back(&c);
  const IndustryClass& industry = *choice[size_t(random_.Below(int(choice.size())))];
  const std::string ending = industry.endings[size_t(random_.Below(int(industry.endings.size())))];

  // A word comes round again in a large market, then with another ending.
  for (;;) {
    const std::string& word = words_[used_++ % words_.size()];
    std::string name = word + " " + ending;
    if (!names_.insert(name).second) continue;
    return {CodeFor(word), word, std::move(name), industry.id};
  }
}

// The word's first letter, then letters that few real codes have, so that a code hardly ever
// means something else to the reader.
std::string Namer::CodeFor(const std::string& word) {
  static constexpr std::string_view kRare = "QZXJVK";
  static constexpr std::string_view kLetters = "ABCDEFGHIJKLMNOPQRSTUVWXYZ";
  const auto take = [this](char first, std::string_view middles, std::string_view lasts) {
    for (size_t m = 0; m < middles.size(); ++m) {
      const char middle = middles[(used_ + m) % middles.size()];
      for (const char last : lasts) {
        const std::string code = {first, middle, last};
        if (middle != last && IsFileCode(code) && codes_.insert(code).second) return code;
      }
    }
    return std::string();
  };
  const std::string letters = UCase(word);
  std::string code = take(letters[0], kRare, kRare);
  if (code.empty()) code = take(letters[0], kRare, letters.substr(2));
  // A market of thousands takes what is left.
  if (code.empty()) code = take(letters[0], kLetters, kLetters);
  for (size_t i = 0; code.empty() && i < kLetters.size(); ++i)
    code = take(kLetters[i], kLetters, kLetters);
  return code;
}

}  // namespace kora::demo
