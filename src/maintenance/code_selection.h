#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "store/name_rec.h"

// The choice of the security whose price file is to be seen: what stands behind the form
// `EnterCode`.

namespace kora {

class Dialogs;

class CodeSelection {
 public:
  CodeSelection(const Files& files, const std::string& dataPath)
      : files_(files), dataPath_(dataPath) {}

  // Reads the name file, in whose order the codes stand; no file gives none. What is chosen stays.
  // Errors of reading.
  void Load();
  // True when another program changed the name file since.
  bool Changed() const;

  size_t count() const { return names_.size(); }
  std::string CodeAt(size_t index) const;  // trimmed, UTF-8
  std::string NameAt(size_t index) const;

  // A click on the list: the security at this place.
  void Choose(size_t index);
  // A typed code. False, and told, when there is none such; nothing is chosen then. `moveTo` is the
  // place to which the list goes: the first one is never gone to.
  bool Enter(std::string_view typed, Dialogs& dialogs, std::optional<size_t>& moveTo);

  const std::string& CurrentCode() const { return code_; }  // trimmed, ANSI
  // The price file of what is chosen, empty for nothing or a code that can name no file.
  const std::string& CurrentDataFile() const { return file_; }
  const std::string& Name() const { return name_; }    // of the security
  const std::string& Label() const { return label_; }  // its code + ".WDT"
  std::int16_t RecType() const { return recType_; }

 private:
  void Take(const NameRec& rec, std::string_view code);

  const Files& files_;
  const std::string& dataPath_;
  std::vector<NameRec> names_;
  FileStamp stamp_;
  std::string code_, file_, name_, label_;
  std::int16_t recType_ = kShare;
};

}  // namespace kora
