// The operations of koractl that write.

#include <cstdio>

#include "tests/kills/operations.h"

namespace kora::test {
namespace {

std::string Day(const char* date, const char* const* codes, double price) {
  std::string out;
  char line[120];
  for (; *codes; ++codes) {
    std::snprintf(line, sizeof line, "%s,%s,%.2f,%.2f,%.2f,%.2f,%d,0\r\n", *codes, date, price,
                  price + 0.1, price - 0.1, price + 0.05, 1000);
    out += line;
    price += 1;
  }
  return out;
}

// Codes of the demo market of eight securities.
const char* const kCodes[] = {"CJQ", "CXQ", "FVQ", "NQZ", "TZQ", "VKQ", nullptr};
const char* const kFresh[] = {"CJQ", "NEWA", "NEWB", nullptr};
const std::string kDown = "drive_c/korawin/download/";
const std::string kData = "drive_c/korawin/data/";

}  // namespace

const std::vector<Operation>& CommandOperations() {
  static const std::vector<Operation> operations = {
      {"import of new and old securities",
       {},
       Cmd("import", "{home}/in.csv"),
       kFileByFile,
       {{"in.csv", Day("20261105", kFresh, 3) + Day("20261106", kFresh, 4)}}},
      {"import that replaces days",
       {},
       Cmd("import", "{home}/in.csv"),
       kFileByFile,
       {{"in.csv", Day("20261030", kCodes, 3)}}},
      {"update of service 1", {}, Cmd("update", "02NOV26.d"), kDayByDay},
      {"update of all days", {}, Cmd("update", "--all"), kDayByDay},
      {"update of service 2",
       {},
       Cmd("--set", "Download.DataService=2", "update", "02NOV26.d"),
       kDayByDay},
      {"update of service 4",
       {},
       Cmd("--set", "Download.DataService=4", "--set", "Download.InternetDLfmt=DDMMMYY.D", "update",
           "02NOV26.d"),
       kDayByDay},
      {"update of service 5",
       {},
       Cmd("--set", "Download.DataService=5", "update", "02NOV26.d"),
       kDayByDay},
      {"bulletins", {}, Cmd("bulletins", "03NOV26")},
      {"bonus issue",
       {},
       Cmd("adjust", "bonus", "CJQ", "--date", "{day}", "--new", "1", "--held", "4")},
      {"share split of a chart with notes",
       {Cmd("notes", "CJQ", "add", "--at", "300,200", "a note")},
       Cmd("adjust", "split", "CJQ", "--date", "{day}", "--new", "2", "--old", "1")},
      {"removal of an adjustment",
       {Cmd("adjust", "split", "CJQ", "--date", "{day}", "--new", "2", "--old", "1")},
       Cmd("adjust", "remove", "CJQ")},
      {"adjustments made",
       {Cmd("bulletins", "02NOV26"), Cmd("bulletins", "03NOV26"), Cmd("bulletins", "04NOV26"),
        Cmd("adjustments", "set", "Y")},
       Cmd("adjustments", "make"),
       kRowByRow},
      {"adjustments sorted",
       {Cmd("bulletins", "02NOV26"), Cmd("bulletins", "03NOV26")},
       Cmd("adjustments", "sort")},
      {"names sorted", {}, Cmd("edit-names", "sort", "class")},
      {"names in title case", {}, Cmd("edit-names", "title-case")},
      {"optional fields cleaned", {}, Cmd("edit-names", "clean-optional")},
      {"a day entered",
       {},
       Cmd("enter", "CJQ", "--date", "5/11/26", "--open", "2.4", "--high", "2.6", "--low", "2.3",
           "--close", "2.5"),
       kInPlace},
      {"a code changed", {}, Cmd("change-code", "CJQ", "NEWC")},
      {"two codes combined", {}, Cmd("change-code", "CJQ", "FVQ")},
      {"a file moved",
       {},
       Cmd("move", "CJQ", "--from", "c:\\korawin\\data\\", "--to", "c:\\korawin\\other\\"),
       kWhole,
       {{"drive_c/korawin/other/Names.dat", ""}}},
      {"files checked and mended",
       {},
       Cmd("--answer", "yes", "check", "data", "--types", "1,2,4,5"),
       kFileByFile},
      {"names checked",
       {},
       Cmd("--answer", "yes", "check", "names"),
       kFileByFile,
       {{kData + "LOST.WDT", std::string(500, ' ')}}},
      {"backup", {}, Cmd("backup"), kFileByFile},
      {"restore",
       {Cmd("backup"), Cmd("enter", "CJQ", "--date", "5/11/26", "--open", "2.4", "--high", "2.6",
                           "--low", "2.3", "--close", "2.5")},
       Cmd("restore"),
       kFileByFile},
      {"closes exported", {}, Cmd("export", "closes")},
      {"a history exported", {}, Cmd("export", "history", "CJQ")},
      {"a date removed", {}, Cmd("remove-date", "{last}"), kFileByFile},
      {"a trendline drawn", {}, Cmd("lines", "CJQ", "add", "--at", "100,100,300,200")},
      {"a trendline deleted",
       {Cmd("lines", "CJQ", "add", "--at", "100,100,300,200"),
        Cmd("lines", "CJQ", "add", "--at", "120,100,300,220")},
       Cmd("lines", "CJQ", "delete", "1")},
      {"a text written", {}, Cmd("notes", "CJQ", "add", "--at", "300,200", "a note")},
      {"a text deleted",
       {Cmd("notes", "CJQ", "add", "--at", "300,200", "a note")},
       Cmd("notes", "CJQ", "delete", "1")},
      {"a set of oscillators kept",
       {},
       Cmd("multi", "sets", "--set", "1", "--oscs", "MACD,RSI,None,FX")},
      {"scan 1", {}, Cmd("scan1", "--rise", "1")},
      {"scan 2", {}, Cmd("scan2", "--price", "1")},
      {"scan 3", {}, Cmd("scan3", "--up")},
      {"statistics", {}, Cmd("stats")},
      {"snapshot list", {}, Cmd("snapshot", "1", "add", "CJQ")},
  };
  return operations;
}

}  // namespace kora::test
