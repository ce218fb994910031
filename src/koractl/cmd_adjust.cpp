#include <memory>

#include "adjust/issue_adjustment.h"
#include "base/numbers.h"
#include "base/runtime_error.h"
#include "koractl/options.h"
#include "koractl/run.h"

namespace kora {
namespace {

struct AdjustOptions {
  std::string code, date;
  std::string first, second, amount;  // as typed
  int record = 0;                     // 0: the one that the look-up selects
  int times = 1;
};

// The security, as the form offers it, and where its data are.
AdjustServices Locate(Run& run, const std::string& code) {
  run.Open();
  run.Locate(code);
  const std::int16_t type = run.session.current.Rec.RecType;
  if (type != kShare && type != kIndex)
    run.Abandon("Only shares and indices can be adjusted", kAdjustTitle);
  const Session& s = run.session;
  return {s.files, run.dialogs, run.dataPath(), s.settings.paths.ChartMiscPath,
          s.colours[kChartTitle]};
}

double Figure(Run& run, const std::string& text) {
  const auto number = FieldNumber(text);
  if (!number) run.Abandon(kMustBeNumeric, " Data Input ");
  return *number;
}

int AdjustByHand(const CommandLine& line, IssueKind kind, const AdjustOptions& o) {
  Run run(line);
  const AdjustServices services = Locate(run, o.code);
  const std::string code(run.session.current.Rec.Code.trimmed());
  const IssueFigures figures{CSng(Figure(run, o.first)), CSng(Figure(run, o.second)),
                             Currency(Figure(run, o.amount))};
  IssueAdjustment work(services, kind);
  if (!work.CheckDate(code, figures, o.date, o.date)) return kAbandoned;
  const AdjustmentDates& dates = work.dates();
  const std::int16_t record = o.record > 0 ? CInt(o.record) : dates.AdjRecNo(dates.Selected);
  return work.Adjust(figures, record, {}) ? kDone : kAbandoned;
}

int RemoveByHand(const CommandLine& line, const AdjustOptions& o) {
  Run run(line);
  const AdjustServices services = Locate(run, o.code);
  const std::string code(run.session.current.Rec.Code.trimmed());
  return RemoveAdjustments(services, code, o.times) == RemoveEnd::kRemoved ? kDone : kAbandoned;
}

}  // namespace

void AddAdjust(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<AdjustOptions>();
  CLI::App* adjust = app.add_subcommand("adjust", "Rescale a security's history for an issue");
  adjust->require_subcommand(1);
  const auto add = [&](const char* name, const char* about) {
    CLI::App* command = adjust->add_subcommand(name, about);
    command->add_option("CODE", o->code, "Security")->required();
    return command;
  };
  const auto addKind = [&](const char* name, const char* about, IssueKind kind) {
    CLI::App* command = add(name, about);
    command->add_option("--date", o->date, "The last day in old terms")
        ->type_name("d/m/yy")
        ->required();
    command
        ->add_option("--record", o->record,
                     "Record to adjust from (default: the one that the date selects)")
        ->check(CLI::Range(1, 32767));
    command->callback(
        [&line, o, kind] { line.run = [&line, o, kind] { return AdjustByHand(line, kind, *o); }; });
    return command;
  };
  const auto figure = [](CLI::App* command, const char* name, std::string& value,
                         const char* about) {
    command->add_option(name, value, about)->type_name("N")->required();
  };
  CLI::App* bonus = addKind("bonus", "Bonus issue", IssueKind::kBonus);
  figure(bonus, "--new", o->first, "Bonus shares for every");
  figure(bonus, "--held", o->second, "Shares held");
  CLI::App* cash = addKind("cash", "Cash issue", IssueKind::kCash);
  figure(cash, "--new", o->first, "New shares for every");
  figure(cash, "--held", o->second, "Shares held");
  figure(cash, "--cost", o->amount, "Cost per new share");
  CLI::App* split = addKind("split", "Share split", IssueKind::kSplit);
  figure(split, "--new", o->first, "New shares for");
  figure(split, "--old", o->second, "Old shares");
  CLI::App* call = addKind("call", "Call on contributing shares", IssueKind::kCall);
  figure(call, "--amount", o->amount, "Amount of call per share");
  CLI::App* dividend = addKind("dividend", "Dividend", IssueKind::kDividend);
  figure(dividend, "--amount", o->amount, "Dividend amount per share");
  CLI::App* remove = add("remove", "Take the latest adjustment out again");
  remove->add_option("--times", o->times, "The latest N")
      ->capture_default_str()
      ->check(CLI::Range(1, 20));
  remove->callback([&line, o] { line.run = [&line, o] { return RemoveByHand(line, *o); }; });
}

}  // namespace kora
