#include "scans/scan_report.h"

#include <set>

#include "base/text.h"
#include "base/version.h"

namespace kora {
namespace {

constexpr std::string_view kStyle = R"(
:root {
  color-scheme: light dark;
  --page: #f6f7f9; --card: #ffffff; --text: #1c2430; --faint: #5c6878; --line: #d9dee6;
  --link: #0b57c2; --fall: #b3261e; --rise: #17703a;
}
@media (prefers-color-scheme: dark) {
  :root {
    --page: #14181d; --card: #1d232b; --text: #e6eaf0; --faint: #9aa6b5; --line: #343d49;
    --link: #8ab8ff; --fall: #ff8a80; --rise: #7fd99f;
  }
}
* { box-sizing: border-box; }
body {
  margin: 0; background: var(--page); color: var(--text);
  font: 16px/1.5 system-ui, -apple-system, "Segoe UI", "DejaVu Sans", sans-serif;
}
main { max-width: 1400px; margin: 0 auto; padding: 24px 20px 48px; }
h1 { font-size: 1.7rem; margin: 0; }
h2 { font-size: 1.15rem; margin: 32px 0 10px; }
.date, footer { color: var(--faint); }
ul { margin: 0; padding-left: 1.2em; }
a { color: var(--link); }
.table { overflow-x: auto; background: var(--card); border: 1px solid var(--line); border-radius: 8px; }
table { border-collapse: collapse; width: 100%; }
th, td { padding: 6px 14px; text-align: left; white-space: nowrap; border-bottom: 1px solid var(--line); }
tbody tr:last-child td { border-bottom: 0; }
th { font-weight: 600; color: var(--faint); }
.n { text-align: right; font-variant-numeric: tabular-nums; }
.fall { color: var(--fall); }
.rise { color: var(--rise); }
.charts { display: grid; gap: 20px; grid-template-columns: repeat(auto-fill, minmax(min(100%, 460px), 1fr)); }
figure { margin: 0; padding: 12px; background: var(--card); border: 1px solid var(--line); border-radius: 8px; }
figcaption { margin-bottom: 8px; font-weight: 600; }
figcaption span { font-weight: 400; color: var(--faint); }
figure img { display: block; width: 100%; height: auto; border-radius: 4px; }
footer { margin-top: 40px; font-size: .9rem; }
@media print { .charts { display: block; } figure { break-inside: avoid; margin-bottom: 12px; } }
)";

std::string Html(std::string_view text) {
  std::string out;
  for (const char c : text) switch (c) {
      case '&': out += "&amp;"; break;
      case '<': out += "&lt;"; break;
      case '>': out += "&gt;"; break;
      case '"': out += "&quot;"; break;
      default: out += static_cast<unsigned char>(c) < 0x20 && c != '\n' ? ' ' : c;
    }
  return out;
}

std::string Base64(std::string_view bytes) {
  static constexpr char kLetters[] =
      "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
  std::string out;
  out.reserve((bytes.size() + 2) / 3 * 4);
  for (size_t i = 0; i < bytes.size(); i += 3) {
    const auto byte = [&](size_t at) {
      return at < bytes.size() ? static_cast<unsigned char>(bytes[at]) : 0u;
    };
    const unsigned word = byte(i) << 16 | byte(i + 1) << 8 | byte(i + 2);
    out += kLetters[word >> 18];
    out += kLetters[word >> 12 & 63];
    out += i + 1 < bytes.size() ? kLetters[word >> 6 & 63] : '=';
    out += i + 2 < bytes.size() ? kLetters[word & 63] : '=';
  }
  return out;
}

// A name within the page: letters and digits alone.
std::string Anchor(std::string_view code) {
  static constexpr char kHex[] = "0123456789abcdef";
  std::string out = "chart-";
  for (const char c : code) {
    const auto u = static_cast<unsigned char>(c);
    if ((c >= '0' && c <= '9') || (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z')) {
      out += c;
    } else {
      out += '_';
      out += kHex[u >> 4];
      out += kHex[u & 15];
    }
  }
  return out;
}

std::string_view ClassOf(std::string_view cell) {
  if (cell.ends_with("%D") || cell == "DOWN" || cell == "FALL") return "fall";
  if (cell.ends_with("%U") || cell == "UP" || cell == "RISE") return "rise";
  return "";
}

void AddTable(const ScanReport& report, const std::set<std::string>& charted, std::string& out) {
  out += "<div class=\"table\"><table>\n<caption hidden>Securities found</caption>\n<thead><tr>";
  const auto number = [&](size_t i) { return i < report.right.size() && report.right[i]; };
  for (size_t i = 0; i < report.columns.size(); ++i)
    out += std::string("<th scope=\"col\"") + (number(i) ? " class=\"n\">" : ">") +
           Html(report.columns[i]) + "</th>";
  out += "</tr></thead>\n<tbody>\n";
  for (const auto& row : report.rows) {
    out += "<tr>";
    for (size_t i = 0; i < row.size(); ++i) {
      std::string classes = number(i) ? "n" : "";
      if (const std::string_view own = ClassOf(row[i]); !own.empty())
        classes += (classes.empty() ? "" : " ") + std::string(own);
      out += classes.empty() ? "<td>" : "<td class=\"" + classes + "\">";
      if (i == report.codeColumn && charted.contains(row[i]))
        out += "<a href=\"#" + Anchor(row[i]) + "\">" + Html(row[i]) + "</a>";
      else
        out += Html(row[i]);
      out += "</td>";
    }
    out += "</tr>\n";
  }
  out += "</tbody></table></div>\n";
}

void AddPictures(const ScanReport& report, std::string& out) {
  out += "<h2>Charts</h2>\n<div class=\"charts\">\n";
  for (const ReportPicture& picture : report.pictures) {
    out += "<figure id=\"" + Anchor(picture.code) + "\"><figcaption>" + Html(picture.code) +
           " <span>" + Html(picture.name) + "</span></figcaption>";
    if (picture.bytes.empty())
      out += "<p>" + Html(picture.fault) + "</p>";
    else
      out += "<img loading=\"lazy\" alt=\"Chart of " + Html(picture.code) +
             "\" src=\"data:" + picture.type + ";base64," + Base64(picture.bytes) + "\">";
    out += "</figure>\n";
  }
  out += "</div>\n";
}

class Lines {
 public:
  void Add(bool ticked, const std::string& text) {
    if (ticked) lines_.push_back(text);
  }
  std::vector<std::string> Take() { return std::move(lines_); }

 private:
  std::vector<std::string> lines_;
};

}  // namespace

std::string ReportHtml(const ScanReport& report) {
  std::string out =
      "<!DOCTYPE html>\n<html lang=\"en\">\n<head>\n<meta charset=\"utf-8\">\n"
      "<meta name=\"viewport\" content=\"width=device-width, initial-scale=1\">\n<title>" +
      Html(report.title) + (report.date.empty() ? "" : " - " + Html(report.date)) +
      "</title>\n<style>" + std::string(kStyle) + "</style>\n</head>\n<body>\n<main>\n<h1>" +
      Html(report.title) + "</h1>\n";
  if (!report.date.empty()) out += "<p class=\"date\">Prices up to " + Html(report.date) + "</p>\n";
  if (!report.criteria.empty()) {
    out += "<h2>Criteria</h2>\n<ul>\n";
    for (const std::string& line : report.criteria) out += "<li>" + Html(line) + "</li>\n";
    out += "</ul>\n";
  }
  std::set<std::string> charted;
  for (const ReportPicture& picture : report.pictures) charted.insert(picture.code);
  const size_t found = report.rows.size();
  out += "<h2>" + std::to_string(found) + (found == 1 ? " row" : " rows") + "</h2>\n";
  if (found > 0) AddTable(report, charted, out);
  for (const std::string& note : report.notes) out += "<p>" + Html(note) + "</p>\n";
  if (!report.pictures.empty()) AddPictures(report, out);
  out += "<footer>" + Html(kProgramTitle) + "</footer>\n</main>\n</body>\n</html>\n";
  return out;
}

std::vector<std::string> CriteriaOf(const Scan1Choices& c) {
  Lines lines;
  lines.Add(c.Check7, "Closing price from " + c.Text3 + " to " + c.Text2);
  lines.Add(c.Check1, "Percentage rise of " + c.Text1 + " or more");
  lines.Add(c.Check15, "Percentage fall of " + c.Text6 + " or more");
  lines.Add(c.Check8, "Category " + c.Text4 + " only");
  lines.Add(c.Check14, "Industry class " + c.Text5 + " only");
  lines.Add(c.Check16, "No warrants");
  std::string names;
  for (size_t i = 0; i < kScanOscillators; ++i)
    if (c.oscillators[i]) names += (names.empty() ? "" : ", ") + std::string(ScanOscillatorName(i));
  lines.Add(!names.empty(), "Oscillators: " + names);
  std::string signals;
  for (const auto& [ticked, text] : {std::pair(c.Check9, "OB"), std::pair(c.Check12, "cut OB"),
                                     std::pair(c.Check10, "OS"), std::pair(c.Check11, "cut OS")})
    if (ticked) signals += (signals.empty() ? "" : ", ") + std::string(text);
  lines.Add(!signals.empty(), "Signals: " + signals);
  return lines.Take();
}

std::vector<std::string> CriteriaOf(const Scan2Choices& c) {
  Lines lines;
  lines.Add(c.Check1, "Closing price from " + c.Text1 + " to " + c.Text2);
  lines.Add(c.Check2, "Volume " + c.Text3 + " % above " +
                          (c.Text5.empty() ? "1" : "the average of the last " + c.Text5 + " days"));
  lines.Add(c.Check3, "Price up or down by " + c.Text4 + " % or more");
  lines.Add(c.Check4, "Industry class " + c.Text6 + " only");
  lines.Add(c.Check5, "No warrants");
  return lines.Take();
}

std::vector<std::string> CriteriaOf(const Scan3Choices& c) {
  Lines lines;
  lines.Add(c.Check3, "Parabolic stop broken upwards");
  lines.Add(c.Check5, "Parabolic stop broken downwards");
  lines.Add(c.Check1, "Closing price from " + c.Text1 + " to " + c.Text2);
  lines.Add(c.Check2, "Category " + c.Text3 + " only");
  lines.Add(c.Check4, "Industry class " + c.Text6 + " only");
  lines.Add(c.Check6, "No warrants");
  return lines.Take();
}

}  // namespace kora
