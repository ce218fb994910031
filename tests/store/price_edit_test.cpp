#include "store/price_edit.h"

#include <gtest/gtest.h>

#include <filesystem>

#include "store/chart_notes.h"
#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kPath = "c:\\data\\ORE.WDT";
constexpr const char* kHost = "drive_c/data/ORE.WDT";

PriceRec Day(std::string_view date, float close) {
  PriceRec rec = NewPriceRec(date);
  rec.Close = close;
  return rec;
}

TEST(PriceEditTest, ReadsChangesAndPutsInPlaceWithTheOldFileBeside) {
  TempHome home;
  const std::string old = Bytes<PriceRec>({Day("20240101", 1), Day("20240102", 2)}) + "torn";
  home.Put(kHost, old);
  home.Put("drive_c/data/ORE.OLD", "older");
  PriceEdit edit(home.files(), kPath);
  ASSERT_EQ(edit.records().size(), 2u);
  edit.records().erase(edit.records().begin());
  FileSet set(home.files());
  edit.KeepOld(set);
  edit.Save(set);
  EXPECT_EQ(home.Get(kHost), old);
  set.Commit();
  EXPECT_EQ(home.Get(kHost), Bytes<PriceRec>({Day("20240102", 2)}));
  EXPECT_EQ(home.Get("drive_c/data/ORE.OLD"), old);
}

TEST(PriceEditTest, AKillAnywhereLeavesThePriceFile) {
  const std::string old = Bytes<PriceRec>({Day("20240101", 1)});
  const std::string fresh = Bytes<PriceRec>({Day("20240101", 1), Day("20240102", 2)});
  for (int at = 1;; ++at) {
    FailingIo io;
    TempHome home(io);
    home.Put(kHost, old);
    PriceEdit edit(home.files(), kPath);
    edit.records().push_back(Day("20240102", 2));
    io.Reset(at);
    io.lasting = io.torn = true;
    ErrorOf([&] {
      FileSet set(home.files());
      edit.KeepOld(set);
      edit.Save(set);
      set.Commit();
    });
    const std::string now = home.Get(kHost);
    EXPECT_TRUE(now == old || now == fresh) << at;
    if (now == fresh) {
      EXPECT_EQ(home.Get("drive_c/data/ORE.OLD"), old) << at;
    }
    if (io.calls < at) break;
  }
}

TEST(PriceEditTest, SeesThatAnotherProgramChangedTheFile) {
  TempHome home;
  home.Put(kHost, Bytes<PriceRec>({Day("20240101", 1)}));
  const PriceEdit edit(home.files(), kPath);
  EXPECT_FALSE(edit.Changed());
  home.files().WriteAll(kPath, Bytes<PriceRec>({Day("20240101", 2)}));
  EXPECT_TRUE(edit.Changed());
}

TEST(PriceEditTest, RefusesWhatCannotBeNumberedAndWhatIsNotThere) {
  TempHome home;
  EXPECT_EQ(ErrorOf([&] { PriceEdit(home.files(), "c:\\none.WDT"); }), kFileNotFound);
  home.Put(kHost, std::string(32768u * 50, ' '));
  EXPECT_EQ(ErrorOf([&] { PriceEdit(home.files(), kPath); }), kOverflow);
  home.Put(kHost, std::string(32767u * 50, ' '));
  PriceEdit edit(home.files(), kPath);
  edit.records().push_back(Day("20240101", 1));
  FileSet set(home.files());
  EXPECT_EQ(ErrorOf([&] { edit.Save(set); }), kOverflow);
  edit.records().pop_back();
  std::filesystem::permissions(home.path() + "/" + kHost, std::filesystem::perms(0444));
  EXPECT_EQ(ErrorOf([&] { edit.Save(set); }), kPathAccess);
}

TEST(PriceEditTest, TheOldFileStandsBesideUnderItsOwnName) {
  EXPECT_EQ(OldFilePath("c:\\a.b\\ORE.WDT"), "c:\\a.b\\ORE.OLD");
  EXPECT_EQ(OldFilePath("c:\\a.b\\ORE"), "c:\\a.b\\ORE.OLD");
  EXPECT_EQ(OldFilePath("A.B.wdt"), "A.B.OLD");
}

TEST(ChartNotesTest, AreReadFieldByFieldAndWrittenBack) {
  TempHome home;
  const std::string path = ChartNotesPath("c:\\misc\\", "ORE ");
  EXPECT_EQ(path, "c:\\misc\\ORE.Txt");
  EXPECT_TRUE(ReadChartNotes(home.files(), path).empty());
  home.Put("drive_c/misc/ore.txt",
           "T,8.25,20240102,5.00,Result out,255\r\n  \n T , 8.25 ,20240103, 4.5 , a b ,1,2\nT");
  const auto notes = ReadChartNotes(home.files(), path);
  ASSERT_EQ(notes.size(), 3u);
  EXPECT_EQ(notes[0].Date, "20240102");
  EXPECT_EQ(notes[0].Price, "5.00");
  EXPECT_EQ(notes[0].Text, "Result out");
  EXPECT_EQ(notes[0].Colour, "255");
  EXPECT_EQ(ChartNotesText(notes),
            "T,8.25,20240102,5.00,Result out,255\r\nT,8.25,20240103,4.5,a b,1\r\nT,,,,,\r\n");
}

TEST(ChartNotesTest, OfACodeThatCannotNameAFileAreRefused) {
  EXPECT_EQ(ErrorOf([] { ChartNotesPath("c:\\misc\\", "..\\x"); }), kBadFileName);
  EXPECT_EQ(ErrorOf([] { ChartNotesPath("c:\\misc\\", "NUL"); }), kBadFileName);
}

}  // namespace
}  // namespace kora::test
