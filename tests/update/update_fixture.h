#pragma once

#include <gtest/gtest.h>

#include <filesystem>
#include <map>
#include <string>
#include <vector>

#include "platform/clock.h"
#include "store/name_file.h"
#include "store/price_rec.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/scripted_dialogs.h"
#include "tests/support/temp_home.h"
#include "update/download_settings.h"
#include "update/download_update.h"

namespace kora::test {

// A day that stands still.
struct FixedClock : Clock {
  CalendarDate today{1998, 9, 20};
  CalendarDate Today() const override { return today; }
};

// Keeps what the update showed.
struct KeptDisplay : Progress {
  std::vector<std::string> states, targets, firsts, seconds;
  int steps = 0, stopAt = 0;
  bool running = false;
  void Show(ProgressLine line, std::string_view text) override {
    switch (line) {
      case ProgressLine::kState: states.emplace_back(text); break;
      case ProgressLine::kTarget: targets.emplace_back(text); break;
      case ProgressLine::kItem: firsts.emplace_back(text); break;
      case ProgressLine::kNote: seconds.emplace_back(text); break;
      case ProgressLine::kDate: break;
    }
  }
  void SetRunning(bool value) override { running = value; }
  bool Step(int, int) override { return ++steps != stopAt; }
};

// An installation with one data folder and one download folder, service 5.
class UpdateFixture : public ::testing::Test {
 protected:
  const std::string kSystem = "c:\\korawin\\";
  const std::string kData = "c:\\korawin\\data\\";
  const std::string kDown = "c:\\korawin\\download\\";
  const std::string kHostSystem = "drive_c/korawin/";
  const std::string kHostData = "drive_c/korawin/data/";
  const std::string kHostDown = "drive_c/korawin/download/";

  UpdateFixture() {
    settings.paths.SystemPath = kSystem;
    settings.paths.CurrentDataPath = kData;
    settings.download.DataService = 5;
    settings.download.DLPath = kDown;
    home.Put(kHostData + "Names.dat", "");
    home.files().MakeFolder(kDown);
  }

  void Names(const std::vector<NameRec>& recs, std::string folder = "") {
    home.Put((folder.empty() ? kHostData : folder) + "Names.dat", Bytes(recs));
  }
  void Prices(const std::string& code, const std::vector<PriceRec>& recs, std::string folder = "") {
    home.Put((folder.empty() ? kHostData : folder) + code + ".WDT", Bytes(recs));
  }
  void Download(const std::string& name, std::string_view text) {
    home.Put(kHostDown + name, text);
  }
  bool Waits(const std::string& name) { return home.Exists(kHostDown + name); }

  std::vector<PriceRec> PricesOf(const std::string& code, std::string folder = "") {
    return PriceFile(home.files(), (folder.empty() ? kData : folder) + code + ".WDT").ReadAll();
  }
  std::vector<NameRec> NamesOf(std::string folder = "") {
    return ReadNames(home.files(), folder.empty() ? kData : folder);
  }
  // "date close volume" a record.
  std::string Shown(const std::string& code, std::string folder = "") {
    std::string out;
    for (const PriceRec& rec : PricesOf(code, folder)) {
      if (!out.empty()) out += "; ";
      out += std::string(rec.RecDate.raw()) + " " + std::to_string(int(rec.Close)) + " " +
             std::to_string(rec.Volume);
    }
    return out;
  }

  UpdateRun Run() {
    return {home.files(), settings, current, dialogs, clock, display, {}, mostHeld};
  }
  // Takes in one waiting file, or all of them when none is named.
  UpdateEnd Update(const std::string& name = "") {
    entries.clear();
    if (BuildDownloadList(home.files(), settings.download, dialogs, entries) != ListResult::kFilled)
      return UpdateEnd::kStopped;
    if (name.empty()) return UpdateAllDays(Run(), entries);
    for (size_t i = 0; i < entries.size(); ++i)
      if (entries[i] == name) return UpdateOneDay(Run(), entries, i);
    ADD_FAILURE() << name << " does not wait";
    return UpdateEnd::kStopped;
  }
  UpdateEnd Take(const std::string& text, const std::string& name = "15SEP98.d") {
    Download(name, text);
    return Update(name);
  }
  std::string LastSaid() { return dialogs.said.empty() ? "" : dialogs.said.back().text; }
  std::string LastTitle() { return dialogs.said.empty() ? "" : dialogs.said.back().title; }

  // Every file below drive C: with its bytes, but for what a kill leaves to be swept.
  std::map<std::string, std::string> Everything() {
    namespace fs = std::filesystem;
    std::map<std::string, std::string> out;
    const std::string root = home.path() + "/drive_c/";
    for (const auto& e : fs::recursive_directory_iterator(root))
      if (e.is_regular_file()) {
        const std::string name = e.path().string().substr(root.size());
        if (!name.ends_with('~')) out[name] = home.Get("drive_c/" + name);
      }
    return out;
  }

  FailingIo io;
  TempHome home{io};
  ScriptedDialogs dialogs;
  FixedClock clock;
  KeptDisplay display;
  Settings settings;
  CurrentName current;
  DownloadEntries entries;
  size_t mostHeld = 32u << 20;
};

}  // namespace kora::test
