#include "update/staged_folder.h"

#include "base/numbers.h"
#include "base/text.h"
#include "store/name_file.h"

namespace kora {

StagedFolder::StagedFolder(const Files& files, std::string path)
    : files_(files), path_(std::move(path)), names_(ReadNames(files_, path_)) {
  namesOnFile_ = names_.size();
  if (const std::string file = NameFilePath(path_); files_.CheckFile(file)) {
    nameFile_ = true;
    const auto host = files_.Open(file, OpenMode::kRead);
    nameBytes_ = namesOnFile_ * sizeof(NameRec);
    tornName_.resize(size_t(host->Size() - nameBytes_));
    tornName_.resize(host->ReadAt(nameBytes_, tornName_.data(), tornName_.size()));
    nameBytes_ += tornName_.size();
  }
  places_.reserve(names_.size());
  for (size_t i = 0; i < names_.size(); ++i)
    places_.try_emplace(std::string(Trim(names_[i].Code.trimmed())), i);
  // Not the sorted listing: thousands of names are wanted in no order.
  const auto listed = files_.io().List(files_.HostPath(path_));
  priceFiles_.reserve(listed.size());
  for (const std::string& name : listed)
    if (std::string upper = UCase(name); upper.ends_with(".WDT"))
      priceFiles_.insert(std::move(upper));
}

size_t StagedFolder::PlaceOf(const std::string& code) const {
  const auto at = places_.find(code);
  return at == places_.end() ? names_.size() : at->second;
}

void StagedFolder::AddName(const NameRec& rec) {
  places_.try_emplace(std::string(Trim(rec.Code.trimmed())), names_.size());
  names_.push_back(rec);
  bytes_ += sizeof(rec);
}

void StagedFolder::ChangeName(size_t place, const NameRec& rec) {
  if (place < namesOnFile_) {
    oldNames_.try_emplace(place, names_[place]);
    bytes_ += 2 * sizeof(rec);
  }
  names_[place] = rec;
}

bool StagedFolder::HasPrices(std::string_view name) const {
  return priceFiles_.contains(UCase(name));
}

PriceView StagedFolder::Prices(const std::string& name) {
  const std::string upper = UCase(name);
  shown_.try_emplace(upper, name);
  const bool exists = !priceFiles_.insert(upper).second;
  return PriceView(files_, path_ + name, exists, prices_[upper]);
}

void StagedFolder::Count(const std::string& name) {
  const auto at = prices_.find(UCase(name));
  if (at == prices_.end()) return;
  // A file that was only looked at takes no room.
  if (at->second.existed && at->second.fresh.empty())
    prices_.erase(at);
  else
    bytes_ += sizeof(StagedPrices) + 4 * sizeof(PriceRec);
}

std::vector<FileEdit> StagedFolder::Edits() {
  std::vector<FileEdit> edits;
  if (names_.size() > namesOnFile_ || !oldNames_.empty()) {
    FileEdit& edit = edits.emplace_back();
    edit.path = NameFilePath(path_);
    edit.existed = nameFile_;
    edit.before = nameBytes_;
    const auto bytesOf = [](const NameRec& rec) {
      return std::string(reinterpret_cast<const char*>(&rec), sizeof(rec));
    };
    for (const auto& [place, old] : oldNames_)
      edit.changes.push_back({place * sizeof(NameRec), bytesOf(old), bytesOf(names_[place])});
    if (names_.size() > namesOnFile_) {
      ByteChange& added = edit.changes.emplace_back();
      added.offset = namesOnFile_ * sizeof(NameRec);
      added.old = tornName_;
      for (size_t i = namesOnFile_; i < names_.size(); ++i) added.fresh += bytesOf(names_[i]);
    }
  }
  for (const auto& [upper, staged] : prices_)
    if (!staged.existed || !staged.fresh.empty())
      edits.push_back(staged.Edit(path_ + shown_.at(upper)));
  return edits;
}

void StagedFolder::Made() {
  if (names_.size() > namesOnFile_) {
    nameFile_ = true;
    namesOnFile_ = names_.size();
    nameBytes_ = namesOnFile_ * sizeof(NameRec);
    tornName_.clear();
  }
  oldNames_.clear();
  prices_.clear();
  shown_.clear();
  bytes_ = 0;
}

}  // namespace kora
