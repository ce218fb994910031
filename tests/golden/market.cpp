#include "tests/golden/market.h"

#include <cmath>
#include <stdexcept>

#include "base/dates.h"
#include "store/price_rec.h"

namespace kora::test {
namespace {

// To the tick, in whole ticks, so that the bytes are the same everywhere.
float ToTick(float value, float step) {
  const float ticks = std::nearbyint(value / step);
  return (ticks < 1 ? 1 : ticks) * step;
}

}  // namespace

GoldenMarket::GoldenMarket() {
  home_.Put("drive_c/korawin/IndClass.dat", "110,Gold\r\n120,Coal\r\n310,Banks\r\n");
  Add("SHARE", "Sharing Holdings Ltd", kShare, 18.0f, 0.01f, 900, 7);
  Add("PENNY", "Penny Minerals NL", kShare, 0.09f, 0.001f, 500, 11);
  Add("INDEX", "All Things Index", kIndex, 3200.0f, 0.1f, 900, 3);
  Add("ADVDEC", "Advances and Declines", kAdvanceDecline, 800.0f, 1.0f, 400, 5);
  Add("FUND", "Fund of Funds", kCloseVolume, 1.5f, 0.005f, 400, 13);
  AddWrap();
  Add("BLUE", "Blue Chip Industries Ltd", kShare, 700.0f, 0.01f, 900, 17, 2021, 700);
  Add("HEIGHT", "Dizzy Height Index", kIndex, 24000.0f, 0.1f, 500, 19, 2021, 20);
  Add("AGES", "Rock of Ages Ltd", kShare, 6.0f, 0.01f, 5700, 23, 2002, 30);
  names_[0].OtherDetails.set("ORD SHARES");
  names_[0].IndClass.set("310");
  names_[0].Base = 10;
  names_[0].Top = 40;
  names_[0].BandUp = 7;
  names_[0].BandDown = 6;
  names_[1].IndClass.set("110");
}

const NameRec& GoldenMarket::name(const std::string& code) const {
  for (const NameRec& rec : names_)
    if (rec.Code.trimmed() == code) return rec;
  throw std::runtime_error("no " + code);
}

// Big swings, then small ones that turn from the grid of the bar which a narrow chart starts at,
// and not from that of the first bar.
void GoldenMarket::AddWrap() {
  names_.push_back(NewNameRec("WRAP"));
  names_.back().Name.set("Wrapping Paper Ltd");
  names_.back().RecType = kShare;
  std::vector<PriceRec> records;
  for (int i = 0; i < 50; ++i) {
    PriceRec rec = NewPriceRec(FormatFileDate(DateOfDayNumber(DayNumber({2023, 3, 1}) + 9 * i)));
    const float close = i == 0 ? 20 : i < 20 ? (i % 2 ? 30 : 20.6f) : (i % 2 ? 27.7f : 24.5f);
    rec.Open = rec.High = rec.Low = rec.Close = close;
    records.push_back(rec);
  }
  home_.Put("drive_c/korawin/data/WRAP.WDT",
            {reinterpret_cast<const char*>(records.data()), records.size() * sizeof(PriceRec)});
}

void GoldenMarket::Add(const char* code, const char* title, std::int16_t type, float start,
                       float step, int days, std::uint32_t seed, int firstYear, std::int32_t lot) {
  NameRec name = NewNameRec(code);
  name.Name.set(title);
  name.RecType = type;
  names_.push_back(name);

  std::vector<PriceRec> records;
  std::uint32_t state = seed;
  const auto draw = [&state] {  // -1 to 1
    state = state * 1664525u + 1013904223u;
    return float(int(state >> 16) - 32768) / 32768.0f;
  };
  float close = start;
  float total = 60;
  for (std::int32_t n = DayNumber({firstYear, 3, 1}); int(records.size()) < days; ++n) {
    const CalendarDate date = DateOfDayNumber(n);
    const int weekday = Weekday(date);
    if (weekday == 1 || weekday == 7 || (date.month == 12 && date.day == 25)) continue;
    const int i = int(records.size());
    PriceRec rec = NewPriceRec(FormatFileDate(date));
    const float trend = i % 300 < 190 ? 0.0011f : -0.0016f;
    const float open = close * (1 + draw() * 0.006f);
    close = close * (1 + trend + draw() * 0.021f);
    const float high = (open > close ? open : close) * (1 + (draw() + 1) * 0.006f);
    const float low = (open < close ? open : close) * (1 - (draw() + 1) * 0.006f);
    const float burst = draw();
    const auto volume =
        std::int32_t(4000.0f + 3000.0f * draw() + (burst > 0.96f ? 30000.0f : 0)) * lot;
    if (type == kAdvanceDecline) {
      rec.High = std::nearbyint(400 + 200 * draw());
      rec.Low = std::nearbyint(400 + 200 * draw());
      total += rec.High - rec.Low;
      rec.Close = total;
      rec.Volume = volume;
    } else {
      rec.Open = ToTick(open, step);
      rec.High = ToTick(high, step);
      rec.Low = ToTick(low, step);
      rec.Close = ToTick(close, step);
      rec.Volume = volume;
      if (type == kCloseVolume) rec.Open = rec.High = rec.Low = rec.Close;
      if (type == kShare && i % 97 == 40) rec.Open = rec.High = rec.Low = 0;  // a close alone
      if (type == kShare && i % 211 == 150) {                                 // no trade at all
        rec.Open = rec.High = rec.Low = rec.Close = 0;
        rec.Volume = 0;
      }
      if (type == kShare && i % 250 == 220) {
        rec.AdjFactor = 0.9f;
        rec.AdjDesc.set("1:10 BONUS");
      }
    }
    records.push_back(rec);
  }
  home_.Put(std::string("drive_c/korawin/data/") + code + ".WDT",
            {reinterpret_cast<const char*>(records.data()), records.size() * sizeof(PriceRec)});
}

}  // namespace kora::test
