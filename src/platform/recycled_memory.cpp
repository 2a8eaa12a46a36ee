#include "platform/recycled_memory.h"

#include <utility>

namespace vesk {

namespace {

enum class Lists : std::uint8_t { notYetOpen, open, closed };

/// Whether the lists of this thread take blocks: they are opened by its first release and closed at its end, after
/// which blocks may still be released.
constinit thread_local Lists lists = Lists::notYetOpen;

}  // namespace

struct RecycledMemory::Keeper {
  Keeper() {
    lists = Lists::open;
    for (FreeList& list : lists_)
      list.room = kMostKept;
  }
  ~Keeper() {
    lists = Lists::closed;
    for (FreeList& list : lists_) {
      list.room = 0;
      for (Block* block = std::exchange(list.first, nullptr); block != nullptr;) {
        ::operator delete(std::exchange(block, block->next));
      }
    }
  }
  Keeper(const Keeper&) = delete;
  Keeper& operator=(const Keeper&) = delete;
};

void RecycledMemory::releaseToHeap(void* memory) noexcept {
  if (!kIsSanitized && lists == Lists::notYetOpen) {
    static thread_local const Keeper keeper;
  }
  ::operator delete(memory);
}

}  // namespace vesk
