#include <gtest/gtest.h>

#include <algorithm>

#include "store/name_file.h"
#include "tests/support/failing_io.h"
#include "tests/support/records.h"
#include "tests/support/temp_home.h"

namespace kora::test {
namespace {

const std::string kData = "c:\\data\\";

std::vector<std::int32_t> Sorted(const std::vector<std::string>& keys) {
  std::vector<SortEntry> items;
  for (size_t i = 0; i < keys.size(); ++i) items.push_back({std::int32_t(i) + 1, keys[i]});
  ShellSort(items);
  std::vector<std::int32_t> order;
  for (const SortEntry& item : items) order.push_back(item.RecNo);
  return order;
}

using Order = std::vector<std::int32_t>;

TEST(ShellSort, OrdersByBytes) {
  EXPECT_EQ(Sorted({"b", "A", "\xE9", "a", "0"}), (Order{5, 2, 4, 1, 3}));
}

TEST(ShellSort, HandlesNoneAndOne) {
  EXPECT_EQ(Sorted({}), Order{});
  EXPECT_EQ(Sorted({"x"}), Order{1});
}

TEST(ShellSort, EqualKeysChangePlaces) {
  // Gap 1 alone turns the row round.
  EXPECT_EQ(Sorted({"x", "x"}), (Order{2, 1}));
  EXPECT_EQ(Sorted({"x", "x", "x"}), (Order{3, 2, 1}));
  EXPECT_EQ(Sorted({"x", "x", "x", "x"}), (Order{4, 3, 2, 1}));
  // Gap 3 first: 4 5 3 1 2, then turned round.
  EXPECT_EQ(Sorted({"x", "x", "x", "x", "x"}), (Order{2, 1, 3, 5, 4}));
}

TEST(ShellSort, OrdersManyKeys) {
  std::vector<std::string> keys;
  for (unsigned i = 0, n = 12345; i < 1000; ++i, n = n * 1103515245u + 12345u)
    keys.push_back(std::to_string(n >> 8));
  const Order order = Sorted(keys);
  for (size_t i = 1; i < order.size(); ++i)
    ASSERT_LE(keys[size_t(order[i - 1] - 1)], keys[size_t(order[i] - 1)]);
  std::vector<bool> seen(1001);
  for (const std::int32_t n : order) seen[size_t(n)] = true;
  EXPECT_EQ(std::count(seen.begin(), seen.end(), true), 1000);
}

TEST(SortKey, IsTwelveCharactersOfTheMode) {
  const NameRec rec = Security("BHP", 7, kIndex, "012");
  EXPECT_EQ(SortKey(rec, NameSort::kCode), "BHP         ");
  EXPECT_EQ(SortKey(rec, NameSort::kIndClass), "012BHP      ");
  EXPECT_EQ(SortKey(rec, NameSort::kCategory), "0075BHP     ");
  EXPECT_EQ(SortKey(Security("ABCDEF", 99), NameSort::kCategory), "0994ABCDEF  ");
}

TEST(SortKey, OfForeignNumbersIsCutToItsLength) {
  NameRec rec = Security("ABCDEF", -32768, -32768);
  EXPECT_EQ(SortKey(rec, NameSort::kCategory), "-32768-32768");
  rec.Code.set(" AB");
  EXPECT_EQ(SortKey(rec, NameSort::kCode), "AB          ");
}

class SortFile : public ::testing::Test {
 protected:
  explicit SortFile() : home_(io_) {}

  void Put(const std::string& name, const std::vector<NameRec>& records,
           const std::string& tail = "") {
    home_.Put("drive_c/data/" + name, Bytes(records) + tail);
  }
  std::string Codes(const std::string& name = "Names.dat") {
    std::string out;
    for (const NameRec& rec : NameFile(home_.files(), kData + name).ReadAll())
      out += std::string(rec.Code.trimmed()) + " ";
    return out;
  }

  FailingIo io_;
  TempHome home_;
};

TEST_F(SortFile, ByEachMode) {
  const std::vector<NameRec> records{Security("CCC", 2, 4, "010"), Security("BBB", 1, 5, "030"),
                                     Security("DDD", 1, 4, "010"), Security("AAA", 2, 4, "020")};
  Put("Names.dat", records);
  SortNameFile(home_.files(), kData, NameSort::kCategory);
  EXPECT_EQ(Codes(), "DDD BBB AAA CCC ");
  SortNameFile(home_.files(), kData, NameSort::kCode);
  EXPECT_EQ(Codes(), "AAA BBB CCC DDD ");
  SortNameFile(home_.files(), kData, NameSort::kIndClass);
  EXPECT_EQ(Codes(), "CCC DDD AAA BBB ");
  EXPECT_EQ(home_.files().List(kData).size(), 1u);
}

TEST_F(SortFile, KeepsEveryByteOfARecord) {
  NameRec rec = Security("BBB");
  std::fill(std::begin(rec.NameSpare.bytes), std::end(rec.NameSpare.bytes), '\x81');
  rec.NameStatus = 9;
  rec.MinMove = 7;
  const NameRec other = Security("AAA");
  Put("Names.dat", {rec, other});
  SortNameFile(home_.files(), kData, NameSort::kCode);
  EXPECT_EQ(home_.Get("drive_c/data/Names.dat"), Bytes<NameRec>({other, rec}));
}

TEST_F(SortFile, DropsDeletedRecordsAndATornOne) {
  NameRec gone = Security("AAA");
  gone.NameStatus = 1;
  Put("Names.dat", {Security("CCC"), gone, Security("BBB")}, "torn");
  SortNameFile(home_.files(), kData, NameSort::kCode);
  EXPECT_EQ(home_.Get("drive_c/data/Names.dat"),
            Bytes<NameRec>({Security("BBB"), Security("CCC")}));
}

TEST_F(SortFile, OfDeletedRecordsAloneIsEmpty) {
  NameRec gone = Security("AAA");
  gone.NameStatus = 1;
  Put("Names.dat", {gone, gone});
  SortNameFile(home_.files(), kData, NameSort::kCode);
  EXPECT_TRUE(home_.Exists("drive_c/data/Names.dat"));
  EXPECT_EQ(home_.Get("drive_c/data/Names.dat"), "");
}

TEST_F(SortFile, WithFewerThanTwoRecordsStaysAsItIs) {
  NameRec gone = Security("AAA");
  gone.NameStatus = 1;
  Put("Names.dat", {gone}, "torn");
  io_.Reset();
  SortNameFile(home_.files(), kData, NameSort::kCode);
  EXPECT_EQ(io_.calls, 0);
  EXPECT_EQ(home_.Get("drive_c/data/Names.dat"), Bytes<NameRec>({gone}) + "torn");
}

TEST_F(SortFile, ReplacesTheNameFileInTheCaseItHas) {
  Put("NAMES.DAT", {Security("BBB"), Security("AAA")});
  SortNameFile(home_.files(), kData, NameSort::kCode);
  EXPECT_EQ(home_.files().List(kData), std::vector<std::string>{"NAMES.DAT"});
  EXPECT_EQ(Codes(), "AAA BBB ");
}

TEST_F(SortFile, OfTheEditorWorksOnItsCopy) {
  Put("Names.dat", {Security("BBB"), Security("AAA")});
  Put("Temp.Wk2", {Security("DDD"), Security("CCC")});
  SortEditorCopy(home_.files(), kData, NameSort::kCode);
  EXPECT_EQ(Codes("Temp.Wk2"), "CCC DDD ");
  EXPECT_EQ(Codes(), "BBB AAA ");
  EXPECT_EQ(home_.files().List(kData).size(), 2u);
}

TEST_F(SortFile, CutOffAnywhereLeavesTheOldFileOrTheNewOne) {
  const std::string old = Bytes<NameRec>({Security("BBB"), Security("AAA")});
  const std::string sorted = Bytes<NameRec>({Security("AAA"), Security("BBB")});
  for (const bool lasting : {false, true}) {
    io_.lasting = lasting;
    io_.torn = true;
    bool done = false;
    int at = 0;
    while (!done) {
      ASSERT_LT(++at, 20);
      home_.Put("drive_c/data/Names.dat", old);
      io_.Reset(at);
      const int error = ErrorOf([&] { SortNameFile(home_.files(), kData, NameSort::kCode); });
      done = io_.calls < at;
      EXPECT_EQ(error, done ? 0 : int(kDiskFull)) << at;
      // The seventh call flushes the folder: on a disk that stays broken the new file stays.
      EXPECT_EQ(home_.Get("drive_c/data/Names.dat"), done || (lasting && at == 7) ? sorted : old)
          << at;
      if (!lasting) {
        EXPECT_EQ(home_.files().List(kData).size(), 1u) << at;
      }
    }
    EXPECT_EQ(at, 8);
  }
}

TEST_F(SortFile, OfAFileThatIsNotThereIsError53) {
  home_.Put("drive_c/data/other", "");
  EXPECT_EQ(ErrorOf([&] { SortNameFile(home_.files(), kData, NameSort::kCode); }), kFileNotFound);
}

}  // namespace
}  // namespace kora::test
