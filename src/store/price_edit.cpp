#include "store/price_edit.h"

#include "base/numbers.h"

namespace kora {
namespace {

template <typename T>
std::string BytesOf(std::span<const T> records) {
  CInt(double(records.size()));
  return {reinterpret_cast<const char*>(records.data()), records.size_bytes()};
}

}  // namespace

// The stamp is taken first: a change while the file is read shows as one.
PriceEdit::PriceEdit(const Files& files, std::string path)
    : files_(files), path_(std::move(path)), stamp_(files.Stamp(path_)) {
  const PriceFile file(files, path_);
  CInt(file.count());
  records_ = file.ReadAll();
}

bool PriceEdit::Changed() const { return files_.Stamp(path_) != stamp_; }

void PriceEdit::KeepOld(FileSet& set) const { set.Add(OldFilePath(path_), files_.ReadAll(path_)); }

void PriceEdit::Save(FileSet& set) const { StagePrices(set, path_, records_); }

void StagePrices(FileSet& set, const std::string& path, std::span<const PriceRec> records) {
  set.Add(path, BytesOf(records));
}

void StageNames(FileSet& set, const std::string& path, std::span<const NameRec> records) {
  set.Add(path, BytesOf(records));
}

std::string OldFilePath(std::string_view path) {
  const size_t name = path.find_last_of("\\/:") + 1;
  const size_t dot = path.rfind('.');
  const bool extended = dot != std::string_view::npos && dot > name;
  return std::string(path.substr(0, extended ? dot : path.size())) + ".OLD";
}

}  // namespace kora
