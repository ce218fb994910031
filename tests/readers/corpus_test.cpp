// What the fuzz targets met and is kept: each input goes to its reader once more. A body ends the
// process where a promise is broken.

#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <iterator>

#include "fuzz/readers.h"
#include "tests/readers/input_in_hand.h"
#include "tests/support/places.h"

using namespace kora::test;
namespace fs = std::filesystem;

namespace {

const fs::path kCorpus = fs::path(kora::SourceDir()) / "fuzz" / "corpus";

std::string BytesOfFile(const fs::path& path) {
  std::ifstream in(path, std::ios::binary);
  return {std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>()};
}

class CorpusTest : public ::testing::TestWithParam<Reader> {};

}  // namespace

TEST_P(CorpusTest, HoldsWhatItPromises) {
  const Reader& reader = GetParam();
  InputInHand hand;
  int seen = 0;
  for (const auto& entry : fs::directory_iterator(kCorpus / reader.name)) {
    const std::string name = entry.path().filename().string();
    EXPECT_NO_THROW(hand.Give(reader, name, BytesOfFile(entry.path()))) << name;
    ++seen;
  }
  EXPECT_GT(seen, 0);
  EXPECT_NO_THROW(hand.Give(reader, "nothing", ""));
}

INSTANTIATE_TEST_SUITE_P(Readers, CorpusTest,
                         ::testing::ValuesIn(Readers().begin(), Readers().end()),
                         [](const auto& each) { return std::string(each.param.name); });

TEST(CorpusFolderTest, EachFolderAndEachDictionaryIsAReaders) {
  std::uintmax_t bytes = 0;
  for (const auto& entry : fs::recursive_directory_iterator(kCorpus.parent_path())) {
    if (entry.is_directory() && entry.path().parent_path() == kCorpus) {
      EXPECT_NE(FindReader(entry.path().filename().string()), nullptr) << entry.path();
    }
    if (entry.path().extension() == ".dict") {
      EXPECT_NE(FindReader(entry.path().stem().string()), nullptr) << entry.path();
    }
    if (entry.is_regular_file()) bytes += entry.file_size();
  }
  EXPECT_LT(bytes, 800u << 10) << "the corpus is kept small";
}
