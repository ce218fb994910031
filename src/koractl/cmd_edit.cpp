#include <CLI/CLI.hpp>
#include <functional>
#include <memory>

#include "base/numbers.h"
#include "base/text.h"
#include "koractl/options.h"
#include "koractl/run.h"
#include "lists/grid_rows.h"
#include "maintenance/data_rows.h"

namespace kora {
namespace {

struct EditOptions {
  std::string code;
  std::int32_t record = 0;
  std::string field, value;  // of set
  std::string records;       // FIRST[-LAST]
  std::vector<std::string> items;
  std::string by;
};

// Ends the operation where something was refused.
void Take(Run& run, const std::optional<Refusal>& refusal) {
  if (refusal) run.Abandon(refusal->text, refusal->title);
}

// Shows the price file as its form does, lets `edit` change the rows, and saves what has changed.
int EditPrices(const CommandLine& line, const std::string& code,
               const std::function<void(Run&, DataRows&)>& edit) {
  Run run(line);
  run.Open();
  run.Locate(code);
  const auto held = run.session.files.lock().Hold();  // from what is read to what is saved
  DataRows rows(run.session.files, run.PriceFilePath());
  const std::string upper = FromAnsi(run.session.current.Rec.Code.trimmed());
  if (!rows.ShowData(upper, *run.dialogs.StartProgress(kDataFileTitle), run.dialogs))
    return kAbandoned;
  edit(run, rows);
  if (!rows.changed()) return kDone;
  return rows.SaveData(*run.dialogs.StartProgress("SAVE DATA FILE "), run.dialogs) ? kDone
                                                                                   : kAbandoned;
}

// Record numbers "3" or "3-7", as rows of the file.
RowBlock RecordsOf(Run& run, const DataRows& rows, const std::string& text) {
  const auto parts = Split(text, '-');
  const auto number = [&](std::string_view digits) {
    const double value = Val(digits);
    if (digits.empty() || digits.size() > 9 ||
        digits.find_first_not_of("0123456789") != digits.npos || value < 1)
      throw UsageError("\"" + text + "\" is no record, or FIRST-LAST");
    return CLng(value);
  };
  if (parts.size() > 2) throw UsageError("\"" + text + "\" is no record, or FIRST-LAST");
  const RowBlock block{number(parts.front()) - 1, number(parts.back()) - 1};
  if (block.last < block.first) throw UsageError("\"" + text + "\" ends before it begins");
  if (block.last >= rows.RowCount())
    run.Abandon("The file has " + Str(std::int32_t(rows.RowCount())) + " records", kDataTitle);
  return block;
}

constexpr const char* kFields[] = {"Date", "Open", "High", "Low", "Close", "Volume", "AdjDesc"};
constexpr DataColumn kFieldColumns[] = {kDataDate,  kDataOpen,   kDataHigh,   kDataLow,
                                        kDataClose, kDataVolume, kDataAdjDesc};
const std::vector<std::string> kItems{"open", "high", "low", "close", "volume"};
const std::vector<std::string> kFactors{"x10", "x100", "/10", "/100"};

int SetCell(const CommandLine& line, const EditOptions& o) {
  const size_t field =
      size_t(std::find(std::begin(kFields), std::end(kFields), o.field) - std::begin(kFields));
  return EditPrices(line, o.code, [&](Run& run, DataRows& rows) {
    const RowBlock row = RecordsOf(run, rows, Str(o.record));
    Take(run, rows.SetText(row.first, kFieldColumns[field], o.value));
  });
}

int DeleteRecords(const CommandLine& line, const EditOptions& o) {
  return EditPrices(line, o.code, [&](Run& run, DataRows& rows) {
    const RowBlock block = RecordsOf(run, rows, o.records);
    Take(run, rows.MayDelete(block));
    if (!AskDeleteRows(run.dialogs, block.count(), rows.RowName(block.first),
                       rows.RowName(block.last)))
      throw Abandoned();
    rows.DeleteRows(block);
  });
}

int ScaleRecords(const CommandLine& line, const EditOptions& o) {
  ScaleItems items{};
  for (size_t i = 0; i < kItems.size(); ++i)
    items[i] = std::find(o.items.begin(), o.items.end(), kItems[i]) != o.items.end();
  const auto by = ScaleBy(std::find(kFactors.begin(), kFactors.end(), o.by) - kFactors.begin());
  return EditPrices(line, o.code, [&](Run& run, DataRows& rows) {
    Take(run, rows.Scale(RecordsOf(run, rows, o.records), items, by));
  });
}

}  // namespace

void AddEdit(CLI::App& app, CommandLine& line) {
  const auto o = std::make_shared<EditOptions>();
  CLI::App* edit = app.add_subcommand("edit", "Correct a price file by hand");
  edit->add_option("CODE", o->code, "Code of the security, in any case")->required();
  edit->require_subcommand(1);

  CLI::App* set = edit->add_subcommand("set", "Put a value into a record");
  set->add_option("REC", o->record, "Number of the record")
      ->required()
      ->check(CLI::Range(1, 999999999));
  AddChoice(*set, "FIELD", o->field, {std::begin(kFields), std::end(kFields)}, "What to change")
      ->required();
  set->add_option("VALUE", o->value, "What it becomes; behind -- where it begins with -")
      ->required();
  set->callback([&line, o] { line.run = [&line, o] { return SetCell(line, *o); }; });

  CLI::App* del = edit->add_subcommand("delete", "Take records out");
  del->add_option("FIRST[-LAST]", o->records, "Numbers of the records")->required();
  del->callback([&line, o] { line.run = [&line, o] { return DeleteRecords(line, *o); }; });

  edit->add_subcommand("sort", "Put the records in the order of their dates")->callback([&line, o] {
    line.run = [&line, o] {
      return EditPrices(line, o->code, [](Run&, DataRows& rows) { rows.SortByDate(); });
    };
  });

  CLI::App* scale = edit->add_subcommand("scale", "Multiply or divide prices and volumes");
  scale->add_option("FIRST[-LAST]", o->records, "Numbers of the records")->required();
  scale->add_option("--items", o->items, "What to change")
      ->required()
      ->delimiter(',')
      ->type_name("open,high,low,close,volume")
      ->transform(CLI::IsMember(kItems, CLI::ignore_case).description(""));
  AddChoice(*scale, "--by", o->by, kFactors, "The factor")->required();
  scale->callback([&line, o] { line.run = [&line, o] { return ScaleRecords(line, *o); }; });
}

}  // namespace kora
