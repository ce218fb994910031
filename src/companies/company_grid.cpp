#include "companies/company_grid.h"

#include <cctype>
#include <unordered_map>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "lists/chart_list.h"
#include "store/name_file.h"
#include "store/price_rec.h"

namespace kora {
namespace {

constexpr size_t kMostTold = 20;

}  // namespace

std::vector<CompanyRow> LoadCompanies(const CompanyStore& store, const Files& files,
                                      const std::string& dataPath) {
  std::unordered_map<std::string, std::int32_t> places;
  const std::vector<NameRec> names = ReadNames(files, dataPath);
  for (size_t i = 0; i < names.size(); ++i)
    places.try_emplace(FromAnsi(Trim(names[i].Code.trimmed())), std::int32_t(i + 1));
  std::vector<CompanyRow> rows;
  rows.reserve(store.codes().size());
  for (const std::string& code : store.codes()) {
    CompanyRow row{.code = code, .fields = store.Fields(store.Find(code))};
    if (const auto place = places.find(code); place != places.end()) {
      const NameRec& rec = names[size_t(place->second - 1)];
      row.nameRec = place->second;
      row.name = FromAnsi(Trim(rec.Name.trimmed()));
      const std::string_view id = Trim(rec.IndClass.trimmed());
      if (!id.empty()) row.IndClass = Format(Val(id), "000");
    }
    rows.push_back(std::move(row));
  }
  return rows;
}

std::vector<std::string> CompanyHeadings(const CompanyStore& store) {
  std::vector<std::string> out{"Code", "Name", "Ind Class", "Last Price", "Price $", "Yield %"};
  out.insert(out.end(), store.labels().begin(), store.labels().end());
  return out;
}

std::vector<std::string> CompanyCells(const CompanyRow& row) {
  std::vector<std::string> out{row.code,     row.name,  row.IndClass,
                               row.lastDate, row.price, row.yield};
  out.insert(out.end(), row.fields.begin(), row.fields.end());
  return out;
}

YieldEnd CalculateYields(const CompanyStore& store, const Files& files, const std::string& dataPath,
                         Progress& progress, std::vector<CompanyRow>& rows) {
  YieldEnd end;
  std::vector<CompanyRow> fresh = rows;
  int done = 0;
  for (CompanyRow& row : fresh) {
    if (!progress.Step(++done, int(fresh.size()))) return {.stopped = true, .missing = {}};
    row.lastDate = row.price = row.yield = "";
    float price = 0;
    try {
      const PriceFile file(files, dataPath + CodeFileName(row.code, ".WDT"));
      const PriceRec last = file.Read(file.count());
      price = last.Close;
      row.lastDate = DateToDisplay(last.RecDate.raw());
      row.price = Format(price, "0.00#");
    } catch (const RunTimeError&) {
      end.missing.push_back(row.code);
      continue;
    }
    const double dividends = DividendsOf(store, row.code).Sum();
    if (dividends > 0 && price > 0)
      row.yield = Format(dividends / double(price) * 100, "#.00#") + " %";
  }
  rows = std::move(fresh);
  return end;
}

std::string MissingText(const std::vector<std::string>& missing) {
  std::string text;
  for (size_t i = 0; i < missing.size() && i < kMostTold; ++i)
    text += (i ? "\n" : "") + std::string("NO DATA FOR ") + missing[i];
  if (missing.size() > kMostTold)
    text += "\nand " + Str(std::int32_t(missing.size() - kMostTold)) + " others";
  return text;
}

int TransferDetails(const Files& files, const std::string& dataPath,
                    const std::vector<Transfer>& details) {
  std::unordered_map<std::string, const std::string*> values;
  for (const Transfer& one : details) values[one.code] = &one.value;
  const auto held = files.lock().Hold();
  std::vector<NameRec> names = ReadNames(files, dataPath);
  int written = 0;
  for (NameRec& rec : names) {
    const auto value = values.find(FromAnsi(Trim(rec.Code.trimmed())));
    if (value == values.end()) continue;
    rec.OtherDetails.set(AsOtherDetails(*value->second));
    ++written;
  }
  if (written > 0)
    files.WriteAll(NameFilePath(dataPath),
                   {reinterpret_cast<const char*>(names.data()), names.size() * sizeof(NameRec)});
  return written;
}

bool CellBefore(const std::string& a, const std::string& b) {
  const std::string_view texts[] = {Trim(a), Trim(b)};
  const auto isNumber = [](std::string_view text) {
    return !text.empty() &&
           (std::isdigit(static_cast<unsigned char>(text[0])) || text[0] == '.' || text[0] == '-');
  };
  const bool numbers[] = {isNumber(texts[0]), isNumber(texts[1])};
  if (numbers[0] != numbers[1]) return numbers[0];
  if (numbers[0]) return Val(texts[0]) < Val(texts[1]);
  return LCase(texts[0]) < LCase(texts[1]);
}

void WriteCompanyList(const Files& files, const std::string& dataPath,
                      const std::vector<CompanyRow>& rows) {
  std::vector<ListRec> list;
  for (const CompanyRow& row : rows) {
    if (row.nameRec == 0) continue;
    ListRec rec;
    rec.ListRecNo = CInt(row.nameRec);
    rec.ListCode.set(row.code);
    list.push_back(rec);
  }
  const auto held = files.lock().Hold();
  WriteList(files, dataPath, kResultList, list);
}

}  // namespace kora
