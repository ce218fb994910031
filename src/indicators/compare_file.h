#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "base/files.h"
#include "platform/dialogs.h"
#include "store/price_rec.h"

namespace kora {

// The price file of a market index that RMO and RMX hold a security against.
//
// Records are paired by position from the end of each file and not by date: a compare file with
// other trading days is misaligned without a word.

// The name of `compFile` in upper case, without folder and extension. Blank when there is no
// such file, when it does not end in ".WDT" (in any case) or when it has no folder: the user is
// told then.
std::string ValidateCompareFile(const Files& files, Dialogs& dialogs, const std::string& compFile);

// Opens it for reading; nothing when it is gone meanwhile.
std::optional<PriceFile> OpenCompareFile(const Files& files, const std::string& compFile);

// The closes of records first to first + n - 1.
std::vector<float> ReadCloses(const PriceFile& file, std::int32_t first, std::int32_t n);

// What both oscillators are made of: close of compare / (close of security * 100). 0 where the
// security has no close. Error 6 where it does not fit a 32-bit float.
float CompareRatio(float compareClose, float close);

}  // namespace kora
