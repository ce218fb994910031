#include "names/name_rows.h"

#include <gtest/gtest.h>

#include "tests/support/records.h"

namespace kora::test {
namespace {

using C = NameColumn;

std::string Refusal(NameRec row, C column, std::string_view text) {
  const NameRec before = row;
  const auto fault = PutNameCell(row, column, text);
  EXPECT_EQ(Bytes<NameRec>({row}) == Bytes<NameRec>({before}), true) << text;
  return fault.value_or("");
}

std::string Put(NameRec& row, C column, std::string_view text) {
  EXPECT_EQ(PutNameCell(row, column, text).value_or(""), "") << text;
  return NameCell(row, column);
}

NameRec Named(std::string_view code, std::string_view name, std::int16_t category = 1,
              std::string_view indClass = "") {
  NameRec rec = Security(code, category, kShare, indClass);
  rec.Name.set(name);
  return rec;
}

std::string Codes(const std::vector<NameRec>& rows) {
  std::string out;
  for (const NameRec& row : rows) out += NameCell(row, C::kCode) + ".";
  return out;
}

TEST(NameCells, ShowScalesOfNothingAsEmptyAndClassesWithThreeDigits) {
  NameRec row = Named("BHP", "Broken Hill", 7, "11 ");
  EXPECT_EQ(NameCell(row, C::kBase), "");
  EXPECT_EQ(NameCell(row, C::kTop), "");
  EXPECT_EQ(NameCell(row, C::kPFInc), "");
  EXPECT_EQ(NameCell(row, C::kClass), "011");
  EXPECT_EQ(NameCell(row, C::kCategory), "7");
  EXPECT_EQ(NameCell(row, C::kType), "4");
  row.Base = 2.5f;
  EXPECT_EQ(NameCell(row, C::kBase), "2.5");
}

TEST(NameCells, AnEmptyRowShowsNothingAtAll) {
  const NameRec row = EmptyNameRow();
  EXPECT_TRUE(IsEmptyNameRow(row));
  for (int i = 0; i < kNameColumns; ++i) EXPECT_EQ(NameCell(row, C(i)), "") << i;
  NameRec other = row;
  other.Category = 3;
  EXPECT_FALSE(IsEmptyNameRow(other));
  other = row;
  other.Id.set("S");
  EXPECT_FALSE(IsEmptyNameRow(other));
  EXPECT_EQ(NameCell(other, C::kCategory), "0");
}

TEST(NameCells, TypeTakesOneToFiveAlone) {
  NameRec row = Named("BHP", "");
  EXPECT_EQ(Put(row, C::kType, " 5 "), "5");
  EXPECT_EQ(row.RecType, 5);
  EXPECT_EQ(Put(row, C::kType, ""), "");
  for (const char* bad : {"0", "6", "-1", "4.5", "x", "4x", "1e9"})
    EXPECT_EQ(Refusal(row, C::kType, bad), "Record Type must be either 1,2,3,4 or 5") << bad;
}

TEST(NameCells, CategoryTakesNoughtToNinetyNine) {
  NameRec row = Named("BHP", "");
  EXPECT_EQ(Put(row, C::kCategory, "99"), "99");
  EXPECT_EQ(Put(row, C::kCategory, "0"), "0");
  for (const char* bad : {"100", "-1", "two", "32768", "1,5"})
    EXPECT_EQ(Refusal(row, C::kCategory, bad), "Category range 0 - 99") << bad;
}

TEST(NameCells, ClassIsKeptWithThreeDigits) {
  NameRec row = Named("BHP", "");
  EXPECT_EQ(Put(row, C::kClass, "7"), "007");
  EXPECT_EQ(row.IndClass.raw(), "007");
  EXPECT_EQ(Put(row, C::kClass, "999"), "999");
  EXPECT_EQ(Put(row, C::kClass, ""), "");
  EXPECT_EQ(row.IndClass.raw(), "   ");
  for (const char* bad : {"1000", "-1", "a"})
    EXPECT_EQ(Refusal(row, C::kClass, bad), "Industry Classification range 0  to 999") << bad;
}

TEST(NameCells, CommasAreRefusedInNamesAndDetails) {
  const NameRec row = Named("BHP", "Broken Hill");
  for (const C column : {C::kName, C::kDetails})
    EXPECT_EQ(Refusal(row, column, "a,b"),
              "Commas NOT to be used in Name or Other Details columns");
}

TEST(NameCells, TextsThatDoNotFitAreRefusedAndNotCut) {
  NameRec row = Named("BHP", "Broken Hill");
  EXPECT_EQ(Put(row, C::kName, std::string(35, 'n')), std::string(35, 'n'));
  EXPECT_EQ(Refusal(row, C::kName, std::string(36, 'n')), "The name can have 35 characters");
  EXPECT_EQ(Put(row, C::kDetails, "\xC3\xA9"), "\xC3\xA9");  // a letter of the files' alphabet
  EXPECT_EQ(Refusal(row, C::kDetails, "\xE6\x97\xA5"),
            "There are characters in the details that cannot be stored");
  EXPECT_NE(Refusal(row, C::kName, "a\tb"), "");
  EXPECT_EQ(Refusal(row, C::kId, "AB"), "The Id can have 1 characters");
  EXPECT_EQ(Put(row, C::kId, "s"), "S");
}

TEST(NameCells, CodesAreUpperCaseAndNameAFileOfTheirOwn) {
  NameRec row = Named("BHP", "");
  EXPECT_EQ(Put(row, C::kCode, "ore"), "ORE");
  EXPECT_EQ(row.Code.raw(), "ORE   ");
  EXPECT_EQ(Put(row, C::kCode, "prn"), "PRNX");
  EXPECT_EQ(Put(row, C::kCode, ""), "");
  for (const char* bad : {"..\\X", "A/B", "NUL", "TOOLONG", "A,B", "C:"})
    EXPECT_EQ(Refusal(row, C::kCode, bad), "Code cannot be used for a data file") << bad;
}

TEST(NameCells, NumbersOfScalesMustBeNumeric) {
  NameRec row = Named("BHP", "");
  EXPECT_EQ(Put(row, C::kBase, "1.25"), "1.25");
  EXPECT_EQ(Put(row, C::kTop, "0"), "");
  EXPECT_EQ(Put(row, C::kPFInc, ""), "");
  EXPECT_EQ(float(row.Base), 1.25f);
  for (const char* bad : {"x", "1.2.3", "1e99", "nan"})
    EXPECT_EQ(Refusal(row, C::kTop, bad), "Must be numeric") << bad;
}

TEST(NameCells, OddBytesBehindATextStayUntilTheCellChanges) {
  NameRec row = Named("BHP", "Hill");
  row.Name.bytes[4] = '\0';
  row.Name.bytes[34] = '\0';
  const std::string before = Bytes<NameRec>({row});
  EXPECT_EQ(Put(row, C::kName, "Hill"), "Hill");
  EXPECT_EQ(Bytes<NameRec>({row}), before);
  Put(row, C::kName, "Hills");
  EXPECT_EQ(row.Name.raw(), "Hills" + std::string(30, ' '));
}

TEST(NameRows, SortKeepsEmptyRowsAtTheEnd) {
  std::vector<NameRec> rows{Security("CCC", 1), EmptyNameRow(), Security("AAA", 2),
                            Security("BBB", 1)};
  SortNameRows(rows, NameSort::kCategory);
  EXPECT_EQ(Codes(rows), "BBB.CCC.AAA..");
  SortNameRows(rows, NameSort::kCode);
  EXPECT_EQ(Codes(rows), "AAA.BBB.CCC..");
  EXPECT_TRUE(IsSortedByCode(rows));
  std::swap(rows[0], rows[1]);
  EXPECT_FALSE(IsSortedByCode(rows));
}

TEST(NameRows, AWarrantHasSixCharactersAndACategoryOfTheEighties) {
  EXPECT_TRUE(IsWarrantRow(Security("BHPWMA", 80)));
  EXPECT_TRUE(IsWarrantRow(Security("BHPWMA", 89)));
  EXPECT_FALSE(IsWarrantRow(Security("BHPWMA", 79)));
  EXPECT_FALSE(IsWarrantRow(Security("BHPWMA", 90)));
  EXPECT_FALSE(IsWarrantRow(Security("BHPWM", 84)));
  std::vector<NameRec> rows{Security("BHPWMA", 84), Security("BHP", 84), Security("ANZIZB", 87)};
  EXPECT_EQ(RemoveWarrantRows(rows), 2);
  EXPECT_EQ(Codes(rows), "BHP.");
  std::vector<NameRec> one{Security("BHPWMA", 84)};
  EXPECT_EQ(RemoveWarrantRows(one), 0);
}

TEST(NameRows, NeighboursWithOneCodeAreDroppedAndEmptyOnesStay) {
  std::vector<NameRec> rows{Named("AAA", "first"),      Named("AAA", "second"), Security("BBB"),
                            Named("AAA", "not beside"), EmptyNameRow(),         EmptyNameRow()};
  EXPECT_EQ(RemoveDuplicateRows(rows), 1);
  EXPECT_EQ(Codes(rows), "AAA.BBB.AAA...");
  EXPECT_EQ(NameCell(rows[0], C::kName), "first");
}

TEST(NameRows, OptionsTakeTheClassOfTheirStock) {
  std::vector<NameRec> rows{Security("BHPWMA"),         Named("BHP", "", 1, "012"),
                            Named("BHP", "", 1, "099"), Named("BHPO", "", 1, "011"),
                            Security("XYZO"),           Security("CBA")};
  EXPECT_EQ(UpdateIC_from_Stock(rows), 1);
  EXPECT_EQ(NameCell(rows[0], C::kClass), "012");  // of the first row of that code
  EXPECT_EQ(NameCell(rows[3], C::kClass), "011");  // had one
  EXPECT_EQ(NameCell(rows[4], C::kClass), "");
  std::vector<NameRec> two{Security("BHPWMA"), Named("BHP", "", 1, "012")};
  EXPECT_EQ(UpdateIC_from_Stock(two), 0);
}

TEST(NameRows, ExpiredRowsAreEmptied) {
  std::vector<NameRec> rows{Named("A", " **EXPIRED** "), Named("B", "**EXPIRED** x"),
                            Named("C", "**EXPIRED**")};
  EXPECT_EQ(EmptyExpiredRows(rows), 2);
  EXPECT_EQ(Codes(rows), ".B..");
  EXPECT_TRUE(IsEmptyNameRow(rows[0]));
}

TEST(NameRows, TitleCaseKeepsBlanksAndLowersTheRest) {
  EXPECT_EQ(TitleCase("  NATIONAL  aUSTRALIA BANK (PREF) o'NEIL "),
            "National  Australia Bank (pref) O'neil");
  EXPECT_EQ(TitleCase(""), "");
  std::vector<NameRec> rows{Named("A", "BHP LTD"), Named("B", "Bhp Ltd"), Security("C")};
  EXPECT_EQ(TitleCaseNames(rows), 1);
  EXPECT_EQ(NameCell(rows[0], C::kName), "Bhp Ltd");
}

TEST(NameRows, CleaningEmptiesTheOptionalColumns) {
  std::vector<NameRec> rows{Security("A"), Security("B")};
  rows[1].Base = 1;
  rows[1].PFInc = 0.5f;
  EXPECT_EQ(CleanOptionalCells(rows), 1);
  EXPECT_EQ(NameCell(rows[1], C::kBase) + NameCell(rows[1], C::kPFInc), "");
}

}  // namespace
}  // namespace kora::test
