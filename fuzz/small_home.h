#pragma once

#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "platform/clock.h"
#include "settings/settings.h"
#include "tests/support/memory_io.h"
#include "tests/support/scripted_dialogs.h"

namespace kora::test {

// What a body takes its choices from, then the bytes that it reads.
class Input {
 public:
  explicit Input(std::string_view bytes) : rest_(bytes) {}
  // 0 at the end.
  unsigned Byte() {
    if (rest_.empty()) return 0;
    const unsigned byte = static_cast<unsigned char>(rest_.front());
    rest_.remove_prefix(1);
    return byte;
  }
  std::string_view Rest() const { return rest_; }
  // Up to a line "%%", or all.
  std::string_view Part() {
    const size_t at = rest_.find(kMark);
    const std::string_view part = rest_.substr(0, at);
    rest_.remove_prefix(at == std::string_view::npos ? rest_.size() : at + kMark.size());
    return part;
  }

 private:
  static constexpr std::string_view kMark = "\n%%\n";
  std::string_view rest_;
};

// An installation in memory: its folders, and no files.
struct SmallHome {
  SmallHome();

  const std::string system = "c:\\korawin\\";
  const std::string data = "c:\\korawin\\data\\";

  MemoryIo io;
  Files files{"home", io};
  ScriptedDialogs dialogs;
  NoProgress progress;
  Settings settings;

  // A file below the program folder, "data/ORE.WDT".
  void Put(std::string_view name, std::string_view bytes);
  std::string Get(std::string_view name) const;
  // Four securities of four kinds, and some days of each: ORE, IDX, ADV and the warrant OREWAA.
  void PutMarket();

  // Promises that files came, went or changed under these names alone; "data/*.WDT" stands for
  // each name in that folder with that end, in any case. Nothing temporary is left.
  void OnlyChanged(const std::map<std::string, std::string>& before,
                   const std::vector<std::string>& names) const;
};

// Sixty days of prices that go up and down.
std::string ManyDays();

struct FixedClock : Clock {
  CalendarDate Today() const override { return {1998, 9, 20}; }
};

template <typename T>
std::string BytesOf(const std::vector<T>& records) {
  return std::string(reinterpret_cast<const char*>(records.data()), records.size() * sizeof(T));
}
template <typename T>
std::string BytesOf(const T& record) {
  return std::string(reinterpret_cast<const char*>(&record), sizeof(T));
}

}  // namespace kora::test
