#include "values/recycled_memory.h"

#include <algorithm>
#include <mutex>
#include <span>

namespace vesk {

namespace {

/// Blocks of one kind that no thread has.
class Depot {
 public:
  /// Fills `lot`; false, and nothing done, when there are too few.
  bool take(std::span<void*> lot) {
    const std::lock_guard lock(mutex_);
    if (count_ < lot.size()) return false;
    count_ -= lot.size();
    std::copy_n(&blocks_[count_], lot.size(), lot.begin());
    return true;
  }

  /// Keeps `lot`; false, and nothing done, when there would be more than `most`.
  bool put(std::span<void* const> lot, std::size_t most) {
    const std::lock_guard lock(mutex_);
    if (count_ + lot.size() > std::min(most, blocks_.size())) return false;
    std::copy(lot.begin(), lot.end(), &blocks_[count_]);
    count_ += lot.size();
    return true;
  }

 private:
  std::mutex mutex_;
  std::size_t count_ = 0;
  std::array<void*, 1024> blocks_{};
};

/// Of one kind, in one depot.
constexpr std::size_t kMostBytes = 1 << 16;

enum class Keeping : std::uint8_t { notYet, now, noMore };
constinit thread_local Keeping keeping = Keeping::notYet;

}  // namespace

struct RecycledMemory::Keeper {
  Keeper() {
    keeping = Keeping::now;
    for (Stock& stock : stocks_)
      stock.room = static_cast<std::uint32_t>(stock.blocks.size());
  }
  ~Keeper() {
    keeping = Keeping::noMore;
    for (Stock& stock : stocks_) {
      stock.room = 0;
      while (stock.count > 0)
        ::operator delete(stock.blocks[--stock.count]);
    }
  }
  Keeper(const Keeper&) = delete;
  Keeper& operator=(const Keeper&) = delete;

  static constinit std::array<Depot, kKinds> depots;
};

constinit std::array<Depot, RecycledMemory::kKinds> RecycledMemory::Keeper::depots{};

bool RecycledMemory::isOpen() {
  if (keeping == Keeping::notYet) {
    static thread_local const Keeper keeper;
  }
  return keeping == Keeping::now;
}

void* RecycledMemory::allocateFromOutside(std::size_t kind) {
  Stock& stock = stocks_[kind];
  if (isOpen() && Keeper::depots[kind].take(std::span(stock.blocks).first(kLot))) {
    stock.count = kLot - 1;
    return stock.blocks[stock.count];
  }
  return ::operator new((kind + 1) * kStep);
}

void RecycledMemory::releaseToOutside(void* memory, std::size_t kind) noexcept {
  Stock& stock = stocks_[kind];
  const std::size_t most = kMostBytes / ((kind + 1) * kStep);
  if (isOpen() && stock.count == stock.room && Keeper::depots[kind].put(std::span(stock.blocks).first(kLot), most)) {
    std::copy(stock.blocks.begin() + kLot, stock.blocks.end(), stock.blocks.begin());
    stock.count -= kLot;
  }
  if (stock.count == stock.room) return ::operator delete(memory);
  stock.blocks[stock.count++] = memory;
}

}  // namespace vesk
