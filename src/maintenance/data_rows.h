#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "base/files.h"
#include "lists/grid_source.h"
#include "store/price_rec.h"

// A price file in a grid, corrected by hand: what stands behind the forms `DataForm` and `VolMod`.

namespace kora {

class Dialogs;
class Progress;

inline constexpr std::string_view kDataTitle = "Data";
inline constexpr std::string_view kDataFileTitle = "Data File";
inline constexpr std::string_view kSaveDataTitle = "Saving Data";
inline constexpr std::string_view kScaleTitle = "Data Modification";
// Put before a file is replaced that another program wrote since it was shown.
inline constexpr std::string_view kDataChangedOutside =
    "The data file was changed by another program. Save over these changes ?";

// The columns of the grid, in their order.
enum DataColumn : int {
  kDataRec,
  kDataDate,
  kDataOpen,
  kDataHigh,
  kDataLow,
  kDataClose,
  kDataVolume,
  kDataAdjFactor,
  kDataAdjDesc,
};
inline constexpr int kDataColumns = 9;
// An advance/decline series has headings of its own.
std::string DataHeading(DataColumn column, std::int16_t RecType);

// What `VolMod` multiplies or divides: open, high, low, close, volume.
using ScaleItems = std::array<bool, 5>;
enum class ScaleBy { kTimes10, kTimes100, kOver10, kOver100 };

// "Modify record 3", "Modify records 3 to 7", "There are no records selected".
std::string ScaleCaption(RowBlock rows);
// What the ticks will do; empty without one.
std::string ScaleText(const ScaleItems& items);
// What is missing before anything can be scaled.
std::optional<Refusal> CheckScale(const ScaleItems& items, std::optional<ScaleBy> by);

// The records of one price file, as many as it has. They are held as the file's own bytes, and
// texts are made of those that are asked for, so that a file of a million days opens as one of ten;
// what nobody edits is saved as it was read.
class DataRows : public GridSource {
 public:
  DataRows(const Files& files, std::string path) : files_(files), path_(std::move(path)) {}

  const std::string& path() const { return path_; }
  const std::vector<PriceRec>& records() const { return records_; }
  // The rows are not those of the file.
  bool changed() const { return changed_; }

  // `ShowData`: reads the file. False, and told, when it is not there, holds no record or can't be
  // read; false when `progress` stops it. The rows are empty then.
  bool ShowData(std::string_view code, Progress& progress, Dialogs& dialogs);

  // `SaveData`: the file as it was is kept as Temp.WRK beside it, and the rows take its place, each at
  // its number, both together. A file that another program changed meanwhile asks first. False
  // when nothing was written: told, unless `progress` stopped it.
  bool SaveData(Progress& progress, Dialogs& dialogs);

  // By date, rows of one date in the order in which they stand.
  void SortByDate();

  // Multiplies or divides; prices are rounded to four decimals, volumes cut to whole numbers, a
  // volume of 0 stays. Nothing has changed where a number would not fit its field.
  std::optional<Refusal> Scale(RowBlock rows, const ScaleItems& items, ScaleBy by);

  int RowCount() const override { return int(records_.size()); }
  std::string Text(int row, int column) const override;
  // A row whose date is none stands out.
  GridShade Shade(int row, int column) const override;
  // Dates are taken as typed, up to 8 bytes; notes up to 14.
  std::optional<Refusal> SetText(int row, int column, const std::string& text) override;
  // A row without a date holds no record, and stays.
  std::optional<Refusal> MayDelete(RowBlock rows) const override;
  void DeleteRows(RowBlock rows) override;

 private:
  const Files& files_;
  std::string path_;
  FileStamp stamp_;  // of the file as it was read
  std::vector<PriceRec> records_;
  bool changed_ = false;
};

}  // namespace kora
