// An installation into a folder of its own: that all is there, agrees, and runs wherever it lies.

#include <gtest/gtest.h>

#include <filesystem>
#include <regex>

#include "base/version.h"
#include "tests/support/help_text.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

namespace fs = std::filesystem;

namespace kora::test {
namespace {

const std::string kId = "org.koracharting.kora";

// A program of the system, or nothing where it is not installed.
std::string Tool(const std::string& name) {
  for (const char* folder : {"/usr/bin/", "/bin/", "/usr/local/bin/"})
    if (fs::exists(folder + name)) return folder + name;
  return {};
}

class Installed : public testing::Test {
 protected:
  static void SetUpTestSuite() {
    place = new TempHome;
    const ProgramResult result =
        RunProgram(KORA_CMAKE, {"--install", BinDir() + "/..", "--prefix", place->path() + "/usr"});
    ASSERT_EQ(result.code, 0) << result.err;
  }
  static void TearDownTestSuite() {
    delete place;
    place = nullptr;
  }

  static std::string Path(const std::string& name) { return place->path() + "/usr/" + name; }
  static std::string Get(const std::string& name) { return place->Get("usr/" + name); }
  static ProgramResult Koractl(const std::vector<std::string>& words) {
    return RunProgram(Path("bin/koractl"), words);
  }
  // A check of the system's that has nothing to say.
  static void ExpectQuiet(const std::string& tool, const std::vector<std::string>& words) {
    const ProgramResult result = RunProgram(tool, words);
    EXPECT_EQ(result.code, 0) << tool << ": " << result.out << result.err;
    EXPECT_EQ(result.err, "") << tool;
  }

  static TempHome* place;
};
TempHome* Installed::place = nullptr;

// The value of a line "Key=value".
std::string ValueOf(const std::string& text, const std::string& key) {
  const size_t at = text.find("\n" + key + "=");
  if (at == text.npos) return {};
  const size_t from = at + key.size() + 2;
  return text.substr(from, text.find('\n', from) - from);
}

TEST_F(Installed, RunsFromWhereverItLies) {
  TempHome home;
  const std::string kora = home.path() + "/kora", png = home.path() + "/a.png";
  ASSERT_EQ(Koractl({"--home", kora, "demo", "--securities", "5", "--years", "1"}).code, 0);
  const std::string names = Koractl({"--home", kora, "names"}).out;
  std::smatch code;
  ASSERT_TRUE(std::regex_search(names, code, std::regex("\n1\t0\t([A-Z]+)\t")));
  const std::vector<std::string> draw{"--home", kora, "chart", code[1], "--out", png};
  ProgramResult result = Koractl(draw);
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_EQ(home.Get("a.png").substr(1, 3), "PNG");

  // Moved as a whole, and started through a link from elsewhere.
  fs::remove(png);
  fs::rename(Path(""), place->path() + "/else where");
  fs::create_symlink(place->path() + "/else where/bin/koractl", home.path() + "/link");
  result = RunProgram(home.path() + "/link", draw);
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_TRUE(fs::exists(png));
  fs::rename(place->path() + "/else where", Path(""));
}

TEST_F(Installed, WithoutTheModulePicturesAreRefusedAndScriptsAreNot) {
  std::string module;
  for (const auto& entry : fs::recursive_directory_iterator(Path("")))
    if (entry.path().filename() == "koractl_pictures.so") module = entry.path().string();
  ASSERT_NE(module, "");
  EXPECT_EQ(fs::path(module).parent_path().filename(), "kora");
  fs::rename(module, module + ".away");
  TempHome home;
  home.Put("a.cht", "L,10,10,300,200,255\r\n");
  ASSERT_EQ(Koractl({"--home", home.path(), "init"}).code, 0);
  const ProgramResult result = Koractl(
      {"--home", home.path(), "play", home.path() + "/a.cht", "--out", home.path() + "/a.png"});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("koractl_pictures.so can't be loaded, it is not there"),
            std::string::npos)
      << result.err;
  fs::rename(module + ".away", module);
}

TEST_F(Installed, BothProgramsTellTheSameVersionAndRevision) {
  const std::string kora = RunProgram(Path("bin/kora"), {"--version"}).out;
  EXPECT_TRUE(kora.starts_with("kora " + std::string(kVersion) + " (revision ")) << kora;
  EXPECT_EQ("kora" + Koractl({"--version"}).out.substr(7), kora);
  EXPECT_NE(Get("share/metainfo/" + kId + ".metainfo.xml")
                .find("<release version=\"" + std::string(kVersion) + "\""),
            std::string::npos);
}

TEST_F(Installed, TheWholeGuideIsWhereTheProgramLooksForIt) {
  int pages = 0;
  for (const auto& entry : fs::recursive_directory_iterator(SourceDir() + "/docs/guide")) {
    if (!entry.is_regular_file()) continue;
    ++pages;
    const std::string name = fs::relative(entry.path(), SourceDir() + "/docs/guide").string();
    EXPECT_TRUE(fs::exists(Path("bin/../share/kora/guide/" + name))) << name;
  }
  EXPECT_GT(pages, 20);
}

TEST_F(Installed, TheDesktopFindsProgramIconAndCharts) {
  const std::string desktop = Get("share/applications/" + kId + ".desktop");
  EXPECT_EQ(ValueOf(desktop, "Exec"), "kora %f");
  EXPECT_TRUE(fs::exists(Path("bin/kora")));
  const std::string icon = ValueOf(desktop, "Icon");
  const std::string icons = "share/icons/hicolor/";
  EXPECT_NE(Get(icons + "scalable/apps/" + icon + ".svg").find("<svg"), std::string::npos);
  for (const int size : {16, 22, 24, 32, 48, 64, 128, 256}) {
    const std::string folder = std::to_string(size) + "x" + std::to_string(size);
    const std::string png = Get(icons + folder + "/apps/" + icon + ".png");
    ASSERT_GT(png.size(), 24u) << size;
    EXPECT_EQ(png.substr(1, 3), "PNG");
    // Width and height stand behind the head of the first chunk, highest byte first.
    EXPECT_EQ((unsigned char)png[18] * 256 + (unsigned char)png[19], size);
    EXPECT_EQ((unsigned char)png[22] * 256 + (unsigned char)png[23], size);
  }
  const std::string type = ValueOf(desktop, "MimeType");
  ASSERT_TRUE(type.ends_with(";"));
  const std::string mime = Get("share/mime/packages/" + kId + ".xml");
  EXPECT_NE(mime.find("type=\"" + type.substr(0, type.size() - 1) + "\""), std::string::npos);
  EXPECT_NE(mime.find("pattern=\"*.cht\""), std::string::npos);
}

TEST_F(Installed, TheDesktopFileIsValid) {
  const std::string tool = Tool("desktop-file-validate");
  if (tool.empty()) GTEST_SKIP() << "desktop-file-validate is not installed";
  ExpectQuiet(tool, {Path("share/applications/" + kId + ".desktop")});
}

TEST_F(Installed, TheMetainfoIsValid) {
  const std::string tool = Tool("appstreamcli");
  if (tool.empty()) GTEST_SKIP() << "appstreamcli is not installed";
  ExpectQuiet(tool, {"validate", "--no-net", Path("share/metainfo/" + kId + ".metainfo.xml")});
}

TEST_F(Installed, TheMimeTypeIsTaken) {
  const std::string tool = Tool("update-mime-database");
  if (tool.empty()) GTEST_SKIP() << "update-mime-database is not installed";
  const ProgramResult result = RunProgram(tool, {"-V", Path("share/mime")});
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_EQ(result.err.find(kId), std::string::npos) << result.err;
  EXPECT_NE(Get("share/mime/globs2").find("application/x-kora-chart:*.cht"), std::string::npos);
}

TEST_F(Installed, TheManualPagesAreQuiet) {
  const std::string tool = Tool("man");
  if (tool.empty() || Tool("groff").empty()) GTEST_SKIP() << "man or groff is not installed";
  for (const char* page : {"kora", "koractl"})
    for (const char* width : {"80", "120"}) {
      const ProgramResult result =
          RunProgram(tool,
                     {"--warnings", "-E", "UTF-8", "-l", "-Tutf8", "-Z",
                      Path("share/man/man1/" + std::string(page) + ".1")},
                     {"MANWIDTH=" + std::string(width), "LC_ALL=C.UTF-8", "MANROFFSEQ="});
      EXPECT_EQ(result.code, 0) << page;
      EXPECT_EQ(result.err, "") << page;
      EXPECT_GT(result.out.size(), 1000u) << page;
    }
}

// The text of a page as roff has it, with its hyphens plain.
std::string Plain(std::string page) {
  for (const char* mark : {"\\-", "\\fB", "\\fI", "\\fR", "\\:"})
    for (size_t at; (at = page.find(mark)) != page.npos;)
      page.replace(at, std::string(mark).size(), std::string(mark) == "\\-" ? "-" : "");
  return page;
}

TEST_F(Installed, TheManualPageOfKoractlHasEveryCommandAndOption) {
  const std::string page = Plain(Get("share/man/man1/koractl.1"));
  const auto commands = WordsUnder(Koractl({"--help"}).out, "Subcommands:");
  EXPECT_GT(commands.size(), 30u);
  for (const std::string& command : commands) {
    const size_t from = page.find("\n.SS " + command + "\n");
    ASSERT_NE(from, page.npos) << command;
    // Up to the next command that is none of its own.
    size_t to = page.find("\n.SS ", from + 5);
    while (to != page.npos && page.compare(to + 5, command.size() + 1, command + " ") == 0)
      to = page.find("\n.SS ", to + 5);
    const std::string section = page.substr(from, to - from);
    for (const std::string& name : WordsUnder(Koractl({command, "--help"}).out, "Options:")) {
      if (name == "-h,--help") continue;  // of every command, and told once
      EXPECT_TRUE(section.find("\n" + name + "\n") != section.npos ||
                  section.find("\n" + name + " ") != section.npos)
          << command << " " << name;
    }
  }
}

TEST_F(Installed, TheManualPageOfKoraHasEveryOptionAndWord) {
  const std::string page = Plain(Get("share/man/man1/kora.1"));
  const std::string help = RunProgram(Path("bin/kora"), {"--help"}).out;
  const auto options = WordsUnder(help, "Options:"), words = WordsUnder(help, "Words:");
  EXPECT_EQ(options.size(), 4u);
  EXPECT_EQ(words.size(), 5u);
  EXPECT_NE(page.find("-h, --help"), page.npos);
  for (const std::string& option : options)
    EXPECT_NE(page.find(option == "-h,--help" ? "--help" : option), page.npos) << option;
  for (const std::string& word : words)
    EXPECT_NE(page.find("\n.B " + word + "\n"), page.npos) << word;
}

TEST_F(Installed, TheShellsFindTheirCompletions) {
  for (const char* file :
       {"bash-completion/completions/kora", "bash-completion/completions/koractl",
        "zsh/site-functions/_kora", "zsh/site-functions/_koractl",
        "fish/vendor_completions.d/kora.fish", "fish/vendor_completions.d/koractl.fish"})
    EXPECT_TRUE(fs::exists(Path(std::string("share/") + file))) << file;
}

}  // namespace
}  // namespace kora::test
