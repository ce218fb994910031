#include "tests/monkey/driver/words.h"

#include <array>

namespace kora::monkey {
namespace {

template <size_t N>
const char* OneOf(Generator& generator, const std::array<const char*, N>& texts) {
  return texts[size_t(Below(generator, int(N)))];
}

constexpr std::array kNumbers{"0",
                              "1",
                              "2",
                              "3",
                              "5",
                              "10",
                              "14",
                              "20",
                              "21",
                              "60",
                              "100",
                              "200",
                              "201",
                              "-1",
                              "-0.5",
                              "0.01",
                              ".",
                              "-",
                              "3.5",
                              "12,5",
                              "32767",
                              "32768",
                              "-32769",
                              "2147483647",
                              "2147483648",
                              "1e38",
                              "1e309",
                              "nan",
                              "&HFF",
                              "1e-40",
                              "99999999999999999999",
                              "  7 ",
                              "1 2",
                              "$4.20",
                              "7%",
                              "0.000001",
                              "922337203685477.5807"};
constexpr std::array kDates{"30/10/26", "29/10/26",   "2/11/26",    "3/11/26",  "4/11/26",
                            "31/2/26",  "29/2/24",    "29/02/2024", "1/1/1900", "99/99/99",
                            "20261030", "30/10/2026", "1/1/30",     "31/12/29", "0/0/0",
                            "30-10-26", "1/1/9999",   "today",      "30/6/26",  "1/7/25"};
constexpr std::array kScripts{"Ωμέγα", "日本語",        "العربية",   "ЁЖИК",   "ǅungla",
                              "🙈🙉🙊",   "é\u0301\u0301", "\u202Eabc", "\uFEFF", "\u200D",
                              "ﷺ",     "नमस्ते",          "x\u00A0y"};
constexpr std::array kOdd{"..",        "../../x",
                          "C:\\",      "c:\\korawin\\data\\",
                          "CON",       "A/B",
                          "\"",        ";",
                          "%s%n%d",    "a\tb",
                          "<b>x</b>",  "&File",
                          "*",         "?",
                          "A:",        "\\\\host\\x",
                          "NUL.txt",   ",,,,",
                          "'",         "[x]",
                          "=1+1",      "c:\\korawin\\data2",
                          "backup",    "\\",
                          "data\\..",  "-",
                          "+",         "x.cht",
                          "sub\\x.csv"};

QString Long(Generator& generator) {
  static constexpr std::array kLengths{41, 81, 255, 256, 257, 1000, 5000, 33000};
  const int length = kLengths[size_t(Below(generator, int(kLengths.size())))];
  if (Chance(generator, 0.3)) return QString("日").repeated(length);
  return QString(QChar('A' + Below(generator, 26))).repeated(length);
}

QString Noise(Generator& generator) {
  QString text;
  for (int left = 1 + Below(generator, 12); left > 0; --left) {
    if (Chance(generator, 0.9))
      text += QChar(' ' + Below(generator, 95));
    else
      text += QChar(1 + Below(generator, 0xD7FF));
  }
  return text;
}

}  // namespace

QString TextToType(Generator& generator, const std::vector<std::string>& codes) {
  const int kind = Below(generator, 100);
  if (kind < 30 && !codes.empty()) {
    const QString code = QString::fromStdString(codes[size_t(Below(generator, int(codes.size())))]);
    return Chance(generator, 0.2) ? code.toLower() : code;
  }
  if (kind < 58) return OneOf(generator, kNumbers);
  if (kind < 73) return OneOf(generator, kDates);
  if (kind < 80) return OneOf(generator, kScripts);
  if (kind < 88) return OneOf(generator, kOdd);
  if (kind < 91) return Long(generator);
  return Noise(generator);
}

QString FileNameToType(Generator& generator) {
  static constexpr std::array kNames{
      "monkey.cht", "monkey",    "m.png",   "m.svg", "m.pdf", "m.csv",     "m.txt",     "Ωμέγα.cht",
      "a b.cht",    "noending.", ".hidden", "long",  "X.PDF", "Names.dat", "broken.cht"};
  QString name = OneOf(generator, kNames);
  if (name == "long") name = QString("n").repeated(300) + ".cht";
  return name;
}

}  // namespace kora::monkey
