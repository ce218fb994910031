#pragma once

#include <span>
#include <string>
#include <vector>

#include "store/name_file.h"

namespace kora {

// Writes the records to the work file, brings them to the disk and renames the work file over
// `path`. A failure leaves `path` as it was and no work file.
void ReplaceThrough(const Files& files, const std::string& workPath, const std::string& path,
                    std::span<const NameRec> records);

}  // namespace kora
