#include "values/recycled_memory.h"

namespace vesk {

namespace {

enum class Keeping : std::uint8_t { notYet, now, noMore };
constinit thread_local Keeping keeping = Keeping::notYet;

}  // namespace

/// Opens the thread's cache and, at the thread's end, gives back what is in it.
struct RecycledMemory::Keeper {
  Keeper() {
    keeping = Keeping::now;
    for (Blocks& blocks : cache_)
      blocks.room = kMost;
  }
  ~Keeper() {
    keeping = Keeping::noMore;
    for (Blocks& blocks : cache_) {
      blocks.room = 0;
      while (blocks.count > 0)
        ::operator delete(blocks.blocks[--blocks.count]);
    }
  }
  Keeper(const Keeper&) = delete;
  Keeper& operator=(const Keeper&) = delete;
};

void RecycledMemory::releaseBeyondRoom(void* memory, std::size_t kind) noexcept {
  if (keeping == Keeping::notYet) {
    static thread_local const Keeper keeper;
    Blocks& blocks = cache_[kind];
    blocks.blocks[blocks.count++] = memory;
    return;
  }
  ::operator delete(memory);
}

}  // namespace vesk
