#include "maintenance/code_selection.h"

#include "base/text.h"
#include "platform/dialogs.h"
#include "store/name_file.h"

namespace kora {

void CodeSelection::Load() {
  const FileStamp stamp = files_.Stamp(NameFilePath(dataPath_));
  names_ = ReadNames(files_, dataPath_);
  stamp_ = stamp;
}

bool CodeSelection::Changed() const { return files_.Stamp(NameFilePath(dataPath_)) != stamp_; }

std::string CodeSelection::CodeAt(size_t index) const {
  return FromAnsi(Trim(names_[index].Code.trimmed()));
}

std::string CodeSelection::NameAt(size_t index) const {
  return FromAnsi(names_[index].Name.trimmed());
}

void CodeSelection::Take(const NameRec& rec, std::string_view code) {
  code_ = Trim(code);
  const std::string upper = UCase(code_);
  file_ = IsFileCode(upper) ? dataPath_ + CodeFileName(upper, ".WDT") : std::string();
  name_ = FromAnsi(rec.Name.trimmed());
  label_ = FromAnsi(upper) + ".WDT";
  recType_ = rec.RecType;
}

void CodeSelection::Choose(size_t index) {
  if (index < names_.size()) Take(names_[index], names_[index].Code.trimmed());
}

bool CodeSelection::Enter(std::string_view typed, Dialogs& dialogs, std::optional<size_t>& moveTo) {
  moveTo.reset();
  CurrentName current;
  current.CurrentCode = Trim(ToAnsi(typed));
  if (!LocateCurrentCode(files_, dataPath_, dialogs, current)) {
    file_.clear();
    return false;
  }
  Take(current.Rec, current.Rec.Code.trimmed());
  const auto number = size_t(current.NameRecNo);
  if (number >= 2 && number <= names_.size()) moveTo = number - 1;
  return true;
}

}  // namespace kora
