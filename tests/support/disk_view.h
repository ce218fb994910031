#pragma once

#include <map>
#include <memory>
#include <string>
#include <vector>

#include "tests/support/memory_disk.h"

namespace kora::test {

// What a user finds below a folder of a disk: every file by its name with its bytes, links with
// those of what they lead to, folders by their names with "/" behind them; but for the lock's file
// and for what a kill leaves to be swept ("~" at its end).
using DiskView = std::map<std::string, std::shared_ptr<const Disk::Bytes>>;
DiskView ViewOf(const Disk& disk, const std::string& folder);
bool SameBytes(const std::shared_ptr<const Disk::Bytes>& a,
               const std::shared_ptr<const Disk::Bytes>& b);
bool SameView(const DiskView& a, const DiskView& b);

// Names below a folder that end in "~".
std::vector<std::string> TemporariesOn(const Disk& disk, const std::string& folder);

// Two disks of one key hold the same, what is to be swept too, so that whoever opens them goes on
// alike. A disk with a set of files under way is told apart by the stamps of its files as well, as
// the set itself does.
size_t KeyOf(const Disk& disk);

}  // namespace kora::test
