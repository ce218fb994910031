#include "companies/snapshot.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/name_file.h"

namespace kora {
namespace {

constexpr std::uint64_t kLargestList = 1u << 20;
constexpr std::uint64_t kLargestAnswer = 1u << 20;
constexpr std::string_view kProgram = "Quickcomm.exe";

// The user gave up waiting.
struct GivenUp {};

// A field of a line: what would end the field or the line becomes a blank.
std::string Field(std::string_view text) {
  std::string out = ToAnsi(Trim(text));
  for (char& c : out)
    if (c == ',' || static_cast<unsigned char>(c) < 0x20) c = ' ';
  return std::string(Trim(out));
}

std::string Exchange(const DownloadSettings& download, std::string_view name) {
  return WithBackslash(Trim(download.ServiceSystem)) + std::string(name);
}

std::string CounterDate(const CalendarDate& today) { return FormatFileDate(today); }

// Keeps which list was asked for and how often today.
void CountAccess(const SnapshotServices& s, int list) {
  const std::string line = Str(std::int32_t(list)) + "," +
                           Str(std::int32_t(SnapshotAccesses(s) + 1)) + "," +
                           CounterDate(s.clock.Today()) + "\r\n";
  s.files.WriteAll(Exchange(s.download, "Snap.Lct"), line);
}

}  // namespace

std::string SnapshotFile(const std::string& systemPath, int list) {
  switch (list) {
    case 1: return systemPath + "Snapshot.Dat";
    case 2: return systemPath + "Snap2.Dat";
    case 3: return systemPath + "Snap3.Dat";
    default: throw RunTimeError(kBadCall);
  }
}

std::vector<SnapshotRow> ReadSnapshot(const Files& files, const std::string& systemPath, int list) {
  const std::string path = SnapshotFile(systemPath, list);
  std::vector<SnapshotRow> rows;
  if (!files.CheckFile(path)) return rows;
  const std::string text = files.ReadAll(path, kLargestList);
  LineReader lines(text);
  for (std::string_view line; rows.size() < kMostSnapshotRows && lines.Next(line);) {
    const auto fields = Split(line, ',');
    const auto field = [&](size_t i) {
      return i < fields.size() ? FromAnsi(Trim(fields[i])) : std::string();
    };
    SnapshotRow row{.code = UCase(field(0)),
                    .kind = UCase(field(1)) == "I" ? 'I' : 'S',
                    .units = field(2),
                    .cost = field(3),
                    .dividend = field(4),
                    .prices = {}};
    if (!row.code.empty()) rows.push_back(std::move(row));
  }
  return rows;
}

void SaveSnapshot(const Files& files, const std::string& systemPath, int list,
                  const std::vector<SnapshotRow>& rows) {
  std::string text;
  for (const SnapshotRow& row : rows) {
    if (Trim(row.code).empty()) continue;
    text += UCase(Field(row.code)) + "," + row.kind + "," + Field(row.units) + "," +
            Field(row.cost) + "," + Field(row.dividend) + "\r\n";
  }
  const auto held = files.lock().Hold();
  files.WriteAll(SnapshotFile(systemPath, list), text);
}

int SnapshotAccesses(const SnapshotServices& services) {
  try {
    const std::string path = Exchange(services.download, "Snap.Lct");
    if (!services.files.CheckFile(path)) return 0;
    const std::string text = services.files.ReadAll(path, kLargestList);
    const std::string_view line = std::string_view(text).substr(0, text.find_first_of("\r\n"));
    const auto fields = Split(Trim(line), ',');
    if (fields.size() < 3 || Trim(fields[2]) != CounterDate(services.clock.Today())) return 0;
    return CLng(std::clamp(Val(fields[1]), 0.0, 1e6));
  } catch (const RunTimeError&) {
    return 0;  // it counts nothing that matters
  }
}

int UpdateGrid(std::string_view answer, std::vector<SnapshotRow>& rows) {
  std::vector<bool> filled(rows.size());
  LineReader lines(answer);
  for (std::string_view line; lines.Next(line);) {
    const auto fields = Split(line, ',');
    const std::string code = UCase(Trim(fields[0]));
    if (code.empty()) continue;
    for (size_t i = 0; i < rows.size(); ++i) {
      if (UCase(rows[i].code) != code) continue;
      for (size_t k = 0; k < rows[i].prices.size(); ++k)
        rows[i].prices[k] = k + 1 < fields.size() ? FromAnsi(Field(fields[k + 1])) : std::string();
      filled[i] = true;
    }
  }
  return int(std::count(filled.begin(), filled.end(), true));
}

bool FetchSnapshot(const SnapshotServices& services, int list, std::vector<SnapshotRow>& rows,
                   const std::function<bool()>& idle) {
  const auto tell = [&](std::string_view text) {
    services.dialogs.Message(text, kSnapshotTitle);
    return false;
  };
  std::string request;
  size_t listed = 0;
  for (const SnapshotRow& row : rows) {
    const std::string code = UCase(Field(row.code));
    if (code.empty()) continue;
    ++listed;
    request += std::string(1, row.kind) + "," + code + "\r\n";
  }
  if (listed == 0) return tell("Cannot proceed - no stocks listed");
  if (listed > kMostSnapshotRows) return tell(kTooManyRows);

  const std::string program = services.paths.SystemPath + std::string(kProgram);
  if (!services.files.CheckFile(program)) return tell("File not found  " + program);
  const std::string answerPath = Exchange(services.download, "Snap.Lst");
  try {
    services.files.WriteAll(Exchange(services.download, "Snap.Snd"), request);
    // An answer of before must not be taken for that of this request.
    if (services.files.CheckFile(answerPath)) services.files.Remove(answerPath);
    services.files.WriteAll(Exchange(services.download, "Comm.Stt"), "");
    CountAccess(services, list);
    const int code = services.processes.RunAndWait(services.files.HostPath(program), {}, [&] {
      if (idle && !idle()) throw GivenUp();
    });
    if (!services.files.CheckFile(answerPath))
      return tell(code == 0 ? "No prices were received"
                            : "No prices were received. " + std::string(kProgram) +
                                  " ended with error " + Str(std::int32_t(code)));
    const std::string answer = services.files.ReadAll(answerPath, kLargestAnswer);
    if (UpdateGrid(answer, rows) == 0) return tell("No prices were received");
    return true;
  } catch (const GivenUp&) {
    return false;
  } catch (const RunTimeError& e) {
    return tell(e.what());
  }
}

std::optional<Holding> HoldingOf(const SnapshotRow& row) {
  Holding h;
  h.units = Val(row.units);
  if (h.units <= 0) return std::nullopt;
  h.cost = Val(row.cost);
  h.price = Val(row.prices[0]);
  h.previous = Val(row.prices[3]);
  h.previousValue = h.units * h.previous;
  h.value = h.units * h.price;
  if (!row.prices[0].empty()) h.gain = h.value - h.units * h.cost;
  h.dividends = h.units * Val(row.dividend);
  return h;
}

Holding Totals(const std::vector<SnapshotRow>& rows) {
  Holding sum;
  for (const SnapshotRow& row : rows) {
    const auto h = HoldingOf(row);
    if (!h) continue;
    sum.previousValue += h->previousValue;
    sum.value += h->value;
    sum.gain += h->gain;
    sum.dividends += h->dividends;
  }
  return sum;
}

}  // namespace kora
