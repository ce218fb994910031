// Makes first inputs of fuzz targets from an invented market: make_seeds FOLDER. Those that a market
// has nothing for are written by hand, in fuzz/corpus.

#include <algorithm>
#include <cstdio>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "base/runtime_error.h"
#include "demo/demo_market.h"
#include "fuzz/readers.h"
#include "fuzz/small_home.h"
#include "store/price_rec.h"
#include "tests/support/places.h"

using namespace kora;
using namespace kora::test;
namespace fs = std::filesystem;

namespace {

class Seeds {
 public:
  explicit Seeds(fs::path folder) : folder_(std::move(folder)) {}

  void Add(const char* reader, const std::string& bytes) {
    if (!FindReader(reader)) throw std::runtime_error(reader);
    fs::create_directories(folder_ / reader);
    std::ofstream out(folder_ / reader / ("seed" + std::to_string(++count_)), std::ios::binary);
    out << bytes;
    if (!out.flush()) throw std::runtime_error("can't write to " + folder_.string());
  }
  // Behind each of some choices.
  void Choices(const char* reader, const std::vector<std::string>& choices,
               const std::string& bytes) {
    for (const std::string& choice : choices) Add(reader, choice + bytes);
  }
  int count() const { return count_; }

 private:
  fs::path folder_;
  int count_ = 0;
};

std::string Lines(const std::string& text, size_t most) {
  size_t at = 0;
  for (size_t n = 0; n < most && at < text.size(); ++n)
    at = std::min(text.find('\n', at), text.size() - 1) + 1;
  return text.substr(0, at);
}

std::string Last(const std::string& bytes, size_t size) {
  return bytes.substr(bytes.size() - std::min(bytes.size(), size));
}

const std::string kMark = "\n%%\n";

void MakeSeeds(Seeds& seeds) {
  ScriptedDialogs dialogs;
  MemoryIo io;
  Files files("home", io);
  SettingsFile ini(files, "C:\\WINDOWS\\Kora.ini"), user(files, "C:\\WINDOWS\\KoraUser.ini");
  MakeDemo(files, ini, user, dialogs, {.securities = 12, .years = 1, .seed = 7});
  int prices = 0, days = 0;
  for (const auto& [path, bytes] : io.Store()) {
    const std::string name = fs::path(path).filename().string();
    const std::string end = fs::path(path).extension().string();
    if (name == "Kora.ini") {
      seeds.Add("settings", bytes + kMark + "Charts" + kMark + "Type" + kMark + "C");
      seeds.Add("settings", Lines(bytes, 20));
    }
    if (name == "KoraUser.ini") seeds.Add("settings", bytes);
    if (name == "Names.dat") seeds.Add("names", Lines(bytes, 1'000'000).substr(0, 8 * 96));
    if (name.starts_with("SubList")) seeds.Add("lists", bytes.substr(0, 20 * 8));
    if (name == "IndClass.dat") seeds.Add("classes", Lines(bytes, 30));
    if (end == ".WDT" && ++prices <= 4) {
      seeds.Add("prices", Last(bytes, 12 * sizeof(PriceRec)));
      const std::string quarter = Last(bytes, 70 * sizeof(PriceRec));
      for (int style = 0; style < 4; ++style)
        seeds.Add("charts",
                  std::string{char(0x20 + style), char(prices * 5 + style * 2), '\x06', '\x03'} +
                      quarter);
      seeds.Add("scans", '\x3F' + Last(bytes, 40 * sizeof(PriceRec)));
    }
    if ((end == ".D" || end == ".d") && ++days <= 2) {
      seeds.Add("daylines", '0' + Lines(bytes, 6));
      seeds.Choices("download", {"10", "30", "42"}, Lines(bytes, 8));
    }
  }
  for (const char* folder : {"charts", "views"}) {
    int scripts = 0;
    for (const auto& entry :
         fs::directory_iterator(fs::path(kora::SourceDir()) / "tests" / "golden" / folder)) {
      std::ifstream in(entry.path(), std::ios::binary);
      const std::string text{std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
      if (++scripts <= 12) seeds.Add("script", Lines(text, 40));
    }
  }
}

}  // namespace

int main(int argc, char** argv) {
  if (argc != 2) {
    std::fprintf(stderr, "make_seeds FOLDER\n");
    return 2;
  }
  Seeds seeds(argv[1]);
  try {
    MakeSeeds(seeds);
  } catch (const std::exception& e) {
    std::fprintf(stderr, "%s\n", e.what());
    return 1;
  }
  std::printf("%d seeds\n", seeds.count());
  return 0;
}
