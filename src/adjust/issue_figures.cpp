#include "adjust/issue_figures.h"

#include <algorithm>
#include <cmath>

#include "base/dates.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {
namespace {

std::string Ratio(std::string_view mark, float first, float second) {
  return std::string(mark) + Str(first) + ":" + Str(second);
}

bool IsSeparator(char c) { return c == '/' || c == '-'; }

}  // namespace

std::string_view AdjKindOf(IssueKind kind) {
  switch (kind) {
    case IssueKind::kBonus:
    case IssueKind::kSplit: return "B";
    case IssueKind::kCash: return "C";
    case IssueKind::kCall: return "CC";
    case IssueKind::kDividend: return "D";
  }
  throw RunTimeError(kBadCall);
}

bool HasRatio(IssueKind kind) {
  return kind == IssueKind::kBonus || kind == IssueKind::kCash || kind == IssueKind::kSplit;
}

bool HasAmount(IssueKind kind) {
  return kind == IssueKind::kCash || kind == IssueKind::kCall || kind == IssueKind::kDividend;
}

float RoundedFactor(double factor) {
  const float rounded = CSng(Val(Format(CSng(factor), "#####.######")));
  if (!(rounded > 0)) throw RunTimeError(kOverflow);
  return rounded;
}

Adjustment BonusIssue(float bonus, float held) {
  return {RoundedFactor(Divide(held, double(bonus) + double(held))), Ratio("bi", bonus, held)};
}

Adjustment CashIssue(float fresh, float held, Currency cost, float AdjClose) {
  const double c = cost.ToDouble(), n = fresh, h = held, C = AdjClose;
  const double T = Divide(c * n + h * C, n + h);
  return {RoundedFactor(1 - Divide(C - T, C)), Ratio("ci", fresh, held) + " @ " + Str(c)};
}

Adjustment ShareSplit(float fresh, float old) {
  return {RoundedFactor(Divide(old, fresh)), Ratio("ss", fresh, old)};
}

Adjustment ShareCall(Currency amount, float AdjClose) {
  const double a = amount.ToDouble();
  return {RoundedFactor(Divide(a, AdjClose) + 1), "cl" + Str(a)};
}

Adjustment Dividend(Currency amount, float AdjClose) {
  const double d = amount.ToDouble();
  return {RoundedFactor(1 - Divide(d, AdjClose)), "dv" + Str(d)};
}

Adjustment FigureAdjustment(IssueKind kind, const IssueFigures& f, float AdjClose) {
  switch (kind) {
    case IssueKind::kBonus: return BonusIssue(f.AdjFirst, f.AdjSecond);
    case IssueKind::kCash: return CashIssue(f.AdjFirst, f.AdjSecond, f.Amount, AdjClose);
    case IssueKind::kSplit: return ShareSplit(f.AdjFirst, f.AdjSecond);
    case IssueKind::kCall: return ShareCall(f.Amount, AdjClose);
    case IssueKind::kDividend: return Dividend(f.Amount, AdjClose);
  }
  throw RunTimeError(kBadCall);
}

std::optional<double> FieldNumber(std::string_view text) {
  text = Trim(text);
  if (text.empty()) return 0.0;
  const auto number = ParseFloat(text);
  if (!number) return std::nullopt;
  // The digits as they stand are more than a 32-bit float keeps; an exponent only that can read.
  const bool exponent = text.find_first_of("eE") != std::string_view::npos;
  return exponent ? double(*number) : Val(text);
}

std::string_view FiguresFault(IssueKind kind, const IssueFigures& figures, bool beforeLookUp) {
  const bool ratio = !HasRatio(kind) || (figures.AdjFirst > 0 && figures.AdjSecond > 0);
  const bool amount = !HasAmount(kind) || figures.Amount.units() > 0;
  if (ratio && amount) return {};
  return beforeLookUp && !HasAmount(kind) ? "Ratio Data incomplete" : "Data incomplete";
}

std::string RatioText(const IssueFigures& figures) {
  if (figures.AdjFirst == 0 || figures.AdjSecond == 0) return {};
  return Ratio("Ratio of Bonus Issue is ", figures.AdjFirst, figures.AdjSecond);
}

std::optional<std::string> AdjWantedDateOf(std::string_view typed) {
  const std::string text(Trim(typed));
  const auto first = std::find_if(text.begin(), text.end(), IsSeparator) - text.begin();
  if (first == 1) {
    if (text[0] < '1' || text[0] > '9') return std::nullopt;
  } else if (first == 2) {
    const double day = Val(text.substr(0, 2));
    if (day <= -1 || day >= 32) return std::nullopt;
  } else {
    return std::nullopt;
  }
  if (std::count_if(text.begin(), text.end(), IsSeparator) != 2) return std::nullopt;
  std::string slashed = text;
  std::replace(slashed.begin(), slashed.end(), '-', '/');
  const auto date = ParseUserDate(slashed);
  if (!date) return std::nullopt;
  return FormatFileDate(*date);
}

}  // namespace kora
