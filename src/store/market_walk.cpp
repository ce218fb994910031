#include "store/market_walk.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <condition_variable>
#include <exception>
#include <mutex>
#include <optional>
#include <system_error>
#include <thread>
#include <vector>

#include "base/numbers.h"
#include "base/record_file.h"
#include "base/runtime_error.h"
#include "base/text.h"
#include "store/name_file.h"

namespace kora {
namespace {

// Securities that are read in one go, and such blocks in hand: enough that the two threads rarely
// wait for one another, few enough that the records stay in the cache.
constexpr std::int32_t kMostItems = 32;
constexpr std::int32_t kRecordsPerBlock = 10000;
constexpr size_t kBlocks = 4;
// Of files that are read whole: those in hand are to stay in the cache, however long they are.
constexpr size_t kWholeFilesPerBlock = 1;
constexpr std::int32_t kNamesPerRead = 512;
constexpr std::uint64_t kMostRecords = 32767;

bool IsSound(std::span<const PriceRec> records) {
  bool prices = false;
  for (const PriceRec& rec : records) {
    const float sum =
        std::fabs(rec.Open) + std::fabs(rec.High) + std::fabs(rec.Low) + std::fabs(rec.Close);
    // A sum beyond all floats needs a closer look: it may be one of numbers.
    if (!std::isfinite(sum) && !(std::isfinite(rec.Open) && std::isfinite(rec.High) &&
                                 std::isfinite(rec.Low) && std::isfinite(rec.Close)))
      return false;
    prices |= sum != 0;
  }
  return prices;
}

// Room for the records is kept from one use of a block to the next.
struct Item {
  std::int32_t number = 0;
  NameRec name{};
  std::int32_t count = 0;
  size_t at = 0, size = 0;                     // its records in the block
  std::int32_t UnreadFiles::*fault = nullptr;  // passed over
};

struct Block {
  std::vector<Item> items;
  std::vector<PriceRec> records;
  size_t filled = 0;  // of records
};

// Reads the records of one security; the fault where it is to be passed over.
void ReadItem(const Files& files, const std::string& dataPath, const WalkPlan& plan, Block& block,
              Item& item) {
  const std::string_view code = Trim(item.name.Code.trimmed());
  if (!IsFileCode(code)) {
    item.fault = &UnreadFiles::missing;
    return;
  }
  try {
    const auto file = files.Open(dataPath + CodeFileName(code, ".WDT"), OpenMode::kRead);
    const std::uint64_t bytes = file->Size();
    const std::uint64_t count = bytes / sizeof(PriceRec);
    if (bytes % sizeof(PriceRec) != 0)
      item.fault = &UnreadFiles::torn;
    else if (count < std::uint64_t(std::max(plan.fewest, 0)))
      item.fault = &UnreadFiles::tooShort;
    else if (count > kMostRecords)
      item.fault = &UnreadFiles::refused;
    if (item.fault) return;

    item.count = std::int32_t(count);
    item.at = block.filled;
    item.size = size_t(std::min(item.count, plan.records));
    block.filled += item.size;
    if (block.records.size() < block.filled) block.records.resize(block.filled);
    const std::span<PriceRec> room(block.records.data() + item.at, item.size);
    if (file->ReadAt((count - item.size) * sizeof(PriceRec), room.data(), room.size_bytes()) !=
        room.size_bytes())
      item.fault = &UnreadFiles::torn;  // cut since it was measured
    else if (plan.soundPrices && !IsSound(room))
      item.fault = &UnreadFiles::unsound;
  } catch (const RunTimeError& e) {
    const bool missing = e.number() == kFileNotFound || e.number() == kPathNotFound;
    item.fault = missing ? &UnreadFiles::missing : &UnreadFiles::refused;
  }
}

void ReadBlock(const Files& files, const std::string& dataPath, const WalkPlan& plan,
               Block& block) {
  block.filled = 0;
  if (plan.records == 0) return;
  for (Item& item : block.items) ReadItem(files, dataPath, plan, block, item);
}

// Reads the blocks that it is given, in turn, on a thread of its own.
class AheadReader {
 public:
  // Error of the system where there can be no further thread.
  AheadReader(const Files& files, const std::string& dataPath, const WalkPlan& plan)
      : files_(files.home(), files.io()), dataPath_(dataPath), plan_(plan) {
    thread_ = std::thread([this] { Work(); });
  }
  ~AheadReader() {
    {
      const std::lock_guard lock(mutex_);
      over_ = true;
    }
    changed_.notify_all();
    thread_.join();
  }
  AheadReader(const AheadReader&) = delete;
  AheadReader& operator=(const AheadReader&) = delete;

  // The block is the reader's until Wait has returned for it. At most kBlocks are given ahead.
  void Give(Block& block) {
    {
      const std::lock_guard lock(mutex_);
      blocks_[given_++ % kBlocks] = &block;
    }
    changed_.notify_all();
  }
  // Until the block given first of those not waited for is read.
  void Wait() {
    std::unique_lock lock(mutex_);
    changed_.wait(lock, [this] { return read_ > taken_ || error_; });
    if (read_ == taken_) std::rethrow_exception(error_);
    ++taken_;
  }

 private:
  void Work() {
    std::unique_lock lock(mutex_);
    for (;;) {
      changed_.wait(lock, [this] { return over_ || given_ > read_; });
      if (over_) return;
      Block& block = *blocks_[read_ % kBlocks];
      lock.unlock();
      std::exception_ptr error;
      try {
        ReadBlock(files_, dataPath_, plan_, block);
      } catch (...) {
        error = std::current_exception();
      }
      lock.lock();
      if (error) {
        error_ = error;
        changed_.notify_all();
        return;
      }
      ++read_;
      changed_.notify_all();
    }
  }

  const Files files_;
  const std::string dataPath_;
  const WalkPlan plan_;
  std::mutex mutex_;
  std::condition_variable changed_;
  std::array<Block*, kBlocks> blocks_{};
  size_t given_ = 0, read_ = 0, taken_ = 0;
  bool over_ = false;
  std::exception_ptr error_;
  std::thread thread_;
};

std::unique_ptr<AheadReader> StartReader(const Files& files, const std::string& dataPath,
                                         const WalkPlan& plan) {
  if (!plan.ahead || plan.records == 0 || !files.io().AnyThread()) return nullptr;
  if (std::thread::hardware_concurrency() == 1) return nullptr;
  try {
    return std::make_unique<AheadReader>(files, dataPath, plan);
  } catch (const std::system_error&) {
    return nullptr;
  }
}

size_t ItemsPerBlock(const WalkPlan& plan) {
  if (!plan.ahead) return 1;
  if (plan.records == kWholeFile) return kWholeFilesPerBlock;
  return size_t(std::clamp(kRecordsPerBlock / std::max(plan.records, 1), 1, kMostItems));
}

}  // namespace

std::string UnreadText(const UnreadFiles& unread) {
  const std::int32_t n = unread.total();
  if (n == 0) return "";
  return Str(n) + (n == 1 ? " file could not be read" : " files could not be read");
}

// The name file in runs, from its first record on.
class MarketWalk::Names {
 public:
  explicit Names(NameFile file) : file_(std::move(file)) {}

  std::int32_t count() const { return file_.count(); }
  void Begin() { next_ = 1; }
  // Takes the securities that are wanted next into `items`, up to `most`.
  void Fill(const Wants& wants, size_t most, std::vector<Item>& items) {
    items.clear();
    while (items.size() < most && next_ <= count()) {
      const std::int32_t place = (next_ - 1) % kNamesPerRead;
      if (place == 0) {
        run_.resize(size_t(std::min(kNamesPerRead, count() - next_ + 1)));
        file_.ReadRun(next_, run_);
      }
      const NameRec& name = run_[size_t(place)];
      if (!wants || wants(name)) {
        Item item;
        item.number = next_;
        item.name = name;
        items.push_back(item);
      }
      ++next_;
    }
  }

 private:
  NameFile file_;
  std::vector<NameRec> run_;
  std::int32_t next_ = 1;
};

MarketWalk::MarketWalk(const Files& files, std::string dataPath)
    : files_(files), dataPath_(std::move(dataPath)) {
  try {
    names_ = std::make_unique<Names>(NameFile(files_, NameFilePath(dataPath_)));
  } catch (const RunTimeError& e) {
    if (e.number() != kFileNotFound) throw;
  }
}

MarketWalk::~MarketWalk() = default;

std::int32_t MarketWalk::count() const { return names_ ? names_->count() : 0; }

bool MarketWalk::Run(const WalkPlan& plan, Progress& progress, const Wants& wants,
                     const Visit& visit) {
  unread_ = {};
  const std::int32_t total = count();
  const size_t most = ItemsPerBlock(plan);
  std::array<Block, kBlocks> blocks;
  if (names_) names_->Begin();
  const auto fill = [&](Block& block) {
    if (names_) names_->Fill(wants, most, block.items);
  };

  // One block needs no second thread, and one that is read right before its visits no others.
  fill(blocks[0]);
  std::unique_ptr<AheadReader> reader;
  size_t inHand = 1;
  if (blocks[0].items.size() == most && (reader = StartReader(files_, dataPath_, plan))) {
    reader->Give(blocks[0]);
    for (; inHand < kBlocks; ++inHand) {
      fill(blocks[inHand]);
      reader->Give(blocks[inHand]);
    }
  }

  for (size_t turn = 0;; turn = (turn + 1) % inHand) {
    Block& block = blocks[turn];
    if (block.items.empty()) break;
    if (reader)
      reader->Wait();
    else
      ReadBlock(files_, dataPath_, plan, block);
    for (const Item& item : block.items) {
      const std::string_view code = Trim(item.name.Code.trimmed());
      progress.Show(ProgressLine::kItem, Str(item.number) + " " + std::string(code));
      if (!progress.Step(item.number, total)) return false;
      if (item.fault) {
        ++(unread_.*item.fault);
        continue;
      }
      visit({item.number, item.name, code, item.count,
             std::span<const PriceRec>(block.records.data() + item.at, item.size)});
    }
    fill(block);
    if (reader) reader->Give(block);
  }
  progress.Step(total, total);
  return true;
}

}  // namespace kora
