#pragma once

#include <cstdint>
#include <string>
#include <string_view>
#include <vector>

#include "base/dates.h"
#include "platform/printer.h"
#include "settings/settings.h"

namespace kora {

// Dates of lists on paper: "04-Mar-26", and "4-Mar-26".
std::string MediumDate(const CalendarDate& date);
std::string ShortMediumDate(const CalendarDate& date);

// Keeps the margins and the orientation of text print-outs.
void SaveTextPage(SettingsFile& file, const PageSettings& page);

// How a list looks on paper. Places are shares of the width between the margins.
struct TextPrintLayout {
  std::string heading;               // "NAME FILE": on each page, in Font 1
  std::string continued = {};        // behind the heading from page 2 on: "  (cont)"
  std::string pageLabel = "Page  ";  // before the page's number
  double pageAt = 0.8;               // where it stands
  std::vector<std::string> columns;  // headings of the columns; none: no such line
  std::vector<double> at;            // where the columns begin; empty: one, at 0
  double lineHeight = 1.1;           // of a line, in heights of "R"
};

// A list going to paper, line by line: margins, headings and page numbers on every page, text in
// Font 1 ("CFont", headings in bold) and Font 2 ("SFont", the lines).
//
//   TextPrintOut out(printer, settings.fonts, settings.page, layout);
//   for (...) out.Line({code, name});
//   out.End();
//
// Unless it is ended, nothing is sent. Errors are those of the printer.
class TextPrintOut {
 public:
  // Begins the document: title and first headings. Error 68 without a printer, 5 where margins
  // or a font leave no room for a line.
  TextPrintOut(Printer& printer, const FontSettings& fonts, const PageSettings& page,
               TextPrintLayout layout);
  ~TextPrintOut();
  TextPrintOut(const TextPrintOut&) = delete;
  TextPrintOut& operator=(const TextPrintOut&) = delete;

  // A line, on a further page where this one is full. UTF-8. A text too wide for its column is
  // cut; texts beyond the columns are left out.
  void Line(const std::vector<std::string>& texts);
  // The next line begins a page.
  void NewPage();
  // Sends what there is.
  void End();

  int PageNumber() const { return page_; }

 private:
  void BeginPage();
  void PrintLine(const std::vector<std::string>& texts);
  std::string Cut(const std::string& text, double room) const;

  Printer& printer_;
  TextPrintLayout layout_;
  SurfaceFont heads_, lines_;
  double left_, top_, width_, bottom_;  // of the text, twips
  double y_ = 0;
  int page_ = 0;
  bool full_ = false;
  bool ended_ = false;
};

// A list that is there as a whole.
struct TextTable {
  TextPrintLayout layout;
  std::vector<std::vector<std::string>> rows;  // UTF-8
};
// Prints it as one document. Errors as above; nothing is sent then.
void PrintTable(Printer& printer, const FontSettings& fonts, const PageSettings& page,
                const TextTable& table);

}  // namespace kora
