#pragma once

#include <string>
#include <vector>

#include "base/numbers.h"
#include "base/runtime_error.h"
#include "platform/printer.h"

namespace kora::test {

// A printer of paper 210 by 297 mm with edges of 200 twips, that keeps what is printed as lines
// of text: "line solid 2 1,2,3,4 255" with the pen's width, "text 8.25 b 20,2 BHP 7",
// "box 1 ...", "fill 1 ...". `sent` holds the documents that were sent.
class RecordingPrinter : public Printer {
 public:
  std::string device = "Press";  // empty: no printer
  std::string refused;           // the face that is refused
  int failAtEnd = 0;             // error of EndDoc
  std::vector<std::string> ops;  // of the document under way or last sent
  std::vector<std::vector<std::string>> sent;
  int started = 0, killed = 0;
  double scaleLeft = 0, scaleTop = 0;
  SurfaceFont font;

  std::vector<std::string> DeviceNames() const override { return {"Press", "Other Press"}; }
  std::string DeviceName() const override { return device; }
  void SetDevice(std::string_view name) override { device = std::string(name); }
  std::int16_t Orientation() const override { return orientation_; }
  void SetOrientation(std::int16_t orientation) override { orientation_ = orientation; }
  std::vector<std::string> PaperNames() const override { return {"A4", "Letter"}; }
  std::string PaperName() const override { return paper_; }
  void SetPaper(std::string_view name) override { paper_ = std::string(name); }
  Sheet Page() const override {
    Sheet sheet;
    sheet.width = orientation_ == kLandscape ? 16838 : 11906;
    sheet.height = orientation_ == kLandscape ? 11906 : 16838;
    sheet.left = sheet.top = 200;
    sheet.reachWidth = sheet.width - 400;
    sheet.reachHeight = sheet.height - 400;
    return sheet;
  }
  void StartDoc(std::string_view) override {
    if (device.empty()) throw RunTimeError(kDeviceNotAvailable);
    ++started;
    open_ = true;
    ops.clear();
  }
  void NewPage() override { ops.push_back("page"); }
  void EndDoc() override {
    open_ = false;
    if (failAtEnd != 0) throw RunTimeError(failAtEnd);
    sent.push_back(ops);
  }
  void KillDoc() override {
    if (open_) ++killed;
    open_ = false;
  }
  void SetScale(double left, double top) override {
    scaleLeft = left;
    scaleTop = top;
  }
  void SetDrawStyle(DrawStyle style) override { style_ = style; }
  void SetDrawWidth(double width) override { width_ = width; }
  void SetForeColour(Colour colour) override { fore_ = colour; }
  void Line(double x1, double y1, double x2, double y2, Colour c) override {
    static constexpr const char* kNames[] = {"solid", "dash", "dot"};
    Add(std::string("line ") + kNames[int(style_)], x1, y1, x2, y2, c);
  }
  void Box(double x1, double y1, double x2, double y2, Colour c) override {
    Add("box", x1, y1, x2, y2, c);
  }
  void FilledBox(double x1, double y1, double x2, double y2, Colour c) override {
    Add("fill", x1, y1, x2, y2, c);
  }
  void SetFont(const SurfaceFont& f) override {
    if (!refused.empty() && f.name == refused) throw RunTimeError(kInvalidValue);
    font = f;
  }
  // A character is as wide as half its height.
  double TextWidth(std::string_view text) const override {
    return double(text.size()) * font.size * 10;
  }
  double TextHeight() const override { return font.size * 20; }
  void SetCurrent(double x, double y) override { x_ = x, y_ = y; }
  double CurrentX() const override { return x_; }
  double CurrentY() const override { return y_; }
  void Print(std::string_view text) override {
    std::string op = "text " + Str(font.size);
    if (font.bold) op += " b";
    if (font.italic) op += " i";
    if (!font.name.empty()) op += " " + font.name;
    ops.push_back(op + " " + Str(x_) + "," + Str(y_) + " " + std::string(text) + " " + Str(fore_));
    x_ = scaleLeft;
    y_ += TextHeight();
  }

 private:
  void Add(const std::string& what, double x1, double y1, double x2, double y2, Colour c) {
    ops.push_back(what + " " + Str(width_) + " " + Str(x1) + "," + Str(y1) + "," + Str(x2) + "," +
                  Str(y2) + " " + Str(c));
  }
  std::int16_t orientation_ = kPortrait;
  std::string paper_ = "A4";
  bool open_ = false;
  DrawStyle style_ = DrawStyle::kSolid;
  double width_ = 1;
  Colour fore_ = 0;
  double x_ = 0, y_ = 0;
};

}  // namespace kora::test
