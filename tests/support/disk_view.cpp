#include "tests/support/disk_view.h"

namespace kora::test {
namespace {

const Disk::Node& NodeAt(const Disk& disk, const std::string& path, std::uint64_t id) {
  const Disk::Node* node = &disk.nodes.at(id);
  std::string at = path;
  for (int links = 0; links < 40 && !node->link.empty(); ++links) {
    at = node->link.starts_with('/') ? node->link : HostFolderOf(at) + "/" + node->link;
    const auto found = disk.names.find(at);
    if (found == disk.names.end()) break;
    node = &disk.nodes.at(found->second);
  }
  return *node;
}

size_t Mixed(size_t a, size_t b) { return a ^ (b + 0x9e3779b97f4a7c15u + (a << 6) + (a >> 2)); }

}  // namespace

DiskView ViewOf(const Disk& disk, const std::string& folder) {
  DiskView view;
  const std::string head = folder + "/";
  for (auto at = disk.names.lower_bound(head);
       at != disk.names.end() && at->first.starts_with(head); ++at) {
    const std::string name = at->first.substr(head.size());
    if (name.ends_with('~') || name == "Kora.lock") continue;
    const Disk::Node& node = NodeAt(disk, at->first, at->second);
    view[node.folder ? name + "/" : name] = node.bytes;
  }
  return view;
}

bool SameBytes(const std::shared_ptr<const Disk::Bytes>& a,
               const std::shared_ptr<const Disk::Bytes>& b) {
  return a == b || (a->hash == b->hash && a->text == b->text);
}

bool SameView(const DiskView& a, const DiskView& b) {
  if (a.size() != b.size()) return false;
  auto other = b.begin();
  for (const auto& [name, bytes] : a) {
    if (name != other->first || !SameBytes(bytes, other->second)) return false;
    ++other;
  }
  return true;
}

std::vector<std::string> TemporariesOn(const Disk& disk, const std::string& folder) {
  std::vector<std::string> out;
  for (const auto& [name, node] : disk.names)
    if (name.starts_with(folder + "/") && name.ends_with('~')) out.push_back(name);
  return out;
}

size_t KeyOf(const Disk& disk) {
  bool set = false;
  for (const auto& [name, node] : disk.names) set = set || name.ends_with("/Kora.set~");
  size_t key = 0;
  for (const auto& [name, id] : disk.names) {
    if (name.ends_with("/Kora.lock")) continue;
    const Disk::Node& node = disk.nodes.at(id);
    key = Mixed(key, std::hash<std::string>{}(name));
    key = Mixed(key, node.bytes->hash);
    key = Mixed(key, node.mode);
    if (set) key = Mixed(Mixed(key, id), size_t(node.modified));
  }
  return key;
}

}  // namespace kora::test
