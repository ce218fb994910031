#include "lists/text_print_out.h"

#include <algorithm>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "platform/settings_file.h"

namespace kora {

std::string MediumDate(const CalendarDate& date) {
  const std::string text = ShortMediumDate(date);
  return date.day < 10 ? "0" + text : text;
}

std::string ShortMediumDate(const CalendarDate& date) {
  static constexpr const char* kMonths[] = {"Jan", "Feb", "Mar", "Apr", "May", "Jun",
                                            "Jul", "Aug", "Sep", "Oct", "Nov", "Dec"};
  return Str(std::int32_t(date.day)) + "-" + kMonths[date.month - 1] + "-" +
         Format(double(date.year % 100), "00");
}

void SaveTextPage(SettingsFile& file, const PageSettings& page) {
  const SettingsFile::Batch batch(file);
  file.PutSetting("ChtPage", "PPTop", Str(page.PPTop));
  file.PutSetting("ChtPage", "PPLft", Str(page.PPLft));
  file.PutSetting("ChtPage", "PPBot", Str(page.PPBot));
  file.PutSetting("ChtPage", "PPRht", Str(page.PPRht));
  file.PutSetting("ChtPage", "Orient", Str(std::int32_t(page.Orient)));
}

TextPrintOut::TextPrintOut(Printer& printer, const FontSettings& fonts, const PageSettings& page,
                           TextPrintLayout layout)
    : printer_(printer),
      layout_(std::move(layout)),
      heads_{fonts.Font1Name, fonts.TitleSize >= 1 ? fonts.TitleSize : 8, true, false},
      lines_{fonts.Font2Name, fonts.Font2Points(), false, false} {
  if (layout_.at.empty()) layout_.at = {0};
  if (page.Orient == kPortrait || page.Orient == kLandscape) printer_.SetOrientation(page.Orient);
  left_ = std::max(0, page.PPLft);
  top_ = std::max(0, page.PPTop);
  width_ = printer_.ScaleWidth() - left_ - std::max(0.0, double(page.PPRht));
  bottom_ = printer_.ScaleHeight() - std::max(0.0, double(page.PPBot));
  printer_.StartDoc(layout_.heading);
  try {
    BeginPage();
    if (!(width_ > 0) || full_) throw RunTimeError(kBadCall);
  } catch (...) {
    printer_.KillDoc();
    throw;
  }
}

TextPrintOut::~TextPrintOut() {
  if (!ended_) printer_.KillDoc();
}

void TextPrintOut::BeginPage() {
  ++page_;
  y_ = top_;
  printer_.SetForeColour(0);
  printer_.SetFont(heads_);
  printer_.SetCurrent(left_, y_);
  printer_.Print(layout_.heading + (page_ > 1 ? layout_.continued : ""));
  printer_.SetCurrent(left_ + layout_.pageAt * width_, y_);
  printer_.Print(layout_.pageLabel + Str(std::int32_t(page_)));
  y_ += 2 * printer_.TextHeight() * layout_.lineHeight;
  if (!layout_.columns.empty()) {
    PrintLine(layout_.columns);
    y_ += 0.5 * printer_.TextHeight() * layout_.lineHeight;
  }
  printer_.SetFont(lines_);
  full_ = y_ + printer_.TextHeight() > bottom_;
}

std::string TextPrintOut::Cut(const std::string& text, double room) const {
  std::string cut = text;
  while (!cut.empty() && printer_.TextWidth(cut) > room) {
    // A whole character, of however many bytes.
    while (cut.size() > 1 && (static_cast<unsigned char>(cut.back()) & 0xC0) == 0x80)
      cut.pop_back();
    cut.pop_back();
  }
  return cut;
}

void TextPrintOut::PrintLine(const std::vector<std::string>& texts) {
  for (size_t i = 0; i < texts.size() && i < layout_.at.size(); ++i) {
    const double from = layout_.at[i] * width_;
    // Up to the next column of this line that has a text.
    size_t next = i + 1;
    while (next < layout_.at.size() && (next >= texts.size() || texts[next].empty())) ++next;
    const double to = next < layout_.at.size() ? layout_.at[next] * width_ : width_;
    const std::string text = Cut(texts[i], to - from);
    if (text.empty()) continue;
    printer_.SetCurrent(left_ + from, y_);
    printer_.Print(text);
  }
  y_ += printer_.TextHeight() * layout_.lineHeight;
}

void TextPrintOut::Line(const std::vector<std::string>& texts) {
  if (full_) {
    printer_.NewPage();
    BeginPage();
  }
  PrintLine(texts);
  full_ = y_ + printer_.TextHeight() > bottom_;
}

void TextPrintOut::NewPage() { full_ = true; }

void TextPrintOut::End() {
  ended_ = true;
  printer_.EndDoc();
}

void PrintTable(Printer& printer, const FontSettings& fonts, const PageSettings& page,
                const TextTable& table) {
  TextPrintOut out(printer, fonts, page, table.layout);
  for (const std::vector<std::string>& row : table.rows) out.Line(row);
  out.End();
}

}  // namespace kora
