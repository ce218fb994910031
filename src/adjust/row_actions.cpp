#include "adjust/row_actions.h"

#include <algorithm>
#include <array>
#include <vector>

#include "adjust/adjustment.h"
#include "base/currency.h"
#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/chart_notes.h"
#include "store/definition_file.h"
#include "store/name_file.h"
#include "store/price_edit.h"

namespace kora {
namespace {

class Action {
 public:
  Action(const ActionPlace& place, const AdjustRow& row, FileSet& changes)
      : place_(place), row_(row), changes_(changes), code_(UCase(row.Field(kAdjCode))) {}

  // Whether there is anything to change.
  bool Run();

 private:
  void AddName();
  void ChangeName();
  void RemoveSecurity();
  void IssueBonus();
  void PayDividend();
  void ChangePrices();

  void Status(const std::string& text) const {
    if (place_.status) place_.status(text);
  }
  std::string PricePath(const std::string& code, const char* extension = ".WDT") const {
    return place_.folder + CodeFileName(code, extension);
  }
  bool HasPrices(const std::string& code) const { return place_.files.CheckFile(PricePath(code)); }
  std::vector<PriceRec> Prices(const std::string& code) const {
    return PriceEdit(place_.files, PricePath(code)).records();
  }
  void WritePrices(const std::string& code, const std::vector<PriceRec>& prices) {
    StagePrices(changes_, PricePath(code), prices);
    any_ = true;
  }
  void WriteNames(const std::vector<NameRec>& names) {
    StageNames(changes_, NameFilePath(place_.folder), names);
    any_ = true;
  }
  void Scale(PriceEdit& edit, std::int32_t recNo, float factor, const std::string& desc);

  const ActionPlace& place_;
  const AdjustRow& row_;
  FileSet& changes_;
  const std::string code_;
  bool any_ = false;
};

// The place of the first record of the code, or the end.
std::vector<NameRec>::iterator FindName(std::vector<NameRec>& names, const std::string& code) {
  return std::find_if(names.begin(), names.end(), [&](const NameRec& name) {
    return UCase(Trim(name.Code.trimmed())) == code;
  });
}

// The last record dated before the day, or 0. Dates compare as numbers.
std::int32_t RecordBefore(const std::vector<PriceRec>& prices, const std::string& date) {
  for (std::int32_t n = std::int32_t(prices.size()); n >= 1; --n) {
    const double at = Val(prices[size_t(n - 1)].RecDate.raw());
    if (at == Val(date)) return n - 1;
    if (at < Val(date)) return n;
  }
  return 0;
}

// NI, NL: the name and class of a security that is there, or a record for a price file that has
// none.
void Action::AddName() {
  const std::string name = row_.Field(kAdjName);
  if (name.empty()) return;
  std::vector<NameRec> names = ReadNames(place_.files, place_.folder);
  auto rec = FindName(names, code_);
  if (rec == names.end()) {
    if (!HasPrices(code_)) return;
    NameRec added = NewNameRec(code_);
    added.Category = 0;
    rec = names.insert(names.end(), added);
  }
  rec->Name.set(name);
  rec->IndClass.set(row_.Field(kAdj7));
  Status("Adding " + code_ + " " + name + " to Name File");
  WriteNames(names);
}

// NC. A security that takes its own code as the new one stays as it is.
void Action::ChangeName() {
  const std::string to = UCase(row_.Field(kAdj7));
  const std::string date = BulletinDate(row_.Field(kAdjName));
  if (date.empty() || !IsFileCode(to) || to == code_) return;
  std::vector<NameRec> names = ReadNames(place_.files, place_.folder);
  const bool newNameThere = FindName(names, to) != names.end();
  const auto rec = FindName(names, code_);
  if (rec == names.end()) return;
  const auto done = [&] { Status("Name Change :" + code_ + "to  " + to); };
  if (newNameThere) rec->NameStatus = 9;
  if (!HasPrices(code_)) {
    if (newNameThere) WriteNames(names);
    return;
  }
  const std::vector<PriceRec> old = Prices(code_);
  if (old.empty()) {
    rec->NameStatus = 9;
    WriteNames(names);
    return;
  }
  if (!HasPrices(to)) {
    rec->Code.set(to);
    WriteNames(names);
    changes_.Rename(PricePath(code_), PricePath(to));
    done();
    return;
  }
  if (old.size() > 1) {
    std::vector<PriceRec> merged;
    const std::vector<PriceRec> next = Prices(to);
    std::copy_if(old.begin(), old.end(), std::back_inserter(merged),
                 [&](const PriceRec& day) { return day.RecDate.raw() < date; });
    std::copy_if(next.begin(), next.end(), std::back_inserter(merged),
                 [&](const PriceRec& day) { return day.RecDate.raw() >= date; });
    changes_.Add(PricePath(to, ".OLD"), place_.files.ReadAll(PricePath(to)));
    WritePrices(to, merged);
    changes_.Rename(PricePath(code_), PricePath(code_, ".OLD"));
  }
  if (newNameThere) WriteNames(names);
  done();
}

// DC.
void Action::RemoveSecurity() {
  if (HasPrices(code_)) {
    changes_.Rename(PricePath(code_), PricePath(code_, ".OLD"));
    any_ = true;
  }
  std::vector<NameRec> names = ReadNames(place_.files, place_.folder);
  if (const auto rec = FindName(names, code_); rec != names.end()) {
    rec->NameStatus = 9;
    WriteNames(names);
  }
  Status("Removal :" + code_);
}

void Action::Scale(PriceEdit& edit, std::int32_t recNo, float factor, const std::string& desc) {
  StageAdjustment(changes_,
                  {.files = place_.files,
                   .priceFile = edit.path(),
                   .notesFile = ChartNotesPath(place_.notesFolder, code_),
                   .NoteColour = place_.noteColour},
                  edit, CInt(recNo), {factor, desc});
  any_ = true;
}

// BI, SP. A ratio that gives no factor above 0 does nothing.
void Action::IssueBonus() {
  const Currency a(Val(row_.Field(kAdj7))), b(Val(row_.Field(kAdj8)));
  const std::string date = BulletinDate(row_.Field(kAdjName));
  Currency sum = a;
  sum += b;
  if (date.empty() || sum.units() == 0 || !HasPrices(code_)) return;
  const Currency factor(b.ToDouble() / sum.ToDouble());
  if (factor.units() <= 0) return;
  PriceEdit edit(place_.files, PricePath(code_));
  const std::int32_t recNo = RecordBefore(edit.records(), date);
  if (recNo < 2) return;
  const std::string desc = a.units() < 0 ? "ss" : "bi";
  Status(desc + "  Adjustment :" + code_);
  Scale(edit, recNo, CSng(Val(Format(factor.ToDouble(), "#####.######"))), desc);
}

// DI. A dividend that is not below the close leaves no price to scale to.
void Action::PayDividend() {
  const Currency amount(Val(row_.Field(kAdj9)) / 100);
  const std::string date = BulletinDate(row_.Field(kAdjName));
  if (date.empty() || !HasPrices(code_)) return;
  PriceEdit edit(place_.files, PricePath(code_));
  const std::int32_t recNo = RecordBefore(edit.records(), date);
  if (recNo < 2) return;
  const float AdjClose = edit.records()[size_t(recNo - 1)].Close;
  if (amount.units() <= 0 || !(AdjClose > 0)) return;
  const float factor =
      CSng(Val(Format(CSng(1 - amount.ToDouble() / double(AdjClose)), "#####.######")));
  if (!(factor > 0)) return;
  const std::string desc = "dv" + Str(amount.ToDouble());
  Status("dv  Adjustment :" + code_);
  Scale(edit, recNo, factor, desc);
}

// The values of "O:1.20 H:1.25 L:1.18 C:1.22 V:12000": each goes on to the next tag, of which a
// blank and a letter stand in front of the colon.
double TagValue(const std::string& text, std::string_view tag) {
  const size_t at = text.find(tag);
  if (at == std::string::npos) return 0;
  const size_t from = at + tag.size();
  size_t to = text.find(':', from);
  to = to == std::string::npos ? text.size() : to - std::min<size_t>(2, to - from);
  return double(ParseFloat(Trim(std::string_view(text).substr(from, to - from))).value_or(0));
}

// PC.
void Action::ChangePrices() {
  const std::string text = UCase(row_.Field(kAdj7));
  if (text.find(':') == std::string::npos) return;
  std::array<double, 4> wanted{TagValue(text, "O:"), TagValue(text, "H:"), TagValue(text, "L:"),
                               TagValue(text, "C:")};
  double volume = TagValue(text, "V:");
  const std::string date = BulletinDate(row_.Field(kAdjName));
  const auto above0 = [](double value) { return value > 0; };
  if (date.empty() || (std::none_of(wanted.begin(), wanted.end(), above0) && !above0(volume)) ||
      !HasPrices(code_))
    return;
  const std::string market = UCase(row_.Field(kAdjFile));
  double divisor = 1, factor = 1, volumeFactor = 1;
  if (market == "OVS") {
    factor = 0.01;
    if (const auto defined =
            FindDefinition(place_.files, place_.systemFolder + "WMMAIN.OVS", code_)) {
      if (defined->pricePower) {
        factor = PowerOfTen(*defined->pricePower);
        volumeFactor = defined->volumePower ? PowerOfTen(*defined->volumePower) : 0;
      } else {
        volumeFactor = 0;
      }
    }
  } else {
    if (place_.wholeMarket) divisor = market == "IDX" ? 10 : 100;
    volumeFactor = market == "IDX" ? place_.indexVolumeFactor : place_.volumeFactor;
  }
  volume *= volumeFactor;
  std::vector<PriceRec> prices = Prices(code_);
  bool changed = false;
  for (auto day = prices.rbegin(); day != prices.rend(); ++day) {
    const double at = Val(day->RecDate.raw());
    if (at > Val(date)) continue;
    if (at < Val(date)) break;
    // By value: the records are packed, and a price in them may not be aligned.
    float stored[] = {day->Open, day->High, day->Low, day->Close};
    for (size_t i = 0; i < wanted.size(); ++i) {
      const float value = CSng(wanted[i] * factor / divisor);
      if (value == 0 || value == stored[i]) continue;
      stored[i] = value;
      changed = true;
    }
    day->Open = stored[0];
    day->High = stored[1];
    day->Low = stored[2];
    day->Close = stored[3];
    if (const std::int32_t value = CLng(volume); value != 0 && value != day->Volume) {
      day->Volume = value;
      changed = true;
    }
    break;
  }
  Status("Price Changes for " + code_);
  if (changed) WritePrices(code_, prices);
}

bool Action::Run() {
  if (!IsFileCode(code_)) return false;
  const std::string act = row_.Action();
  if (act == "NI" || act == "NL") AddName();
  if (act == "NC") ChangeName();
  if (act == "DC") RemoveSecurity();
  if (act == "BI" || act == "SP") IssueBonus();
  if (act == "DI") PayDividend();
  if (act == "PC") ChangePrices();
  return any_;
}

}  // namespace

bool AddAction(const ActionPlace& place, const AdjustRow& row, FileSet& changes) {
  return Action(place, row, changes).Run();
}

}  // namespace kora
