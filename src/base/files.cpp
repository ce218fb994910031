#include "base/files.h"

#include <algorithm>

#include "base/file_set.h"
#include "base/runtime_error.h"
#include "base/text.h"

namespace kora {

// What a folder held when it was read. A change shows in the folder's time, but the host's clock
// is coarse: a change right after the reading can leave the time as it was.
struct Files::Folder {
  std::int64_t modified = -1;
  bool sure = false;   // read when the time had settled: every later change shows
  bool own = false;    // the last change was the program's own, and is entered here
  bool twins = false;  // there are names that differ in case alone
  // Lower-case name to the name on the host; where two differ in case alone, the first by bytes.
  std::unordered_map<std::string, std::string> entries;
};

namespace {

bool IsLetter(char c) { return (c >= 'A' && c <= 'Z') || (c >= 'a' && c <= 'z'); }
bool IsSeparator(char c) { return c == '\\' || c == '/'; }

// The names of a path without its drive, "." passed over and ".." taken back, never above the
// drive.
std::vector<std::string_view> PathNames(std::string_view path) {
  std::vector<std::string_view> names;
  size_t start = 0;
  for (size_t i = 0; i <= path.size(); ++i) {
    if (i < path.size() && !IsSeparator(path[i])) continue;
    const std::string_view name = path.substr(start, i - start);
    start = i + 1;
    if (name.empty() || name == ".") continue;
    if (name == "..") {
      if (!names.empty()) names.pop_back();
      continue;
    }
    names.push_back(name);
  }
  return names;
}

struct DosParts {
  char drive = 'c';
  std::string_view rest;
};

DosParts SplitDrive(std::string_view path) {
  if (path.empty() || path.find('\0') != std::string_view::npos) throw RunTimeError(kBadFileName);
  DosParts parts;
  parts.rest = path;
  if (path.size() >= 2 && path[1] == ':') {
    if (!IsLetter(path[0])) throw RunTimeError(kBadFileName);
    parts.drive = char(path[0] | 0x20);
    parts.rest = path.substr(2);
  }
  return parts;
}

// Splits "c:\a\b.txt" into "c:\a\" and "b.txt".
std::pair<std::string_view, std::string_view> SplitName(std::string_view path) {
  size_t end = path.size();
  while (end > 0 && !IsSeparator(path[end - 1]) && !(end == 2 && path[1] == ':')) --end;
  return {path.substr(0, end), path.substr(end)};
}

// Drive C: has the home under this name.
bool IsWindows(const DosParts& parts, std::string_view name) {
  return parts.drive == 'c' && EqualNoCase(name, "windows");
}

std::string Join(const std::string& folder, std::string_view name) {
  std::string out;
  out.reserve(folder.size() + 1 + name.size());
  out += folder;
  if (out.empty() || out.back() != '/') out += '/';
  out += name;
  return out;
}

}  // namespace

namespace {

std::string WithoutSlash(std::string home) {
  while (home.size() > 1 && home.back() == '/') home.pop_back();
  return home.empty() ? "." : home;  // never the root of the host
}

}  // namespace

Files::Files(std::string home, Io& io)
    : home_(WithoutSlash(std::move(home))), io_(io), lock_(home_, io) {}

Files::~Files() = default;

std::int64_t Files::Modified(const std::string& host) const {
  const HostStatus status = io_.Status(host);
  return status.exists && status.folder ? status.modified : -1;
}

Files::Folder* Files::ReadFolder(const std::string& host, std::int64_t modified) const {
  std::unique_ptr<Folder>& folder = listings_[host];
  folder = std::make_unique<Folder>();
  folder->modified = modified;
  folder->sure = TimeIsSettled(modified);
  std::vector<std::string> names;
  try {
    names = io_.List(host);
  } catch (const RunTimeError& e) {
    listings_.erase(host);
    if (e.number() != kPathAccess && e.number() != kPathNotFound) throw;
    return nullptr;  // a folder that may not be listed has no names to offer
  }
  std::sort(names.begin(), names.end());
  for (std::string& name : names) {
    std::string key = LCase(name);
    if (!folder->entries.emplace(std::move(key), std::move(name)).second) folder->twins = true;
  }
  return folder.get();
}

Files::Folder* Files::FolderFor(const std::string& host, std::int64_t modified) const {
  const auto it = listings_.find(host);
  if (modified < 0) {
    if (it != listings_.end()) listings_.erase(it);
    return nullptr;
  }
  if (it != listings_.end() && it->second->modified == modified) return it->second.get();
  return ReadFolder(host, modified);
}

const std::string* Files::FindEntry(const std::string& hostFolder, std::string_view name,
                                    bool making, std::int64_t modified) const {
  Folder* folder = FolderFor(hostFolder, modified);
  if (!folder) return nullptr;
  const std::string key = LCase(name);
  auto it = folder->entries.find(key);
  const bool found = it != folder->entries.end();
  // Who looks where to make a file may rely on the program's own notes, or making thousands
  // would read the folder thousands of times. Who looks for a file must not miss it.
  if (!folder->sure &&
      (found ? !io_.Status(Join(hostFolder, it->second)).exists : !(making && folder->own))) {
    folder = ReadFolder(hostFolder, Modified(hostFolder));
    if (!folder) return nullptr;
    it = folder->entries.find(key);
  }
  return it == folder->entries.end() ? nullptr : &it->second;
}

// The program's own changes are entered into a listing that was true before them.
void Files::Note(const std::string& host, bool added, std::int64_t before) const {
  Note(host, added, before, Modified(HostFolderOf(host)));
}

void Files::Note(const std::string& host, bool added, std::int64_t before,
                 std::int64_t after) const {
  const std::string hostFolder = HostFolderOf(host);
  const auto it = listings_.find(hostFolder);
  if (it == listings_.end()) return;
  Folder& folder = *it->second;
  const std::string name = host.substr(host.rfind('/') + 1);
  // A name taken away may leave its twin behind, which the listing does not hold.
  if (folder.modified != before || (!added && folder.twins)) {
    listings_.erase(it);
    return;
  }
  if (added) {
    const auto [entry, fresh] = folder.entries.emplace(LCase(name), name);
    if (!fresh && entry->second != name) folder.twins = true;
  } else {
    folder.entries.erase(LCase(name));
  }
  if (after == before && folder.sure) return;  // a file that was there: nothing changed
  folder.modified = after;
  folder.sure = false;
  folder.own = true;
}

std::int64_t Files::NoteTemporary(const std::string& hostFolder, std::int64_t before) const {
  const std::int64_t after = Modified(hostFolder);
  const auto it = listings_.find(hostFolder);
  if (it != listings_.end() && it->second->modified == before) {
    it->second->modified = after;
    it->second->sure = false;
    it->second->own = true;
  }
  return after;
}

std::string Files::ResolveFolder(std::string_view dosFolder) const {
  const auto known = folders_.find(dosFolder);
  if (known != folders_.end()) return known->second.host;

  std::string host;
  const DosParts parts = SplitDrive(dosFolder.empty() ? std::string_view("c:\\") : dosFolder);
  if (parts.drive == 'z') {
    host.assign(1, '/');
  } else {
    host = Join(home_, std::string("drive_") + parts.drive);
  }
  std::vector<std::string_view> names = PathNames(parts.rest);
  if (!names.empty() && IsWindows(parts, names.front())) {
    host = home_;
    names.erase(names.begin());
  }
  for (const std::string_view name : names) {
    std::string next = Join(host, name);
    if (!io_.Status(next).exists) {
      if (const std::string* entry = FindEntry(host, name, false, Modified(host)))
        next = Join(host, *entry);
    }
    host = std::move(next);
  }
  // A folder that is not there yet may come in another case.
  if (Modified(host) >= 0) folders_.emplace(dosFolder, Known{host});
  return host;
}

std::string Files::Locate(std::string_view path, bool making) const {
  const DosParts parts = SplitDrive(path);
  const auto [folder, name] = SplitName(path);
  if (name.empty() || name == "." || name == ".." || IsWindows(parts, name))
    return ResolveFolder(path);
  std::string hostFolder = ResolveFolder(folder);
  std::string host = Join(hostFolder, name);
  if (io_.Status(host).exists) return host;
  std::int64_t modified = Modified(hostFolder);
  if (modified < 0) {
    // The folder known under this path is gone; another may stand in its place.
    const auto known = folders_.find(folder);
    if (known == folders_.end()) return host;
    folders_.erase(known);
    hostFolder = ResolveFolder(folder);
    host = Join(hostFolder, name);
    if (io_.Status(host).exists) return host;
    modified = Modified(hostFolder);
  }
  if (const std::string* entry = FindEntry(hostFolder, name, making, modified))
    return Join(hostFolder, *entry);
  return host;
}

std::string Files::DosPath(std::string_view hostPath) const {
  std::string out(hostPath);
  const std::string drive = home_ + "/drive_c/";
  if (out.rfind(drive, 0) == 0) {
    out = "c:\\" + out.substr(drive.size());
  } else {
    out = "Z:" + (out.empty() || out[0] != '/' ? "/" + out : out);
  }
  std::replace(out.begin(), out.end(), '/', '\\');
  return out;
}

bool Files::CheckFile(std::string_view path) const {
  try {
    return io_.Status(HostPath(path)).exists;
  } catch (const RunTimeError& e) {
    if (e.number() != kBadFileName) throw;
    return false;  // what is no path does not exist
  }
}

bool Files::IsFolder(std::string_view path) const {
  try {
    return io_.Status(HostPath(path)).folder;
  } catch (const RunTimeError& e) {
    if (e.number() != kBadFileName) throw;
    return false;
  }
}

// Nothing where the name has to be looked for.
std::unique_ptr<HostFile> Files::OpenInKnown(Known& known, std::string_view name,
                                             OpenMode mode) const {
  if (name.find('\0') != std::string_view::npos) throw RunTimeError(kBadFileName);
  std::string host = Join(known.host, name);
  if (known.otherCase) {
    // Where one file is in another case the next one is too: the listing is asked first. It
    // can't be wrong about the exact name, which would win, when it is sure.
    const Folder* folder = FolderFor(known.host, Modified(known.host));
    if (folder && folder->sure && !folder->twins) {
      const auto it = folder->entries.find(LCase(name));
      if (it != folder->entries.end())
        host.replace(host.size() - name.size(), name.size(), it->second);
    }
    known.otherCase = !host.ends_with(name);
  }
  try {
    return io_.Open(host, mode);
  } catch (const RunTimeError& e) {
    if (e.number() != kFileNotFound && e.number() != kPathNotFound) throw;
    return nullptr;
  }
}

std::unique_ptr<HostFile> Files::Open(std::string_view path, OpenMode mode) const {
  const auto [folder, name] = SplitName(path);
  if (name.empty()) throw RunTimeError(kBadFileName);
  if (mode == OpenMode::kRead || mode == OpenMode::kReadWrite) {
    if (const auto known = folders_.find(folder); known != folders_.end()) {
      if (auto file = OpenInKnown(known->second, name, mode)) return file;
    }
    const std::string host = Locate(path, false);
    auto file = io_.Open(host, mode);
    if (const auto known = folders_.find(folder); known != folders_.end())
      known->second.otherCase = !host.ends_with(name);
    return file;
  }
  const std::string host = Locate(path, true);
  const std::int64_t before = Modified(HostFolderOf(host));
  auto file = io_.Open(host, mode);
  Note(host, true, before);
  return file;
}

std::vector<std::string> Files::List(std::string_view folder) const {
  std::vector<std::string> names = io_.List(HostPath(folder));
  std::sort(names.begin(), names.end(), [](const std::string& a, const std::string& b) {
    const std::string x = LCase(a), y = LCase(b);
    return x != y ? x < y : a < b;
  });
  return names;
}

void Files::MakeFolder(std::string_view path) const {
  const std::string host = Locate(path, true);
  for (size_t i = 1; i <= host.size(); ++i) {
    if (i < host.size() && host[i] != '/') continue;
    const std::string part = host.substr(0, i);
    const HostStatus status = io_.Status(part);
    if (status.exists && !status.folder) throw RunTimeError(kPathAccess);
    if (status.exists) continue;
    const std::int64_t before = Modified(HostFolderOf(part));
    io_.MakeFolder(part);
    Note(part, true, before);
  }
}

void Files::Remove(std::string_view path) const {
  const std::string host = HostPath(path);
  if (io_.Status(host).readOnly)
    throw RunTimeError(kPathAccess, std::string(FileNameOf(path)) + " is read-only");
  const std::int64_t before = Modified(HostFolderOf(host));
  io_.Remove(host);
  Note(host, false, before);
}

std::pair<std::string, std::string> Files::RenamePaths(std::string_view from,
                                                       std::string_view to) const {
  std::string hostFrom = HostPath(from);
  std::string hostTo = Locate(to, true);
  const std::string_view name = SplitName(to).second;
  if (hostTo == hostFrom && !name.empty() && name != "." && name != "..")
    hostTo = Join(HostFolderOf(hostTo), name);
  return {std::move(hostFrom), std::move(hostTo)};
}

void Files::Rename(std::string_view from, std::string_view to) const {
  const auto [hostFrom, hostTo] = RenamePaths(from, to);
  const std::string folderFrom = HostFolderOf(hostFrom), folderTo = HostFolderOf(hostTo);
  const std::int64_t beforeFrom = Modified(folderFrom), beforeTo = Modified(folderTo);
  io_.Rename(hostFrom, hostTo);
  if (io_.Status(hostTo).folder) {
    folders_.clear();
    listings_.clear();
    return;
  }
  Note(hostFrom, false, beforeFrom);
  Note(hostTo, true, folderFrom == folderTo ? Modified(folderTo) : beforeTo);
}

std::string Files::ReadAll(std::string_view path, std::uint64_t limit) const {
  const auto file = Open(path, OpenMode::kRead);
  const std::uint64_t size = file->Size();
  if (size > limit) throw RunTimeError(kOutOfMemory);
  std::string bytes(size_t(size), '\0');
  const size_t got = file->ReadAt(0, bytes.data(), bytes.size());
  bytes.resize(got);
  return bytes;
}

void Files::WriteAll(std::string_view path, std::string_view bytes) const {
  FileSet set(*this);
  set.Add(path, std::string(bytes));
  set.Commit();
}

FileStamp Files::Stamp(std::string_view path) const {
  const HostStatus status = io_.Status(HostPath(path));
  if (!status.exists) return {};
  return {status.id, status.size, status.modified};
}

std::string_view FileNameOf(std::string_view path) { return path.substr(path.rfind('\\') + 1); }

std::string WithBackslash(std::string_view folder) {
  std::string out(folder);
  if (!out.empty() && !IsSeparator(out.back())) out += '\\';
  return out;
}

bool IsFileCode(std::string_view code) {
  code = Trim(code);
  if (code.empty() || code.size() > 6) return false;
  if (code.back() == '.' || code.front() == '.') return false;
  for (const char c : code) {
    const auto u = static_cast<unsigned char>(c);
    if (u < 0x21 || u == 0x7F || u >= 0x80) return false;
    switch (c) {
      case '\\':
      case '/':
      case ':':
      case '*':
      case '?':
      case '"':
      case '<':
      case '>':
      case '|':
      case ',':
      case ';':
      case '=': return false;
      default: break;
    }
  }
  const std::string_view stem = code.substr(0, code.find('.'));
  for (const std::string_view device : {"CON", "PRN", "AUX", "NUL", "CONIN$", "CLOCK$"})
    if (EqualNoCase(stem, device)) return false;
  const std::string_view port = stem.substr(0, 3);
  if (stem.size() == 4 && stem[3] >= '1' && stem[3] <= '9' &&
      (EqualNoCase(port, "COM") || EqualNoCase(port, "LPT")))
    return false;
  return true;
}

std::string KeptCode(std::string code) {
  if (code == "PRN") return "PRNX";
  if (code == "AUX") return "1AUX";
  return code;
}

std::string CodeFileName(std::string_view code, std::string_view extension) {
  if (!IsFileCode(code)) throw RunTimeError(kBadFileName);
  return std::string(Trim(code)) + std::string(extension);
}

bool LineReader::Next(std::string_view& line) {
  if (rest_.empty()) return false;
  const size_t end = rest_.find('\n');
  line = rest_.substr(0, end);
  rest_.remove_prefix(end == std::string_view::npos ? rest_.size() : end + 1);
  if (!line.empty() && line.back() == '\r') line.remove_suffix(1);
  ++number_;
  return true;
}

}  // namespace kora
