#include "base/record_file.h"

#include <gtest/gtest.h>
#include <sys/stat.h>
#include <unistd.h>

#include "tests/support/error_of.h"
#include "tests/support/failing_io.h"
#include "tests/support/temp_home.h"

using namespace kora;
using kora::test::ErrorOf;
using kora::test::FailingIo;
using kora::test::TempHome;

namespace {

#pragma pack(push, 1)
struct Pair {
  char name[3];
  std::int16_t value;
};
#pragma pack(pop)
static_assert(sizeof(Pair) == 5);

using PairFile = RecordFile<Pair>;
const std::string kPath = "c:\\p.dat";

}  // namespace

TEST(RecordFileTest, CountTruncates) {
  TempHome home;
  for (const auto& [bytes, count] : {std::pair(0, 0), {4, 0}, {5, 1}, {9, 1}, {10, 2}}) {
    home.Put("drive_c/p.dat", std::string(size_t(bytes), 'x'));
    EXPECT_EQ(PairFile(home.files(), kPath).count(), count) << bytes;
  }
}

TEST(RecordFileTest, RecordsAreNumberedFromOne) {
  TempHome home;
  home.Put("drive_c/p.dat", std::string("abc\x01\x02"
                                        "def\x03\x04",
                                        10));
  const PairFile file(home.files(), kPath);
  EXPECT_EQ(int(file.Read(1).value), 0x0201);  // little-endian
  EXPECT_EQ(std::string_view(file.Read(2).name, 3), "def");
}

TEST(RecordFileTest, NumberOutsideTheFileIsError63) {
  TempHome home;
  home.Put("drive_c/p.dat", std::string(14, 'x'));  // two records and a torn one
  PairFile file(home.files(), kPath, OpenMode::kReadWrite);
  EXPECT_EQ(ErrorOf([&] { file.Read(0); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Read(-1); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Read(3); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Read(0x7FFFFFFF); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Write(0, {}); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Write(4, {}); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Truncate(3); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.Truncate(-1); }), 63);
  EXPECT_EQ(home.Get("drive_c/p.dat"), std::string(14, 'x'));
}

TEST(RecordFileTest, FileThatShrankUnderTheReaderIsError63AndNoZeroedRecord) {
  TempHome home;
  home.Put("drive_c/p.dat", std::string(10, 'x'));
  PairFile file(home.files(), kPath);
  ASSERT_EQ(::truncate((home.path() + "/drive_c/p.dat").c_str(), 7), 0);
  EXPECT_EQ(ErrorOf([&] { file.Read(2); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.ReadAll(); }), 63);
  file.Refresh();
  EXPECT_EQ(file.count(), 1);
  EXPECT_EQ(file.ReadAll().size(), 1u);
}

TEST(RecordFileTest, AppendWritesOverATornTail) {
  TempHome home;
  home.Put("drive_c/p.dat", "abcABtorn");
  PairFile file(home.files(), kPath, OpenMode::kReadWrite);
  file.Append({{'n', 'e', 'w'}, 0x4443});
  EXPECT_EQ(file.count(), 2);
  EXPECT_EQ(home.Get("drive_c/p.dat"), "abcABnewCD");
}

TEST(RecordFileTest, ReadsARunAndNothingBeyond) {
  TempHome home;
  home.Put("drive_c/p.dat", "aaaAABBBBBcccCC");
  const PairFile file(home.files(), kPath);
  std::vector<Pair> run(2);
  file.ReadRun(2, run);
  EXPECT_EQ(run[0].name[0], 'B');
  EXPECT_EQ(run[1].name[0], 'c');
  EXPECT_EQ(ErrorOf([&] { file.ReadRun(3, run); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.ReadRun(0x7FFFFFFF, run); }), 63);
  EXPECT_EQ(ErrorOf([&] { file.ReadRun(99, {}); }), 0);  // nothing asked, nothing read
}

TEST(RecordFileTest, WritesARunAndTruncates) {
  TempHome home;
  PairFile file(home.files(), kPath, OpenMode::kCreate);
  const Pair run[] = {{{'a', 'a', 'a'}, 0x4141}, {{'b', 'b', 'b'}, 0x4242}};
  file.WriteRun(1, run);
  file.WriteRun(2, run);
  EXPECT_EQ(file.count(), 3);
  EXPECT_EQ(home.Get("drive_c/p.dat"), "aaaAAaaaAAbbbBB");
  file.Truncate(1);
  EXPECT_EQ(file.count(), 1);
  EXPECT_EQ(home.Get("drive_c/p.dat"), "aaaAA");
}

TEST(RecordFileTest, FolderOrPipeInThePlaceOfTheFileIsError75) {
  TempHome home;
  home.Put("drive_c/p.dat/inner", "x");
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), kPath); }), 75);
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), kPath, OpenMode::kReadWrite); }), 75);
  ASSERT_EQ(::mkfifo((home.path() + "/drive_c/pipe").c_str(), 0600), 0);
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), "c:\\pipe"); }), 75);
  EXPECT_EQ(ErrorOf([&] { home.files().ReadAll("c:\\pipe"); }), 75);
}

TEST(RecordFileTest, MissingFileIsError53AndMissingFolder76) {
  TempHome home;
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), kPath); }), 53);
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), "c:\\none\\p.dat"); }), 76);
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), "c:\\none\\p.dat", OpenMode::kCreate); }), 76);
  EXPECT_FALSE(home.Exists("drive_c/p.dat"));
}

TEST(RecordFileTest, FileOfGigabytesIsNotReadIntoMemory) {
  TempHome home;
  home.Put("drive_c/p.dat", "");
  const std::string host = home.path() + "/drive_c/p.dat";
  ASSERT_EQ(::truncate(host.c_str(), 5'000'000'000), 0);  // a hole, no blocks on the disk
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), kPath).ReadAll(); }), 7);
  EXPECT_EQ(int(PairFile(home.files(), kPath).Read(1'000'000'000).value), 0);
  ASSERT_EQ(::truncate(host.c_str(), 5ll * 0x80000000), 0);
  EXPECT_EQ(ErrorOf([&] { PairFile(home.files(), kPath); }), 6);  // more than 31 bits of records
}

TEST(RecordFileTest, FailedAppendIsNotCounted) {
  FailingIo io;
  TempHome home(io);
  PairFile file(home.files(), kPath, OpenMode::kCreate);
  file.Append({});
  io.Reset(1);
  io.torn = true;
  EXPECT_EQ(ErrorOf([&] { file.Append({}); }), 61);
  EXPECT_EQ(file.count(), 1);
  EXPECT_EQ(PairFile(home.files(), kPath).count(), 1);
}
