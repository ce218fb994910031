// Many charts by one process, and what pictures cost those who draw none.

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>

#include "lists/chart_list.h"
#include "store/name_rec.h"
#include "tests/support/places.h"
#include "tests/support/program.h"
#include "tests/support/temp_home.h"

using namespace kora;
using namespace kora::test;

namespace {

using Words = std::vector<std::string>;
constexpr const char* kData = "kora/drive_c/korawin/data/";

class ManyCharts : public ::testing::Test {
 protected:
  void SetUp() override {
    ASSERT_EQ(Run({"init"}).code, 0);
    for (const std::string code : {"AAA", "BBB", "CCC"})
      home.Put(code + ".csv", code + ",20240104,1,3,1,2,100,0\n" + code +
                                  ",20240105,2,4,2,3,300,0\n" + code + ",20240108,3,6,3,5,200,0\n");
    ASSERT_EQ(Run({"import", home.path() + "/AAA.csv", home.path() + "/BBB.csv",
                   home.path() + "/CCC.csv"})
                  .code,
              0);
  }
  ProgramResult Run(Words words) {
    words.insert(words.begin(), {"--home", home.path() + "/kora"});
    return RunProgram(program, words);
  }
  std::string Folder() const { return home.path() + "/out/"; }
  std::vector<std::string> Made() {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(Folder()))
      names.push_back(entry.path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
  }
  void ExpectUsage(const Words& words, const std::string& part) {
    const ProgramResult result = Run(words);
    EXPECT_EQ(result.code, 2) << part;
    EXPECT_NE(result.err.find(part), std::string::npos) << result.err;
    EXPECT_FALSE(std::filesystem::exists(Folder()));
  }
  void PutList(char letter, std::initializer_list<const char*> codes) {
    std::string bytes;
    for (const char* code : codes) {
      ListRec rec{1, {}};  // numbers that are out of date do not matter here
      rec.ListCode.set(code);
      bytes.append(reinterpret_cast<const char*>(&rec), sizeof rec);
    }
    home.Put(std::string(kData) + "SubList" + letter + ".Dat", bytes);
  }

  TempHome home;
  std::string program = BinDir() + "/koractl";
};

TEST_F(ManyCharts, EachCodeGetsAFileThatIsTheOneOfItsOwnCommand) {
  const ProgramResult result = Run({"chart", "aaa", "CCC", "AAA", "--out", Folder()});
  EXPECT_EQ(result.code, 0) << result.err;
  EXPECT_EQ(result.err, "");
  EXPECT_EQ(Made(), (Words{"AAA.png", "CCC.png"}));
  ASSERT_EQ(Run({"chart", "CCC", "--out", home.path() + "/c.png"}).code, 0);
  EXPECT_EQ(home.Get("out/CCC.png"), home.Get("c.png"));
}

TEST_F(ManyCharts, TypeSaysWhatTheFilesAre) {
  for (const char* type : {"svg", "pdf", "cht"})
    ASSERT_EQ(Run({"chart", "AAA", "--type", type, "--out", Folder()}).code, 0);
  EXPECT_EQ(Made(), (Words{"AAA.cht", "AAA.pdf", "AAA.svg"}));
  EXPECT_EQ(home.Get("out/AAA.cht"), Run({"chart", "AAA", "--out", "-"}).out);
  EXPECT_EQ(home.Get("out/AAA.pdf").substr(0, 5), "%PDF-");
}

TEST_F(ManyCharts, ACodeThatFailsIsToldAndTheOthersAreMade) {
  home.Put(std::string(kData) + "BBB.WDT", "");
  const ProgramResult result =
      Run({"chart", "AAA", "BBB", "XYZ", "..\\X", "CCC", "--osc", "RSI", "--out", Folder()});
  EXPECT_EQ(result.code, 1);
  EXPECT_EQ(Made(), (Words{"AAA.png", "CCC.png"}));
  EXPECT_NE(result.err.find("[Chart Display] BBB: No Data for BBB.WDT"), std::string::npos);
  EXPECT_NE(result.err.find("[Name File] XYZ: No File For That Name\n"), std::string::npos);
  EXPECT_NE(result.err.find("[Name File] ..\\X: No File For That Name\n"), std::string::npos);
  EXPECT_NE(result.err.find("[KORA] 3 of 5 charts could not be made\n"), std::string::npos);
}

TEST_F(ManyCharts, AFailureLeavesTheFileThatWasThere) {
  home.Put("out/BBB.png", "old");
  home.Put(std::string(kData) + "BBB.WDT", "");
  EXPECT_EQ(Run({"chart", "BBB", "AAA", "--out", Folder()}).code, 1);
  EXPECT_EQ(Made(), (Words{"AAA.png", "BBB.png"}));
  EXPECT_EQ(home.Get("out/BBB.png"), "old");
}

TEST_F(ManyCharts, AFileThatCannotBeWrittenIsToldAndTheOthersAreMade) {
  std::filesystem::create_directories(Folder() + "BBB.png");
  const ProgramResult result = Run({"chart", "--list", "names", "--out", Folder()});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("[KORA] BBB: " + Folder() + "BBB.png: "), std::string::npos)
      << result.err;
  EXPECT_EQ(Made(), (Words{"AAA.png", "BBB.png", "CCC.png"}));
}

TEST_F(ManyCharts, AListGivesItsCodesAndTheNameFileAll) {
  PutList('B', {"CCC", "AAA", "GONE", "CCC"});
  const ProgramResult result = Run({"chart", "--list", "b", "--type", "cht", "--out", Folder()});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("[Name File] GONE: No File For That Name"), std::string::npos);
  EXPECT_NE(result.err.find("1 of 3 charts"), std::string::npos);
  EXPECT_EQ(Made(), (Words{"AAA.cht", "CCC.cht"}));
  // The file letters skip I: J is the ninth list, K the tenth, Z that of the scans.
  PutList('J', {"BBB"});
  EXPECT_EQ(Run({"chart", "--list", "J", "--type", "cht", "--out", Folder()}).code, 0);
  EXPECT_EQ(Made(), (Words{"AAA.cht", "BBB.cht", "CCC.cht"}));
  PutList('Z', {"AAA"});
  EXPECT_EQ(Run({"chart", "--list", "Z", "--type", "svg", "--out", Folder()}).code, 0);
  EXPECT_EQ(Made().size(), 4u);
  EXPECT_EQ(Run({"chart", "--list", "names", "--out", Folder()}).code, 0);
  EXPECT_EQ(Made().size(), 7u);
  EXPECT_EQ(Run({"chart", "--list", "A", "--out", Folder()}).code, 0);  // no such list: no codes
}

TEST_F(ManyCharts, CommandLinesThatMakeNoSense) {
  ExpectUsage({"chart", "--out", Folder()}, "Either CODE or --list");
  ExpectUsage({"chart", "AAA", "--list", "A", "--out", Folder()}, "Either CODE or --list");
  ExpectUsage({"chart", "--list", "I", "--out", Folder()}, "--list");
  ExpectUsage({"chart", "AAA", "--type", "gif", "--out", Folder()}, "--type");
  ExpectUsage({"chart", "AAA", "BBB", "--out", home.path() + "/a.png"}, "folder");
  ExpectUsage({"chart", "AAA", "BBB", "--out", "-"}, "folder");
  ExpectUsage({"chart", "AAA", "--type", "png", "--out", home.path() + "/a.png"}, "--type");
}

TEST_F(ManyCharts, AFolderThatCannotBeMadeIsTold) {
  home.Put("out", "a file");
  const ProgramResult result = Run({"chart", "AAA", "--out", Folder()});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("[KORA] " + Folder() + " can't be made"), std::string::npos);
  EXPECT_EQ(home.Get("out"), "a file");
}

// Loading the toolkit takes many times what a script does.
TEST_F(ManyCharts, TheProgramIsLoadedWithoutTheToolkit) {
  const ProgramResult libraries = RunProgram(program, {}, {"LD_TRACE_LOADED_OBJECTS=1"});
  EXPECT_NE(libraries.out.find("libc."), std::string::npos) << libraries.out;
  EXPECT_EQ(libraries.out.find("Qt"), std::string::npos) << libraries.out;
}

TEST_F(ManyCharts, WithoutItsModuleTheProgramWritesScriptsAndSaysWhyNoPictures) {
  const std::string png = home.path() + "/a.png";
  const std::string script = Run({"chart", "AAA", "--out", "-"}).out;
  program = home.path() + "/koractl";
  std::filesystem::copy_file(BinDir() + "/koractl", program);
  EXPECT_EQ(Run({"chart", "AAA", "--out", "-"}).out, script);
  for (const Words& words :
       {Words{"chart", "AAA", "--out", png}, Words{"print", "AAA", "--out", home.path() + "/a.pdf"},
        Words{"play", "a.cht", "--out", png}}) {
    const ProgramResult result = Run(words);
    EXPECT_EQ(result.code, 1);
    EXPECT_NE(result.err.find("[KORA] Pictures can't be drawn, only scripts"), std::string::npos);
    EXPECT_NE(result.err.find("koractl_pictures.so can't be loaded, it is not there"),
              std::string::npos)
        << result.err;
  }
  EXPECT_FALSE(home.Exists("a.png"));
  // What stands in its place is refused, and the folder's other charts are not tried.
  home.Put("koractl_pictures.so", "no module");
  const ProgramResult result = Run({"chart", "AAA", "BBB", "--out", Folder()});
  EXPECT_EQ(result.code, 1);
  EXPECT_NE(result.err.find("koractl_pictures.so can't be loaded: "), std::string::npos);
  EXPECT_EQ(result.err.find("koractl_pictures.so"), result.err.rfind("koractl_pictures.so can't"));
}

}  // namespace
