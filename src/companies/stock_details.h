#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "settings/settings.h"
#include "update/security_details.h"

// Facts of companies, as the store in the download system folder has them:
// SecurityDetails.Stx, its index Sdix1.inx, and STKHeader.txt, the labels of its fields.

namespace kora {

// The labels of the service's header in order, the first that of the code; UTF-8. Empty where
// there is no file. More than 200 labels are not read.
std::vector<std::string> ReadDetailLabels(const Files& files, const DownloadSettings& download);

// The store, read as a whole, with its index.
class CompanyStore {
 public:
  // Errors of reading; 7 for a store of more than 64 MB. A torn record at the end, and lines of
  // the index that name no code or no record, are left out.
  CompanyStore(const Files& files, const DownloadSettings& download);

  // Labels behind that of the code, one a field.
  const std::vector<std::string>& labels() const { return labels_; }

  // The codes of the store in its order, each once.
  const std::vector<std::string>& codes() const { return codes_; }

  // Number of the first record of a code, from 1, through the index; 0 when it is not there, or
  // the index points elsewhere.
  std::int32_t Find(std::string_view code) const;
  // Records of one code that follow each other, from its first.
  std::int32_t CountFrom(std::int32_t first) const;

  // The fields of a record in the order of labels(), trimmed, UTF-8; as many as there are labels.
  std::vector<std::string> Fields(std::int32_t record) const;

 private:
  std::string_view Code(std::int32_t record) const;

  std::vector<std::string> labels_;
  std::vector<DetailsRec> records_;
  std::vector<std::string> codes_;
  std::vector<std::pair<std::string, std::int32_t>> index_;  // by code
  char delimiter_ = 0;
};

struct StockDetail {
  std::string description, value;
};
// `GetStockDetails`: the facts of a code in any case, the first record's; empty when it is not in
// the store.
std::vector<StockDetail> GetStockDetails(const CompanyStore& store, std::string_view code);

// The dividends of a company: Current Div of its records, the first of an interim dividend and
// the first of a final one by Div. Type ("INTERIM", "FINAL", or their first letters). Dollars;
// 0 where there is none.
struct Dividends {
  double interim = 0, final = 0;
  double Sum() const { return interim + final; }
};
Dividends DividendsOf(const CompanyStore& store, std::string_view code);

// What stands behind the question before a detail goes to the name file.
std::string TransferQuestion(std::string_view description);
inline constexpr std::string_view kTransferTitle = "Transfer to Name File";
// A value as Other Details takes it: commas made blanks, cut to 15 bytes. ANSI.
std::string AsOtherDetails(std::string_view value);

}  // namespace kora
