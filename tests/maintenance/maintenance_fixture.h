#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <functional>
#include <map>
#include <string>
#include <vector>

#include "platform/progress.h"
#include "settings/settings.h"
#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/failing_io.h"
#include "tests/support/killed_runs.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"

namespace kora::test {

inline PriceRec Flat(std::string_view date, float price, std::int32_t volume = 0) {
  return Day(date, price, price, price, price, volume);
}

// Keeps what was shown; stops at a step.
struct KeptProgress : Progress {
  std::vector<std::string> states, items, notes;
  int steps = 0, stopAt = 0;
  void Show(ProgressLine line, std::string_view text) override {
    if (line == ProgressLine::kState) states.emplace_back(text);
    if (line == ProgressLine::kItem) items.emplace_back(text);
    if (line == ProgressLine::kNote) notes.emplace_back(text);
  }
  bool Step(int, int) override { return ++steps != stopAt; }
};

// An installation with one data folder.
class MaintenanceTest : public ::testing::Test {
 protected:
  const std::string kData = "c:\\korawin\\data\\";
  const std::string kMisc = "c:\\korawin\\chtmisc\\";
  const std::string kHostData = "drive_c/korawin/data/";

  MaintenanceTest() {
    settings.paths.CurrentDataPath = kData;
    home.Put(kHostData + "Names.dat", "");
  }

  void Names(const std::vector<NameRec>& recs, const std::string& folder = "") {
    home.Put((folder.empty() ? kHostData : folder) + "Names.dat", Bytes(recs));
  }
  void Prices(const std::string& code, const std::vector<PriceRec>& recs,
              const std::string& folder = "") {
    home.Put((folder.empty() ? kHostData : folder) + code + ".WDT", Bytes(recs));
  }
  std::vector<PriceRec> PricesOf(const std::string& code, const std::string& folder = "") {
    return PriceFile(home.files(), (folder.empty() ? kData : folder) + code + ".WDT").ReadAll();
  }
  std::vector<NameRec> NamesOf(const std::string& folder = "") {
    return ReadNames(home.files(), folder.empty() ? kData : folder);
  }
  std::string CodesOfNames(const std::string& folder = "") {
    std::string out;
    for (const NameRec& rec : NamesOf(folder))
      out += (out.empty() ? "" : " ") + std::string(rec.Code.trimmed());
    return out;
  }
  // "date close" a record.
  std::string Shown(const std::string& code, const std::string& folder = "") {
    std::string out;
    for (const PriceRec& rec : PricesOf(code, folder))
      out += (out.empty() ? "" : "; ") + std::string(rec.RecDate.raw()) + " " +
             std::to_string(int(rec.Close));
    return out;
  }
  std::string LastSaid() { return dialogs.said.empty() ? "" : dialogs.said.back().text; }
  std::string LastTitle() { return dialogs.said.empty() ? "" : dialogs.said.back().title; }

  // Every file below drive C: with its bytes, but for what a kill may leave to be swept.
  using Store = std::map<std::string, std::string>;
  Store Everything() {
    namespace fs = std::filesystem;
    Store out;
    const std::string root = home.path() + "/drive_c/";
    for (const auto& e : fs::recursive_directory_iterator(root)) {
      const std::string name = e.path().string().substr(root.size());
      if (e.is_regular_file() && !name.ends_with('~')) out[name] = home.Get("drive_c/" + name);
    }
    return out;
  }

  // Runs `work` over a scene in a process of its own that is killed in place of its change number 1,
  // 2, ...; each time every price and name file is an old or a new one, and the same work again
  // gives what an undisturbed one gives. How many points there were.
  int KilledEverywhere(const std::function<void()>& lay, const std::function<bool()>& work) {
    const auto layAnew = [&] {
      io.Reset();
      std::filesystem::remove_all(home.path() + "/drive_c");
      lay();
    };
    layAnew();
    const Store before = Everything();
    EXPECT_TRUE(work()) << LastSaid();
    const Store whole = Everything();
    for (int at = 1;; ++at) {
      SCOPED_TRACE("change " + std::to_string(at));
      layAnew();
      const auto code = InChild([&] {
        io.Reset(at);
        io.kills = true;
        return work() ? 0 : 1;
      });
      if (code) {
        EXPECT_EQ(*code, 0);
        return at - 1;
      }
      for (const auto& [name, bytes] : Everything()) {
        const auto old = before.find(name), fresh = whole.find(name);
        const bool known = (old != before.end() && old->second == bytes) ||
                           (fresh != whole.end() && fresh->second == bytes);
        EXPECT_TRUE(known || !(name.ends_with(".WDT") || name.ends_with("Names.dat"))) << name;
      }
      again();
      EXPECT_TRUE(work()) << LastSaid();
      EXPECT_TRUE(Everything() == whole);
      if (HasFailure()) return 0;
    }
  }
  // What a test does between the kill and the rerun.
  std::function<void()> again = [] {};

  // Fails each change in turn: told, and everything as it was.
  int FailedEverywhere(const std::function<bool()>& work) {
    const Store before = Everything();
    for (int at = 1;; ++at) {
      SCOPED_TRACE("change " + std::to_string(at));
      const size_t said = dialogs.said.size();
      io.Reset(at);
      const bool done = work();
      const bool met = io.calls >= at;
      io.Reset();
      if (!met) {
        EXPECT_TRUE(done);
        return at - 1;
      }
      EXPECT_FALSE(done);
      EXPECT_GT(dialogs.said.size(), said);
      EXPECT_TRUE(Everything() == before);
      if (HasFailure()) return 0;
    }
  }

  FailingIo io;
  TempHome home{io};
  ScriptedDialogs dialogs;
  KeptProgress progress;
  Settings settings;
};

}  // namespace kora::test
