#include "platform/recycled_memory.h"

#include <utility>

namespace vesk {

/// Opens the lists of its thread, and empties and closes them when the thread ends.
struct RecycledMemory::Keeper {
  Keeper() {
    for (FreeList& list : lists_)
      list.room = kIsSanitized ? 0 : kMostKept;
  }
  ~Keeper() {
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
  // The first release of a thread comes here too, and opens its lists.
  static thread_local const Keeper keeper;
  ::operator delete(memory);
}

}  // namespace vesk
