#pragma once

#include <string>
#include <vector>

#include "companies/stock_details.h"
#include "platform/progress.h"

// The rows of `Fundmnt`: the facts of all companies side by side, with prices and yields.

namespace kora {

struct CompanyRow {
  std::string code, name;
  std::string IndClass;      // three digits, empty where the name file has none
  std::int32_t nameRec = 0;  // in Names.dat, 0 where it is not there
  std::string lastDate;      // "dd/mm/yyyy" of the price, by CalculateYields
  std::string price, yield;  // "0.00#" and "#.00# %"; empty until then, or where there is none
  std::vector<std::string> fields;
};

inline constexpr std::string_view kCompanyTitle = "ASX Details";
inline constexpr std::string_view kNoCompanies = "There is no fundamental data";

// A row a code of the store, in its order. Names and classes come from Names.dat of the data
// folder where it has the code. Errors of reading the name file.
std::vector<CompanyRow> LoadCompanies(const CompanyStore& store, const Files& files,
                                      const std::string& dataPath);

// Headings of the grid: Code, Name, Ind Class, Last Price, Price $, Yield %, then those of the
// store. "Last Price" is the date of the price.
std::vector<std::string> CompanyHeadings(const CompanyStore& store);
// The cells of a row in that order.
std::vector<std::string> CompanyCells(const CompanyRow& row);

// Reads the last record of each price file: price is its close, and
//
//   yield = (interim + final dividend) / price * 100
//
// with an empty cell where there is no dividend or no price. Returns what is to be told at the
// end, "NO DATA FOR " + code for each row without a price; nothing is changed when the user stops.
struct YieldEnd {
  bool stopped = false;
  std::vector<std::string> missing;  // codes
};
inline constexpr std::string_view kCalculatingYields = "Calculating Yields %";
YieldEnd CalculateYields(const CompanyStore& store, const Files& files, const std::string& dataPath,
                         Progress& progress, std::vector<CompanyRow>& rows);
// The lines of a message: each code that lacks a price, the first twenty of many.
std::string MissingText(const std::vector<std::string>& missing);

// Puts details into the Other Details of the name file, as AsOtherDetails takes them; the file is
// replaced as a whole. Codes that it does not have are passed over. The number of records
// written. Errors of reading and writing.
struct Transfer {
  std::string code, value;
};
int TransferDetails(const Files& files, const std::string& dataPath,
                    const std::vector<Transfer>& details);

// Orders the cells of a column: numbers by their size, texts behind them in any case.
bool CellBefore(const std::string& a, const std::string& b);

// Replaces the list of scan results by the rows that are in the name file, in their order.
// Errors of writing.
void WriteCompanyList(const Files& files, const std::string& dataPath,
                      const std::vector<CompanyRow>& rows);

}  // namespace kora
