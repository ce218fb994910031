#include <CLI/CLI.hpp>
#include <algorithm>
#include <memory>
#include <span>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "koractl/run.h"
#include "koractl/table.h"
#include "lists/chart_list.h"
#include "platform/dialogs.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr std::string_view kListsTitle = "Chart Lists";
constexpr const char* kForms =
    "list A\n"
    "list A add CODE... | remove CODE... | clear\n"
    "list check\n"
    "list copy A B CODE... | move A B CODE...";

// The list of a letter, in any case; 0 for what is none.
std::int16_t ListOf(std::string_view word) {
  for (std::int16_t number = kFirstChartList; number <= kResultList; ++number)
    if (EqualNoCase(std::string("SubList").append(word) + ".Dat", ListFileName(number)))
      return number;
  return 0;
}

std::int16_t NeedList(std::string_view word) {
  const std::int16_t number = ListOf(word);
  if (number == 0)
    throw UsageError("\"" + std::string(word) + "\" is no list: A to K without I, or Z");
  return number;
}

using Words = std::span<const std::string>;

// Codes as a list holds them.
ListCodes Codes(Words words) {
  if (words.empty()) throw UsageError("Codes are missing");
  ListCodes codes;
  for (const std::string& word : words) codes.push_back(UCase(Trim(ToAnsi(word))));
  return codes;
}

[[noreturn]] void NotFound(Run& run, const std::string& code) {
  run.Abandon(std::string(kCodeNotFound) + "  " + FromAnsi(code), kListsTitle);
}

ListSide SideOf(Run& run, std::int16_t number) {
  ListSide side{number, {}, false};
  side.Codes = CodesOf(ReadList(run.session.files, run.dataPath(), number));
  return side;
}

// Where the codes stand in the list. All of them must.
std::vector<size_t> PlacesOf(Run& run, const ListCodes& list, const ListCodes& codes) {
  std::vector<size_t> places;
  for (const std::string& code : codes) {
    const auto at = std::find_if(list.begin(), list.end(),
                                 [&](const std::string& item) { return EqualNoCase(item, code); });
    if (at == list.end()) NotFound(run, code);
    places.push_back(size_t(at - list.begin()));
  }
  return places;
}

// Saves what has changed. Codes that left the name file go, and are told.
void SaveLists(Run& run, std::span<const ListSide> sides) {
  for (const std::string& code : SaveSides(run.session.files, run.dataPath(), sides))
    run.dialogs.Message(FromAnsi(code) + " is no longer in the Name File", kListsTitle);
}

void PrintList(Run& run, std::int16_t number) {
  Table table("Rec Code");
  for (const ListRec& rec : ReadList(run.session.files, run.dataPath(), number))
    table.Number(std::int32_t(rec.ListRecNo)).Text(rec.ListCode.raw()).EndRow();
  table.Print();
}

void AddCodes(Run& run, std::int16_t number, const ListCodes& codes) {
  ListCodes names;
  for (const NameRec& rec : ReadNames(run.session.files, run.dataPath()))
    names.emplace_back(Trim(rec.Code.trimmed()));
  ListSide side = SideOf(run, number);
  for (const std::string& code : codes) {
    const auto place = FindTypedCode(names, code);
    if (!place) NotFound(run, code);
    if (AddCode(side.Codes, names[*place])) side.Changed = true;
  }
  SaveLists(run, std::span(&side, 1));
}

void RemoveCodes(Run& run, std::int16_t number, const ListCodes& codes) {
  ListSide side = SideOf(run, number);
  const std::vector<size_t> places = PlacesOf(run, side.Codes, codes);
  std::vector<size_t> gone;
  for (const size_t place : places)
    if (run.dialogs.Ask(DeleteQuestion(FromAnsi(side.Codes[place])), kListsTitle,
                        Buttons::kYesNo) == Answer::kYes)
      gone.push_back(place);
  if (gone.empty()) throw Abandoned();
  DeleteItems(side.Codes, gone);
  side.Changed = true;
  SaveLists(run, std::span(&side, 1));
}

void ClearList(Run& run, std::int16_t number) {
  ListSide side = SideOf(run, number);
  if (side.Codes.empty()) return;
  if (run.dialogs.Ask(kDeleteAllItems, kListsTitle, Buttons::kYesNo) != Answer::kYes)
    throw Abandoned();
  side.Codes.clear();
  side.Changed = true;
  SaveLists(run, std::span(&side, 1));
}

void Transfer(Run& run, std::int16_t from, std::int16_t to, const ListCodes& codes, bool move) {
  ListSide sides[] = {SideOf(run, from), SideOf(run, to)};
  auto& [source, target] = sides;
  if (const std::string_view fault = CheckSides(source, target); !fault.empty())
    run.Abandon(fault, kListUtilities);
  const std::vector<size_t> places = PlacesOf(run, source.Codes, codes);
  if (move)
    MoveItems(source, target, places);
  else
    CopyItems(source, target, places);
  SaveLists(run, sides);
}

void CheckLists(Run& run) {
  const ListCheck check = CheckAllLists(run.session.files, run.dataPath());
  WriteOut("# Lists=" + Str(std::int32_t(check.lists)) +
           " Removed=" + Str(std::int32_t(check.removed)) + "\n");
}

// What the words after "list" ask for. A command line that makes no sense is told before anything
// is read.
std::function<void(Run&)> WorkOf(Words words) {
  const std::string action = LCase(words[0]);
  if (action == "check" && words.size() == 1) return CheckLists;
  if ((action == "copy" || action == "move") && words.size() > 3)
    return [from = NeedList(words[1]), to = NeedList(words[2]), codes = Codes(words.subspan(3)),
            move = action == "move"](Run& run) { Transfer(run, from, to, codes, move); };
  if (action == "check" || action == "copy" || action == "move") throw UsageError(kForms);
  const std::int16_t number = NeedList(words[0]);
  if (words.size() == 1) return [number](Run& run) { PrintList(run, number); };
  const std::string change = LCase(words[1]);
  if (change == "clear" && words.size() == 2) return [number](Run& run) { ClearList(run, number); };
  if (change == "add")
    return [number, codes = Codes(words.subspan(2))](Run& run) { AddCodes(run, number, codes); };
  if (change == "remove")
    return [number, codes = Codes(words.subspan(2))](Run& run) { RemoveCodes(run, number, codes); };
  throw UsageError(kForms);
}

int ChartListsOf(const CommandLine& line, const std::vector<std::string>& words) {
  const auto work = WorkOf(words);
  Run run(line);
  run.Open();
  try {
    // From what is read to what is saved; who only looks holds nothing.
    std::optional<HomeLock::Held> held;
    if (words.size() > 1 || ListOf(words[0]) == 0) held.emplace(run.session.files.lock().Hold());
    work(run);
  } catch (const RunTimeError& e) {
    run.Abandon(e.what(), kListsTitle);
  }
  return kDone;
}

}  // namespace

void AddList(CLI::App& app, CommandLine& line) {
  const auto words = std::make_shared<std::vector<std::string>>();
  CLI::App* list = app.add_subcommand("list", "Show and change the chart lists");
  list->add_option("WORDS", *words,
                   "A to K without I, or Z: the list; behind it add CODE..., remove CODE... or "
                   "clear. check: all lists. copy A B CODE..., move A B CODE...")
      ->required();
  list->callback(
      [&line, words] { line.run = [&line, words] { return ChartListsOf(line, *words); }; });
}

}  // namespace kora
