#pragma once

#include <string>
#include <vector>

#include "base/numbers.h"
#include "platform/headless/headless_surface.h"

namespace kora::test {

// Keeps what is drawn as lines of text: "line solid 1,2,3,4 255", "text 8.25 b 20,2 BHP 7".
class RecordingSurface : public HeadlessSurface {
 public:
  using HeadlessSurface::HeadlessSurface;
  std::vector<std::string> ops;

  void Cls() override {
    HeadlessSurface::Cls();
    ops.push_back("cls");
  }
  void SetForeColour(Colour colour) override { fore_ = colour; }
  void SetDrawStyle(DrawStyle style) override { style_ = style; }
  void SetDrawMode(DrawMode mode) override { mode_ = mode; }
  void Line(double x1, double y1, double x2, double y2, Colour c) override {
    static constexpr const char* kNames[] = {"solid", "dash", "dot"};
    Add(std::string(mode_ == DrawMode::kXor ? "xor " : "line ") + kNames[int(style_)], x1, y1, x2,
        y2, c);
  }
  void Box(double x1, double y1, double x2, double y2, Colour c) override {
    Add("box", x1, y1, x2, y2, c);
  }
  void FilledBox(double x1, double y1, double x2, double y2, Colour c) override {
    Add("fill", x1, y1, x2, y2, c);
  }
  void PSet(double x, double y, Colour c) override {
    ops.push_back("point " + Str(x) + "," + Str(y) + " " + Str(c));
  }
  void Print(std::string_view text) override {
    std::string op = "text " + Str(Font().size);
    if (Font().bold) op += " b";
    if (Font().italic) op += " i";
    op +=
        " " + Str(CurrentX()) + "," + Str(CurrentY()) + " " + std::string(text) + " " + Str(fore_);
    ops.push_back(op);
    HeadlessSurface::Print(text);
  }

  bool Has(const std::string& op) const {
    for (const std::string& o : ops)
      if (o == op) return true;
    return false;
  }

 private:
  void Add(const std::string& what, double x1, double y1, double x2, double y2, Colour c) {
    ops.push_back(what + " " + Str(x1) + "," + Str(y1) + "," + Str(x2) + "," + Str(y2) + " " +
                  Str(c));
  }
  DrawStyle style_ = DrawStyle::kSolid;
  DrawMode mode_ = DrawMode::kCopy;
  Colour fore_ = 0;
};

}  // namespace kora::test
