#pragma once

#include <cstddef>

#include "base/files.h"
#include "base/text.h"
#include "settings/settings.h"

namespace kora {

#pragma pack(push, 1)
// One record of SecurityDetails.Stx.
struct DetailsRec {
  FixedText<6> Code;
  FixedText<306> Details;  // the rest of the service's line
};
#pragma pack(pop)
static_assert(sizeof(DetailsRec) == 312 && offsetof(DetailsRec, Details) == 6);

// True when SecurityDetails.Stx and Sdix1.inx stand in the download system folder.
bool KoraDetailsReady(const Files& files, const DownloadSettings& download);

// Takes the details file that the service left into the store: STKHeader.txt,
// SecurityDetails.Stx and Sdix1.inx of the download system folder, replaced together. The
// delimiter is the first character of the header that is no letter, digit, blank or
// underscore. Returns quietly, with everything as it was, when there is no such file, or it can't
// be used: a header without a delimiter or in another alphabet, more than 200,000 codes.
void UpdateSecurityDetails(const Files& files, const DownloadSettings& download);

}  // namespace kora
