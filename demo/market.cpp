#include "demo/market.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "base/currency.h"
#include "base/numbers.h"
#include "demo/calendar.h"

namespace kora::demo {
namespace {

const CalendarDate kLastDay{2026, 10, 30};

// One stretch of the market's mood.
struct Regime {
  double drift;
  double volatility;
  int shortest, longest;  // days
};
enum Mood { kBull, kSideways, kBear, kCrash, kRecovery };
constexpr Regime kRegimes[] = {
    {0.0007, 0.0065, 90, 320}, {0.0001, 0.0060, 40, 160}, {-0.0009, 0.0110, 40, 170},
    {-0.0150, 0.0240, 6, 18},  {0.0023, 0.0150, 25, 70},
};

Mood NextMood(Mood mood, Random& random) {
  const int n = random.Below(100);
  switch (mood) {
    case kBull: return n < 45 ? kSideways : n < 80 ? kBear : kCrash;
    case kSideways: return n < 70 ? kBull : kBear;
    case kBear: return n < 35 ? kCrash : n < 70 ? kSideways : kBull;
    case kCrash: return kRecovery;
    case kRecovery: return n < 70 ? kBull : kSideways;
  }
  return kBull;
}

// Volatility that comes in clusters: large moves are followed by large moves.
class Clustered {
 public:
  double Next(double volatility, Random& random) {
    const double z = random.Noise() * std::sqrt(0.25 + 0.75 * level_);
    level_ = std::min(6.0, 0.90 * level_ + 0.10 * z * z);
    return volatility * z;
  }

 private:
  double level_ = 1;
};

double Hold(double value, double low, double high) { return std::clamp(value, low, high); }

// Volumes of shares are in hundreds, as data services deliver them.
constexpr double kSharesPerUnit = 100;

std::int32_t ToVolume(double volume) { return std::int32_t(std::floor(Hold(volume, 1.0, 2.0e9))); }

PriceRec Flat(const std::string& date, float close) {
  PriceRec rec = NewPriceRec(date);
  rec.Open = rec.High = rec.Low = rec.Close = close;
  return rec;
}

// What the tiers differ in.
struct TierFigures {
  double volatility, beta, turnover;  // of a day, dollars
  double noTrade;                     // chance of a day without a trade
  double low, high;                   // prices that the share keeps to, roughly
};
constexpr TierFigures kTiers[] = {
    {0.010, 1.00, 4.0e7, 0, 4.0, 70.0},
    {0.015, 0.90, 3.0e6, 0.001, 0.8, 20.0},
    {0.023, 0.80, 3.0e5, 0.02, 0.12, 4.0},
    {0.038, 0.70, 4.0e4, 0.10, 0.008, 0.20},
};

struct Adjustment {
  size_t record;  // the last in old terms
  float factor;
  std::string text;
};

// An adjustment of a share that last closed at `close`, in thousandths.
Adjustment MakeAdjustment(Planned kind, int close, Random& random) {
  const double price = close / 1000.0;
  double factor = 1;
  std::string text;
  if (kind == Planned::kSplit) {
    // A share that costs next to nothing is consolidated.
    const int news = price < 0.1 ? 1 : price > 60 ? 4 : 2;
    const int olds = price < 0.1 ? 10 : 1;
    factor = double(olds) / news;
    text = "ss" + Str(std::int32_t(news)) + ":" + Str(std::int32_t(olds));
  } else {
    static constexpr int kHeld[] = {4, 5, 8, 10, 20};
    const int held = kHeld[random.Below(5)];
    if (kind == Planned::kBonus) {
      factor = double(held) / (1 + held);
      text = "bi1:" + Str(std::int32_t(held));
    } else {
      // New shares at about four fifths of the price, in whole steps.
      const int cents = std::max(1, int(price * 80));
      const double cost = cents / 100.0;
      const double theoretical = (cost + held * price) / (1 + held);
      factor = 1 - (price - theoretical) / price;
      text = "ci1:" + Str(std::int32_t(held)) + " @ " + Str(cost);
    }
  }
  return {0, float(Val(Format(float(factor), "#####.######"))), text};
}

void Apply(const Adjustment& adjustment, std::vector<PriceRec>& records) {
  records[adjustment.record].AdjFactor = adjustment.factor;
  records[adjustment.record].AdjDesc.set(adjustment.text);
  const auto scaled = [&adjustment](float price) {
    return float(Currency(double(price) * double(adjustment.factor)).ToDouble());
  };
  for (size_t i = 0; i <= adjustment.record; ++i) {
    PriceRec& rec = records[i];
    rec.Open = scaled(rec.Open);
    rec.High = scaled(rec.High);
    rec.Low = scaled(rec.Low);
    rec.Close = scaled(rec.Close);
  }
}

}  // namespace

int TickOf(int thousandths) { return thousandths < 100 ? 1 : thousandths < 2000 ? 5 : 10; }

int ToThousandths(double price) {
  const double n = std::floor(Hold(price, 0.0, 100000.0) * 1000 + 0.5);
  const int tick = TickOf(int(n));
  return std::max(1, int(std::floor(price * 1000 / tick + 0.5)) * tick);
}

float FromThousandths(int thousandths) { return float(thousandths / 1000.0); }

Days::Days(int years, int waitingDays) {
  const CalendarDate after = {kLastDay.year - years, kLastDay.month, kLastDay.day};
  dates = TradingDays(after, kLastDay);
  history = int(dates.size());
  for (const CalendarDate& date : NextTradingDays(kLastDay, waitingDays)) dates.push_back(date);
  for (const CalendarDate& date : dates) {
    texts.push_back(FormatFileDate(date));
    numbers.push_back(DayNumber(date));
  }
}

Factors MakeFactors(const Days& days, std::uint64_t seed) {
  Factors factors;
  Random random(seed, 2);
  Clustered cluster;
  Mood mood = kBull;
  int left = 0;
  double level = 1, trend = 1;
  for (int day = 0; day < days.count(); ++day) {
    if (left-- <= 0) {
      if (day > 0) mood = NextMood(mood, random);
      left =
          kRegimes[mood].shortest + random.Below(kRegimes[mood].longest - kRegimes[mood].shortest);
    }
    // Long histories neither vanish nor reach the sky.
    trend *= 1.00025;
    const double pull = Hold(0.001 * (trend / level - 1), -0.0012, 0.0012);
    const double noise = cluster.Next(kRegimes[mood].volatility, random);
    const double move = Hold(kRegimes[mood].drift + pull + noise, -0.12, 0.10);
    level *= 1 + move;
    factors.market.push_back(move);
  }
  for (int s = 0; s < kSectors; ++s) {
    Random own(seed, 10 + std::uint64_t(s));
    Clustered clusters;
    double drift = 0, relative = 1;
    int stay = 0;
    for (int day = 0; day < days.count(); ++day) {
      if (stay-- <= 0) {
        stay = 40 + own.Below(160);
        drift = own.Noise() * 0.0004;
      }
      const double move = drift + 0.002 * (1 / relative - 1) + clusters.Next(0.006, own);
      relative *= 1 + move;
      factors.sector[size_t(s)].push_back(move);
    }
  }
  return factors;
}

ShareProfile MakeProfile(int index, int shares, const Days& days, Random& random) {
  ShareProfile share;
  const int leaders = std::max(2, shares / 8);
  const int middle = leaders + std::max(1, shares * 3 / 10);
  const int small = middle + shares * 3 / 10;
  share.tier = index < leaders  ? Tier::kLeader
               : index < middle ? Tier::kMiddle
               : index < small  ? Tier::kSmall
                                : Tier::kPenny;
  const TierFigures& figures = kTiers[int(share.tier)];

  // The first shares give every sector one that was there all the time, for its index.
  const bool founding = index < kSectors;
  share.sector = founding ? index : random.Below(kSectors);
  share.last = days.count() - 1;
  const double fate = random.Unit();
  const double when = random.Unit();
  if (!founding) {
    // A new float has at least some weeks of prices, and some shares are quoted no longer.
    const int span = days.history;
    if (fate < 0.10 || index == shares - 2)
      share.first = int(span * (0.15 + 0.65 * when));
    else if (fate < 0.14 || index == shares - 3)
      share.last = int(span * (0.45 + 0.45 * when));
  }
  if (index < 3) {
    static constexpr Planned kFirst[] = {Planned::kBonus, Planned::kSplit, Planned::kCash};
    share.planned = kFirst[index];
  }

  // Most begin in the lower part of their range.
  const double place = random.Unit();
  share.startPrice = figures.low + (figures.high - figures.low) * (0.05 + 0.4 * place * place);
  share.issued = figures.turnover * random.Between(150, 500) / share.startPrice;
  return share;
}

Series SimulateShare(const ShareProfile& share, const Factors& factors, const Days& days,
                     Random& random) {
  const TierFigures& figures = kTiers[int(share.tier)];
  const double beta = figures.beta * random.Between(0.7, 1.3);
  const double volatility = figures.volatility * random.Between(0.8, 1.3);
  const double turnover = figures.turnover * random.Between(0.4, 1.8);
  const std::vector<double>& sector = factors.sector[size_t(share.sector)];
  const int length = share.last - share.first + 1;
  const int plannedDay = share.first + int(length * random.Between(0.35, 0.75));

  Series series;
  series.first = share.first;
  series.records.reserve(size_t(length));
  std::vector<Adjustment> adjustments;

  Clustered cluster;
  double price = share.startPrice;  // where trading would be if there were any
  int close = ToThousandths(price);
  double trend = 0, activity = 1, jump = 0;
  int trendLeft = 0, haltLeft = 0, sinceAdjustment = 0;
  bool plannedDone = share.planned == Planned::kNone;

  for (int day = share.first; day <= share.last; ++day, ++sinceAdjustment) {
    if (trendLeft-- <= 0) {
      trendLeft = 25 + random.Below(140);
      trend = random.Noise() * volatility * 0.06;
    }
    double own = cluster.Next(volatility, random);
    if (random.Chance(0.006)) own *= 3;  // news
    double move = beta * factors.market[size_t(day)] + sector[size_t(day)] + own + trend + jump +
                  0.5 * volatility * volatility;
    if (price > figures.high) move -= 0.0015;
    if (price < figures.low) move += 0.0025;
    move = Hold(move, -0.45, 0.60);
    price = std::max(0.002, price * (1 + move));
    jump = 0;

    const std::string& date = days.texts[size_t(day)];
    const double last = close / 1000.0;
    const double luck = random.Unit();
    if (haltLeft == 0 && luck < 0.0005 && day > share.first) haltLeft = 2 + random.Below(9);

    if (haltLeft > 0) {
      series.records.push_back(Flat(date, FromThousandths(close)));
      price = last;
      if (--haltLeft == 0) jump = random.Noise() * 0.12;
    } else if (luck > 1 - figures.noTrade && day > share.first) {
      PriceRec rec = Flat(date, FromThousandths(close));
      // Now and then the source knew the closing price alone.
      if (random.Chance(0.05)) rec.Open = rec.High = rec.Low = 0;
      series.records.push_back(rec);
    } else {
      const double gapPart = random.Between(0.15, 0.65);
      const double openNoise = random.Noise() * volatility * 0.25;
      const double upper = 1 + volatility * 0.6 * random.Unit();
      const double lower = 1 - volatility * 0.6 * random.Unit();
      const double openAt = last * (1 + (price / last - 1) * gapPart + openNoise);
      const int open = ToThousandths(std::max(openAt, last * 0.4));
      const int closing = ToThousandths(price);
      const int high = std::max({open, closing, ToThousandths(std::max(openAt, price) * upper)});
      const int low = std::min({open, closing, ToThousandths(std::min(openAt, price) * lower)});
      close = closing;

      activity = 0.85 * activity + 0.15 * random.Between(0.3, 1.7);
      const double surprise = std::fabs(move) / volatility;
      const double spike = 1 + 0.5 * std::min(surprise * surprise, 16.0);
      const double grain = random.Between(0.6, 1.4);

      PriceRec rec = NewPriceRec(date);
      rec.Open = FromThousandths(open);
      rec.High = FromThousandths(high);
      rec.Low = FromThousandths(low);
      rec.Close = FromThousandths(close);
      rec.Volume = ToVolume(turnover * activity * spike * grain * 0.6 / price / kSharesPerUnit);
      if (luck < 0.0012) rec.Open = rec.High = rec.Low = 0;
      series.records.push_back(rec);
    }

    // Adjustments take effect overnight, never close to the ends of the history.
    const double event = random.Unit();
    if (haltLeft > 0 || day < share.first + 20 || day > days.history - 40 || day == share.last)
      continue;
    Planned kind = Planned::kNone;
    if (!plannedDone && day >= plannedDay) {
      kind = share.planned;
      plannedDone = true;
    } else if (sinceAdjustment > 250) {
      const bool extreme = close > 40000 || (share.tier == Tier::kPenny && close < 9);
      if (extreme && event < 0.05)
        kind = Planned::kSplit;
      else if (!extreme && close >= 200 && event < 0.00012)
        kind = Planned::kBonus;
      else if (!extreme && close >= 200 && event < 0.00024)
        kind = Planned::kCash;
    }
    if (kind == Planned::kNone) continue;
    Adjustment adjustment = MakeAdjustment(kind, close, random);
    adjustment.record = series.records.size() - 1;
    price *= double(adjustment.factor);
    close = ToThousandths(close / 1000.0 * double(adjustment.factor));
    adjustments.push_back(std::move(adjustment));
    sinceAdjustment = 0;
  }
  for (const Adjustment& adjustment : adjustments) Apply(adjustment, series.records);
  return series;
}

MarketSums::MarketSums(int days) : rises_(size_t(days)), falls_(size_t(days)) {
  const auto clear = [days](Sums& sums) {
    for (auto* v : {&sums.before, &sums.open, &sums.high, &sums.low, &sums.close, &sums.volume})
      v->assign(size_t(days), 0);
  };
  clear(all_);
  for (Sums& sums : sectors_) clear(sums);
}

void MarketSums::AddDay(Sums& sums, int day, double units, const PriceRec& last,
                        const PriceRec& now) {
  const size_t d = size_t(day);
  const bool closeOnly = now.High == 0;
  sums.before[d] += units * double(last.Close);
  sums.open[d] += units * double(closeOnly ? now.Close : now.Open);
  sums.high[d] += units * double(closeOnly ? now.Close : now.High);
  sums.low[d] += units * double(closeOnly ? now.Close : now.Low);
  sums.close[d] += units * double(now.Close);
  sums.volume[d] += double(now.Volume);
}

void MarketSums::Add(const ShareProfile& share, const Series& series) {
  // The prices are in the newest terms, so the shares on issue have to be.
  double issued = share.issued;
  for (const PriceRec& rec : series.records)
    if (rec.AdjFactor != 0) issued /= double(rec.AdjFactor);
  for (size_t i = 1; i < series.records.size(); ++i) {
    const PriceRec& last = series.records[i - 1];
    const PriceRec& now = series.records[i];
    const int day = series.first + int(i);
    AddDay(all_, day, issued, last, now);
    AddDay(sectors_[size_t(share.sector)], day, issued, last, now);
    if (now.Close > last.Close) ++rises_[size_t(day)];
    if (now.Close < last.Close) ++falls_[size_t(day)];
  }
}

Series MarketSums::Index(int sector, const Days& days) const {
  return MakeIndex(sector < 0 ? all_ : sectors_[size_t(sector)], days);
}

// Chained from day to day over the shares that both days had, so that a new float or an end of
// quotation does not move it.
Series MarketSums::MakeIndex(const Sums& sums, const Days& days) const {
  const auto tenths = [](double points) { return float(std::floor(points * 10 + 0.5) / 10.0); };
  Series series;
  double level = 1000;
  series.records.push_back(Flat(days.texts[0], tenths(level)));
  for (size_t d = 1; d < size_t(days.count()); ++d) {
    const double scale = level / sums.before[d];
    const double open = sums.open[d] * scale, close = sums.close[d] * scale;
    // Shares do not reach their extremes together.
    const double top = std::max(open, close), bottom = std::min(open, close);
    PriceRec rec = NewPriceRec(days.texts[d]);
    rec.Open = tenths(open);
    rec.High = tenths(top + 0.4 * std::max(0.0, sums.high[d] * scale - top));
    rec.Low = tenths(bottom - 0.4 * std::max(0.0, bottom - sums.low[d] * scale));
    rec.Close = tenths(close);
    rec.Volume = ToVolume(sums.volume[d] * kSharesPerUnit / 1000);
    series.records.push_back(rec);
    level = close;
  }
  return series;
}

Series MarketSums::AdvanceDecline(const Days& days) const {
  // The total starts at the lowest thousand that keeps all of it above 0, since a close of 0
  // means no close.
  int total = 0, lowest = 0;
  for (size_t d = 0; d < rises_.size(); ++d) {
    total += rises_[d] - falls_[d];
    lowest = std::min(lowest, total);
  }
  total = (-lowest / 1000 + 1) * 1000;
  Series series;
  for (size_t d = 0; d < rises_.size(); ++d) {
    total += rises_[d] - falls_[d];
    PriceRec rec = NewPriceRec(days.texts[d]);
    rec.High = float(rises_[d]);
    rec.Low = float(falls_[d]);
    rec.Close = float(total);
    rec.Volume = ToVolume(all_.volume[d] * kSharesPerUnit / 1000);
    series.records.push_back(rec);
  }
  return series;
}

Series SimulateRight(const Right& right, const Series& share, int first, const Days& days,
                     Random& random) {
  Series series;
  series.first = first;
  const double yearly = random.Between(0.22, 0.38);
  const double liquidity = random.Between(0.01, 0.04);
  int last = 0;
  for (int day = first; day <= share.last() && days.numbers[size_t(day)] <= right.expiry; ++day) {
    const PriceRec& under = share.records[size_t(day - share.first)];
    const double years = (right.expiry - days.numbers[size_t(day)]) / 365.0;
    // Worth half of what it is in the money at least, and the rest of it with the time left:
    // exact at expiry and about right at the money.
    const auto worth = [&](float at) {
      const double inside = right.call ? double(at) - right.strike : right.strike - double(at);
      const double time = 0.8 * yearly * double(at) * std::sqrt(years);
      return ToThousandths(0.5 * (inside + std::sqrt(inside * inside + time * time)) / right.ratio);
    };
    const double luck = random.Unit();
    const double grain = random.Between(0.3, 1.7);
    const std::string& date = days.texts[size_t(day)];
    if (under.Volume == 0 || under.High == 0 || (luck < 0.12 && day > first)) {
      if (last == 0) last = worth(under.Close);
      series.records.push_back(Flat(date, FromThousandths(last)));
      continue;
    }
    last = worth(under.Close);
    const int open = worth(under.Open);
    const int high = worth(right.call ? under.High : under.Low);
    const int low = worth(right.call ? under.Low : under.High);
    PriceRec rec = NewPriceRec(date);
    rec.Open = FromThousandths(open);
    rec.High = FromThousandths(std::max({high, open, last}));
    rec.Low = FromThousandths(std::min({low, open, last}));
    rec.Close = FromThousandths(last);
    rec.Volume = ToVolume(double(under.Volume) * liquidity * grain);
    series.records.push_back(rec);
  }
  return series;
}

Series SimulateFund(const Series& index, const Days& days, Random& random) {
  Series series;
  double price = random.Between(1, 8);
  const double share = random.Between(0.4, 0.9);
  const double units = random.Between(2.0e4, 2.0e5);
  for (int day = 0; day < days.count(); ++day) {
    if (day > 0) {
      const double move =
          double(index.records[size_t(day)].Close) / double(index.records[size_t(day - 1)].Close) -
          1;
      price *= 1 + share * move + random.Noise() * 0.0015;
    }
    PriceRec rec = Flat(days.texts[size_t(day)], FromThousandths(ToThousandths(price)));
    rec.Volume = ToVolume(units * random.Between(0.2, 1.8));
    series.records.push_back(rec);
  }
  return series;
}

Series SimulateRate(const Days& days, Random& random) {
  Series series;
  double rate = random.Between(3, 6);
  double aim = rate;
  for (int day = 0; day < days.count(); ++day) {
    if (random.Chance(0.01)) aim = Hold(aim + 0.25 * (random.Below(5) - 2), 1.5, 9.0);
    rate += 0.03 * (aim - rate) + random.Noise() * 0.015;
    rate = Hold(rate, 1.0, 10.0);
    series.records.push_back(
        Flat(days.texts[size_t(day)], float(std::floor(rate * 100 + 0.5) / 100.0)));
  }
  return series;
}

}  // namespace kora::demo
