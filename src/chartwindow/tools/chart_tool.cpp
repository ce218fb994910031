#include "chartwindow/tools/chart_tool.h"

#include "base/numbers.h"
#include "base/text.h"

namespace kora {

std::string LineOf(const DrawnMark& mark) {
  const auto number = [](double value) { return "," + Str(CSng(value)); };
  std::string line(1, mark.letter);
  if (mark.letter == 'T')
    line += ",8.25" + number(mark.x1) + number(mark.y1) + "," + ToAnsi(mark.text);
  else
    line += number(mark.x1) + number(mark.y1) + number(mark.x2) + number(mark.y2);
  return line + "," + Str(mark.colour) + "\r\n";
}

}  // namespace kora
