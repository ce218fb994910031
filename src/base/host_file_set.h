#pragma once

#include <functional>
#include <memory>
#include <span>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "base/io.h"

namespace kora {

struct CopiedFile {
  std::uint64_t bytes = 0;
  std::uint64_t replaces = 0;  // bytes of the file that is to give way
};

// The one way in which files are replaced: several files by host paths, changed together or not
// at all.
//
// New bytes go to a temporary file of a fresh name beside the file, are flushed, and are put in
// place by renaming; the new file has permissions, owner and group of the old one. Where the
// path is a link the file that it leads to is replaced, and the link stays. A temporary file is
// always a new one. What stands under its name, a link too, is left alone, unless a crash left it:
// a living writer holds a lock on the temporary file of a set of one until it is in place, and the
// home's lock while it makes several.
//
// Commit writes all new bytes first, so that a full disk shows while every file is as it was,
// and then changes the names, in the order in which the changes were added, and flushes their
// folders. A process that dies meanwhile leaves each file old or new, never half-written. With
// `journal`, a path for a file that no other set has at a time, it leaves all of them old or all
// new: a set of several changes is written down there before the first name changes, and
// FinishSet goes on with it; each file is moved or removed once at most in such a set. Without
// one, those added first are the first to be new.
//
// A failure of any kind, of memory too, brings back what was there, removes the temporary files,
// empties the set and is raised again.
//
// A file that is to be replaced or removed and is read-only, or is no plain file, is error 75,
// with its name in the text. Other errors are those of Io.
class HostFileSet {
 public:
  explicit HostFileSet(Io& io, std::string journal = {}) : io_(io), journal_(std::move(journal)) {}
  ~HostFileSet();
  HostFileSet(const HostFileSet&) = delete;
  HostFileSet& operator=(const HostFileSet&) = delete;

  // Each only notes what is to be done; nothing is changed yet. Error 75 as above.
  void Write(std::string path, std::string bytes);
  // The bytes of another file that is open for reading: they are copied to the temporary file at once, unflushed, so that
  // thousands of large files take no memory. A failure leaves what the set has so far. Called under
  // the home's lock.
  CopiedFile Copy(HostFile& source, std::string path);
  // The same with bytes that the program has, in pieces that follow one another.
  CopiedFile WriteNow(std::string path, std::span<const std::string_view> pieces);
  void Remove(std::string path);                  // nothing where it is not there by then
  void Rename(std::string from, std::string to);  // replaces `to`

  // Writes the bytes noted so far to their temporary files, frees their memory, and returns once
  // they and the copies are on the disk. Commit does it for those that are left.
  void Stage();
  void Commit();

  size_t size() const { return steps_.size(); }  // changes noted

 private:
  enum class Kind { kWrite, kRemove, kRename };
  struct Step {
    Kind kind;
    std::string path;  // written, removed, or renamed from
    std::string to;    // renamed to
    std::string bytes;
    std::string temporary;                  // of kWrite
    std::unique_ptr<HostFile> making = {};  // the temporary file of a set of one, locked
    std::string aside;                      // where the file that gives way is kept meanwhile
    bool staged = false;                    // the temporary file is there
    bool flushed = true;                    // ... and on the disk
    bool kept = false;                      // the file that gave way is at `aside`
    bool done = false;
  };

  // `write` returns how many bytes it wrote.
  CopiedFile Fill(std::string path, const std::function<std::uint64_t(HostFile&)>& write);
  // Returns what is to give way.
  HostStatus AddWrite(std::string path, std::string bytes);
  void OpenStaged(Step& step, const HostStatus& old);
  void StageOne(Step& step, bool flush);
  void Perform(Step& step);
  void KeepAside(Step& step, const std::string& path);
  void FlushFolders();
  void Undo() noexcept;
  void Clear() noexcept;

  void WriteJournal();
  // False where the journal can't be taken away: the set is then finished by the next writer.
  bool RemoveJournal() noexcept;

  Io& io_;
  std::string journal_;
  bool written_ = false;  // the journal is there
  std::vector<Step> steps_;
};

// Where the sets of a home are written down.
std::string SetJournalOf(const std::string& home);

// Goes on with the set that a process that died wrote down in `journal`, and takes the journal
// away. Nothing where there is none. A journal that was cut short belongs to a set that had not
// begun to change names. Errors of Io: the journal stays.
void FinishSet(Io& io, const std::string& journal);

}  // namespace kora
