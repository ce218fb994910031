// Readers under damaged input. The bodies check what must hold and abort where it does not.

#include <gtest/gtest.h>

#include "store/name_rec.h"
#include "store/price_rec.h"
#include "tests/support/mutate.h"
#include "tests/support/reader_bodies.h"

using namespace kora;
using namespace kora::test;

namespace {

template <typename T>
std::string Bytes(const T& record) {
  return {reinterpret_cast<const char*>(&record), sizeof record};
}

}  // namespace

TEST(MutationTest, ScriptLines) {
  Mutator(1).Run({"L,10,20,30,40,255", "T,8.25,20,2,  BHP    Steel ,255", "S,8,1,2, 12 50 ,7",
                  "P,1,2,3", "H,40.5,41.5,2147483648,x,1", "", ",,,,,", std::string(4097, 'x')},
                 20000, ReadScriptLine);
}

TEST(MutationTest, NumbersDatesAndTexts) {
  Mutator(2).Run({"123.456", "-0.05", "  +7.", "99999999999999999999", "1E5", "0.0000000000001",
                  "19990131", "31/12/99", "1/1/2001", "\xC3\xA9\xE2\x82\xAC", ""},
                 20000, ReadNumber);
}

TEST(MutationTest, SettingsFiles) {
  Mutator(3).Run(
      {"[Charts]\r\nType=B\r\nPeriod=A\r\n\r\n[Download]\r\nDataService=1\r\n",
       "; note\n[charts]\nTYPE = C \nType=D\n[x]\n[CHARTS]\nPeriod=M", "Type=1\r\n", "[", ""},
      4000, ReadSettings);
}

TEST(MutationTest, NameRecords) {
  NameRec rec = NewNameRec("BHP");
  rec.Name.set("BHP Steel");
  Mutator(4).Run({Bytes(rec), Bytes(rec) + Bytes(NewNameRec("NUL")), ""}, 4000, ReadNameRecords);
}

TEST(MutationTest, PriceRecords) {
  PriceRec rec{};
  rec.RecDate.set("19990131");
  rec.Close = 2.1935f;
  Mutator(5).Run({Bytes(rec), Bytes(rec) + Bytes(rec) + "torn", ""}, 4000, ReadPriceRecords);
}
