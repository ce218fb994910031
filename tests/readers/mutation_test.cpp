// Readers under damaged input, the same in every run: what is kept of the fuzz targets, cut,
// changed, doubled and joined. The bodies check what must hold, and end the process where it does
// not.

#include <gtest/gtest.h>

#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "fuzz/readers.h"
#include "tests/readers/input_in_hand.h"
#include "tests/support/mutate.h"
#include "tests/support/places.h"

using namespace kora::test;
namespace fs = std::filesystem;

namespace {

// Texts alone are cheap; others make a home each time.
int TimesOf(const Reader& reader) {
  for (const std::string_view cheap : {"numbers", "formats", "dates", "daylines"})
    if (reader.name == cheap) return 4000;
  return reader.name == "charts" || reader.name == "scans" || reader.name == "prices" ? 100 : 400;
}

std::vector<std::string> CorpusOf(const Reader& reader) {
  std::vector<fs::path> paths;
  for (const auto& entry :
       fs::directory_iterator(fs::path(kora::SourceDir()) / "fuzz" / "corpus" / reader.name))
    paths.push_back(entry.path());
  std::sort(paths.begin(), paths.end());  // the order of a folder is the machine's
  std::vector<std::string> texts{""};
  for (const fs::path& path : paths) {
    std::ifstream in(path, std::ios::binary);
    texts.emplace_back(std::istreambuf_iterator<char>(in), std::istreambuf_iterator<char>());
  }
  return texts;
}

class MutationTest : public ::testing::TestWithParam<Reader> {};

}  // namespace

TEST_P(MutationTest, HoldsWhatItPromises) {
  const Reader& reader = GetParam();
  InputInHand hand;
  Mutator(std::uint32_t(reader.name.size() + size_t(reader.name[0])))
      .Run(CorpusOf(reader), TimesOf(reader),
           [&](const std::string& bytes) { hand.Give(reader, "damaged", bytes); });
}

INSTANTIATE_TEST_SUITE_P(Readers, MutationTest,
                         ::testing::ValuesIn(Readers().begin(), Readers().end()),
                         [](const auto& each) { return std::string(each.param.name); });
