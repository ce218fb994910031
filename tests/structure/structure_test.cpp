// Reads the sources themselves: Qt stays where it belongs, nothing looks up a floor, and
// nothing tells where on a machine it was written.

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <regex>
#include <set>
#include <string>
#include <vector>

#include "tests/support/places.h"

namespace fs = std::filesystem;

namespace {

const fs::path kRoot = kora::SourceDir();

// What each room may include besides itself.
const std::map<std::string, std::set<std::string>>& Allowed() {
  static const std::map<std::string, std::set<std::string>> table = [] {
    std::map<std::string, std::set<std::string>> t;
    t["base"] = {};
    t["platform"] = {"base"};
    t["settings"] = {"base", "platform"};
    t["store"] = {"base", "platform", "settings"};
    t["looks"] = t["lists"] = {"base", "platform", "settings", "store"};
    t["chart"] = {"base", "platform", "settings", "store", "looks", "lists"};
    t["indicators"] = t["chart"];
    t["indicators"].insert("chart");
    t["chartwindow"] = t["indicators"];
    t["chartwindow"].insert("indicators");
    for (const char* room : {"adjust", "update", "scans", "maintenance", "names", "companies"})
      t[room] = {"base", "platform", "settings", "store", "lists"};
    t["update"].insert("adjust");
    for (const char* room : {"names", "companies"}) t[room].insert("update");
    for (const auto& [room, below] : std::map(t)) t["shell"].insert(room);
    t["demo"] = t["chartwindow"];
    for (const char* program : {"kora", "koractl"}) {
      t[program] = t["shell"];
      t[program].insert("shell");
    }
    for (const char* program : {"kora", "koractl"}) t[program].insert({"demo", "revision"});
    t["revision"] = {"base"};
    return t;
  }();
  return table;
}

bool IsSource(const fs::path& path) {
  const std::string ext = path.extension().string();
  return ext == ".h" || ext == ".cpp";
}

std::string ReadText(const fs::path& path) {
  std::ifstream in(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

struct Include {
  fs::path file;     // below src
  std::string name;  // between the quotes or brackets
};

std::vector<Include> IncludesOf(const fs::path& file, const std::string& text) {
  static const std::regex line(R"(^[ \t]*#[ \t]*include[ \t]*[<"]([^>"]+)[>"])",
                               std::regex::ECMAScript | std::regex::multiline);
  std::vector<Include> out;
  for (std::sregex_iterator it(text.begin(), text.end(), line), end; it != end; ++it)
    out.push_back({file, (*it)[1]});
  return out;
}

std::string Room(const std::string& path) { return path.substr(0, path.find('/')); }

bool MayUseQt(const fs::path& file) {
  const std::string path = file.generic_string();
  return path.starts_with("platform/qt/") || path.find("/forms/") != std::string::npos ||
         path.starts_with("kora/") || path.starts_with("koractl/");
}

bool IsQt(const std::string& include) {
  return include.size() > 1 && include[0] == 'Q' &&
         ((include[1] >= 'A' && include[1] <= 'Z') || include[1] == 't');
}

// What is wrong with an include, or nothing.
std::string Fault(const Include& include) {
  const std::string file = include.file.generic_string();
  if (IsQt(include.name))
    return MayUseQt(include.file) ? "" : file + " includes Qt: " + include.name;
  const std::string room = Room(file), other = Room(include.name);
  if (!Allowed().contains(room)) return file + ": a room that the table of floors lacks";
  if (include.name.find('/') == std::string::npos || !Allowed().contains(other)) return "";
  if (!MayUseQt(include.file) && MayUseQt(include.name))
    return file + " looks at Qt through " + include.name;
  if (other == room || Allowed().at(room).contains(other)) return "";
  return file + " looks up: " + include.name;
}

std::vector<Include> AllIncludes() {
  std::vector<Include> out;
  const auto read = [&out](const fs::path& folder, const fs::path& top) {
    for (const auto& entry : fs::recursive_directory_iterator(folder)) {
      if (!entry.is_regular_file() || !IsSource(entry.path())) continue;
      const auto some = IncludesOf(fs::relative(entry.path(), top), ReadText(entry.path()));
      out.insert(out.end(), some.begin(), some.end());
    }
  };
  read(kRoot / "src", kRoot / "src");
  read(kRoot / "demo", kRoot);
  return out;
}

}  // namespace

TEST(StructureTest, QtStaysInItsRoomsAndNothingLooksUp) {
  const auto includes = AllIncludes();
  EXPECT_GT(includes.size(), 100u);
  for (const Include& include : includes) EXPECT_EQ(Fault(include), "");
}

// One program holds them all: of two with one name either may be taken for the other.
TEST(StructureTest, NoTwoHeadersGiveOneNameToTheirConstants) {
  const std::regex constant(R"(inline constexpr [^;=]*?\b(k[A-Z]\w*)\s*[\[{=;])");
  std::map<std::string, std::string> seen;
  for (const auto& entry : fs::recursive_directory_iterator(kRoot / "src")) {
    if (entry.path().extension() != ".h") continue;
    const std::string text = ReadText(entry.path());
    for (std::sregex_iterator it(text.begin(), text.end(), constant), end; it != end; ++it) {
      const auto [first, fresh] = seen.emplace((*it)[1], entry.path().filename().string());
      EXPECT_TRUE(fresh) << (*it)[1] << " of " << first->second << " and "
                         << entry.path().filename().string();
    }
  }
  EXPECT_GT(seen.size(), 50u);
}

TEST(StructureTest, RulesCatchWhatTheyForbid) {
  EXPECT_NE(Fault({"base/x.cpp", "QString"}), "");
  EXPECT_NE(Fault({"chart/x.cpp", "QtWidgets/QWidget"}), "");
  EXPECT_NE(Fault({"platform/headless/x.cpp", "platform/qt/qt_surface.h"}), "");
  EXPECT_NE(Fault({"base/x.cpp", "platform/clock.h"}), "");
  EXPECT_NE(Fault({"store/x.cpp", "chart/composer.h"}), "");
  EXPECT_NE(Fault({"update/x.cpp", "scans/scan.h"}), "");
  EXPECT_NE(Fault({"demo/x.cpp", "update/day_line.h"}), "");
  EXPECT_NE(Fault({"shell/x.cpp", "demo/demo_market.h"}), "");
  EXPECT_NE(Fault({"attic/x.cpp", "base/text.h"}), "");
  EXPECT_EQ(Fault({"chart/x.cpp", "store/name_rec.h"}), "");
  EXPECT_EQ(Fault({"chart/forms/ChtSel.cpp", "QDialog"}), "");
  EXPECT_EQ(Fault({"kora/main.cpp", "shell/session.h"}), "");
  const auto found =
      IncludesOf("a.cpp", "// #include <x>\n#include \"base/a.h\"\n #  include <QFont>\n");
  ASSERT_EQ(found.size(), 2u);
  EXPECT_EQ(found[1].name, "QFont");
}

// Paths of the machine that something was written on have no place in what is handed on.
TEST(StructureTest, NothingNamesAPathOfTheMachine) {
  std::string places;
  for (const char* place : {"root", "work"})
    places += (places.empty() ? "" : "|") + std::string(place);
  const std::regex path("(^|[^A-Za-z0-9_.}/\\)-])/(" + places + ")/[A-Za-z0-9_.]",
                        std::regex::ECMAScript | std::regex::multiline);
  const auto names = [&](const std::string& text) { return std::regex_search(text, path); };
  EXPECT_TRUE(names(std::string("cd /") + "root/x"));
  EXPECT_TRUE(names(std::string("\"/") + "work/main/src\""));
  EXPECT_FALSE(names("demo/work/x ${HOME}/work/x"));

  const std::set<std::string> kinds = {".h",   ".cpp",     ".md",   ".txt", ".cmake", ".json",
                                       ".sh",  ".yml",     ".yaml", ".py",  ".in",    ".html",
                                       ".css", ".desktop", ".ui",   ".qrc"};
  int seen = 0;
  for (const auto& top : fs::directory_iterator(kRoot)) {
    const std::string name = top.path().filename().string();
    if (name.starts_with("build") || name == ".git") continue;
    std::vector<fs::path> files;
    if (top.is_regular_file()) files.push_back(top.path());
    if (top.is_directory())
      for (const auto& entry : fs::recursive_directory_iterator(top.path()))
        if (entry.is_regular_file()) files.push_back(entry.path());
    for (const fs::path& file : files) {
      if (!kinds.contains(file.extension().string())) continue;
      ++seen;
      std::ifstream in(file);
      std::string line;
      for (int n = 1; std::getline(in, line); ++n)
        if (line.find('/') != std::string::npos && line.size() < 4096) {
          EXPECT_FALSE(names(line)) << fs::relative(file, kRoot) << ":" << n;
        }
    }
  }
  EXPECT_GT(seen, 50);
}
