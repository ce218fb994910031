#pragma once

#include <string_view>

// What the readers must hold whatever bytes they meet. Each is the body of a mutation test
// and of a fuzz target; a broken promise aborts.

namespace kora::test {

void ReadScriptLine(std::string_view bytes);    // SplitScriptLine and its fields
void ReadNumber(std::string_view bytes);        // Val, Str and Format
void ReadSettings(std::string_view bytes);      // SettingsFile, reading and one write
void ReadNameRecords(std::string_view bytes);   // RecordFile<NameRec>
void ReadPriceRecords(std::string_view bytes);  // RecordFile<PriceRec>

}  // namespace kora::test
