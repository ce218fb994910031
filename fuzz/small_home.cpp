#include "fuzz/small_home.h"

#include "base/dates.h"
#include "base/text.h"
#include "store/name_rec.h"
#include "store/price_rec.h"

namespace kora::test {
namespace {

const std::string kRoot = "home/drive_c/korawin/";

PriceRec Day(std::string_view date, float close, std::int32_t volume, float factor = 0) {
  PriceRec rec = NewPriceRec(date);
  rec.Open = close;
  rec.High = close * 2;
  rec.Low = close / 2;
  rec.Close = close;
  rec.Volume = volume;
  rec.AdjFactor = factor;
  return rec;
}

bool Fits(std::string_view path, std::string_view name) {
  const size_t star = name.find('*');
  if (star == std::string_view::npos) return EqualNoCase(path, name);
  const std::string_view front = name.substr(0, star), end = name.substr(star + 1);
  return path.size() >= front.size() + end.size() &&
         EqualNoCase(path.substr(0, front.size()), front) && EndsNoCase(path, end) &&
         path.find('/', front.size()) == std::string_view::npos;
}

}  // namespace

SmallHome::SmallHome() {
  for (const char* folder : {"data/", "download/", "service/", "in/", "out/", "chtmisc/"})
    io.Put(kRoot + folder + "x", "");
  for (const char* folder : {"data/", "download/", "service/", "in/", "out/", "chtmisc/"})
    io.Remove(kRoot + folder + "x");
  settings.paths.WindowsPath = "C:\\WINDOWS\\";
  SetDefaultPaths(settings.paths, "c:");
  settings.download.DLPath = system + "download\\";
  settings.download.ServiceSystem = system + "service\\";
  settings.download.ServiceIn = system + "in\\";
  settings.download.ServiceOut = system + "out\\";
}

void SmallHome::Put(std::string_view name, std::string_view bytes) {
  io.Put(kRoot + std::string(name), bytes);
}

std::string SmallHome::Get(std::string_view name) const {
  return io.Get(kRoot + std::string(name));
}

void SmallHome::PutMarket() {
  std::vector<NameRec> names;
  const auto add = [&](std::string_view code, std::int16_t type, std::int16_t category,
                       const std::vector<PriceRec>& days) {
    NameRec rec = NewNameRec(code);
    rec.RecType = type;
    rec.Category = category;
    rec.Name.set("Name of " + std::string(code));
    names.push_back(rec);
    Put("data/" + std::string(code) + ".WDT", BytesOf(days));
  };
  add("ADV", kAdvanceDecline, 3, {Day("19980911", 100, 0), Day("19980914", 110, 0)});
  add("IDX", kIndex, 2, {Day("19980911", 2500, 0), Day("19980914", 2510.5f, 0)});
  add("ORE", kShare, 1,
      {Day("19980910", 1, 100), Day("19980911", 1.25f, 200, 0.8f), Day("19980914", 1.3f, 300)});
  add("OREWAA", kShare, 84, {Day("19980914", 0.2f, 50)});
  Put("data/Names.dat", BytesOf(names));
}

std::string ManyDays() {
  std::vector<PriceRec> days;
  CalendarDate date{1998, 1, 5};
  for (int n = 0; n < 60; ++n) {
    days.push_back(
        Day(FormatFileDate(date), 2 + 0.1f * float(n % 7) - 0.05f * float(n % 11), 100 * (n % 13)));
    date = DateOfDayNumber(DayNumber(date) + (n % 5 == 4 ? 3 : 1));
  }
  return BytesOf(days);
}

void SmallHome::OnlyChanged(const std::map<std::string, std::string>& before,
                            const std::vector<std::string>& names) const {
  const auto after = io.Store();
  const auto allowed = [&](const std::string& path) {
    if (path.rfind(kRoot, 0) != 0) return false;
    for (const std::string& name : names)
      if (Fits(std::string_view(path).substr(kRoot.size()), name)) return true;
    return false;
  };
  for (const auto& [path, bytes] : after) {
    Promise(!path.ends_with('~'), "nothing temporary is left");
    const auto old = before.find(path);
    if (old == before.end() || old->second != bytes)
      Promise(allowed(path), "only files of the reader's own change");
  }
  for (const auto& [path, bytes] : before)
    if (!after.contains(path)) Promise(allowed(path), "only files of the reader's own go");
}

}  // namespace kora::test
