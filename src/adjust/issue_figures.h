#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "base/currency.h"

// The arithmetic of issues: from the figures that a company announces to the factor by which
// earlier prices are multiplied, and the note that marks the date.

namespace kora {

enum class IssueKind { kBonus, kCash, kSplit, kCall, kDividend };

// "B", "C", "CC", "D" for the date look-up. A split has "B".
std::string_view AdjKindOf(IssueKind kind);

struct IssueFigures {
  float AdjFirst = 0;   // bonus shares, or new shares
  float AdjSecond = 0;  // shares held, or old shares
  Currency Amount;      // cost per new share, call or dividend per share
};

bool HasRatio(IssueKind kind);
bool HasAmount(IssueKind kind);

struct Adjustment {
  float AdjFactorValue = 0;
  std::string AdjDescText;  // cut to the 14 bytes of AdjDesc on storing
};

// `factor` as a 32-bit float, rounded to 6 decimals by its decimal form. Error 6 unless it is
// above 0 then.
float RoundedFactor(double factor);

// Factors are worked in 64 bits. Error 11 where the shares together or `AdjClose`, the close of
// the last day in old terms, is 0; 6 where the factor does not come out above 0.
Adjustment BonusIssue(float bonus, float held);               // h / (b + h), "bi1:4"
Adjustment CashIssue(float fresh, float held, Currency cost,  // 1 - (C - T) / C,
                     float AdjClose);                         // T = (c n + h C) / (n + h)
Adjustment ShareSplit(float fresh, float old);                // o / n, "ss2:1"
Adjustment ShareCall(Currency amount, float AdjClose);        // a / C + 1, "cl0.5"
Adjustment Dividend(Currency amount, float AdjClose);         // 1 - d / C, "dv0.25"
// The one of the kind.
Adjustment FigureAdjustment(IssueKind kind, const IssueFigures& figures, float AdjClose);

// ---- What is typed

// The whole text as a number; nothing where it is none, which is told as kMustBeNumeric. An empty
// text is 0.
std::optional<double> FieldNumber(std::string_view text);
inline constexpr std::string_view kMustBeNumeric = " Data must be numeric ";

// Empty where all figures that the kind takes are above 0; else what is told of it, which before
// the look-up of the date names the ratio.
std::string_view FiguresFault(IssueKind kind, const IssueFigures& figures, bool beforeLookUp);

// "Ratio of Bonus Issue is 1:4"; empty while one of the two is 0.
std::string RatioText(const IssueFigures& figures);

// The date typed, as "yyyymmdd". Day, month and year stand between "/" or "-", the first of them
// at position 2 behind a digit 1 to 9, or at position 3 behind a value below 32. Nothing where
// they do not, or where it is no calendar date: that is told as kDateFormat.
std::optional<std::string> AdjWantedDateOf(std::string_view typed);
inline constexpr std::string_view kDateFormat =
    " Use  /   or  -  to separate day/month/year\n eg.  2/10/93";

}  // namespace kora
