#pragma once

#include <string>
#include <vector>

#include "scans/chart_scan1.h"
#include "scans/chart_scan2.h"
#include "scans/chart_scan3.h"

// A page that a scan leaves for its reader: one file, with everything in it.

namespace kora {

// A chart as a picture, or why there is none.
struct ReportPicture {
  std::string code, name;  // UTF-8
  std::string type;        // "image/png", "image/svg+xml"
  std::string bytes;
  std::string fault;  // where bytes are empty
};

// All texts are UTF-8.
struct ScanReport {
  std::string title;                  // "Chart Scan 1"
  std::string date;                   // of the latest prices, as shown; may be empty
  std::vector<std::string> criteria;  // a line each
  std::vector<std::string> columns;
  std::vector<std::vector<std::string>> rows;
  size_t codeColumn = 0;           // the one that names the security, and leads to its picture
  std::vector<bool> right = {};    // columns of numbers
  std::vector<std::string> notes;  // what is told at the end, a line each
  std::vector<ReportPicture> pictures;
};

// The page: criteria, table, notes and the pictures, in light and dark as the reader's screen has
// it. It needs no network, no other file and no script; the same report gives the same bytes.
std::string ReportHtml(const ScanReport& report);

// The ticked choices in words, with their values.
std::vector<std::string> CriteriaOf(const Scan1Choices& choices);
std::vector<std::string> CriteriaOf(const Scan2Choices& choices);
std::vector<std::string> CriteriaOf(const Scan3Choices& choices);

}  // namespace kora
