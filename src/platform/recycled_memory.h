#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <new>

namespace vesk {

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
inline constexpr bool kIsSanitized = true;
#elif defined(__has_feature)
inline constexpr bool kIsSanitized = __has_feature(address_sanitizer) || __has_feature(thread_sanitizer);
#else
inline constexpr bool kIsSanitized = false;
#endif

/// Memory for the many small objects that an event is made of and that live no longer than it does: what a thread gives
/// back is kept, within bounds, for its next request of about that size. A block may be released by another thread than
/// the one that allocated it. Under a sanitizer of memory or threads every block comes from the heap, in the size that
/// was asked for, so that its checks see them all.
class RecycledMemory {
 public:
  /// `size` bytes, aligned for every ordinary type; throws std::bad_alloc.
  [[nodiscard]] static void* allocate(std::size_t size) {
    if constexpr (kIsSanitized) return ::operator new(size);
    const std::size_t index = listIndex(size);
    if (index < kLists) [[likely]] {
      FreeList& list = lists_[index];
      if (Block* block = list.first; block != nullptr) [[likely]] {
        list.first = block->next;
        ++list.room;
        return block;
      }
      size = (index + 1) * kStep;
    }
    return ::operator new(size);
  }

  /// Gives back what allocate() gave for the same size.
  static void release(void* memory, std::size_t size) noexcept {
    const std::size_t index = listIndex(size);
    if (index < kLists && lists_[index].room > 0) [[likely]] {
      keep(memory, lists_[index]);
    } else {
      releaseToHeap(memory);
    }
  }

 private:
  struct Block {
    Block* next;
  };
  struct FreeList {
    Block* first;
    /// How many more blocks it takes; none before its thread's first release and after the thread's end.
    std::uint32_t room;
  };
  struct Keeper;

  static constexpr std::size_t kStep = 32;
  static constexpr std::size_t kLists = 32;
  static constexpr std::uint32_t kMostKept = 64;

  static std::size_t listIndex(std::size_t size) { return (size - 1) / kStep; }
  static void keep(void* memory, FreeList& list) noexcept {
    list.first = new (memory) Block{list.first};
    --list.room;
  }
  static void releaseToHeap(void* memory) noexcept;

  static inline constinit thread_local std::array<FreeList, kLists> lists_{};
};

/// RecycledMemory for the standard containers and std::allocate_shared.
template <class T>
struct RecyclingAllocator {
  static_assert(alignof(T) <= alignof(std::max_align_t));
  using value_type = T;

  RecyclingAllocator() = default;
  template <class Other>
  RecyclingAllocator(const RecyclingAllocator<Other>& /*other*/) {}

  [[nodiscard]] T* allocate(std::size_t count) {
    if (count > SIZE_MAX / sizeof(T)) throw std::bad_array_new_length();
    return static_cast<T*>(RecycledMemory::allocate(count * sizeof(T)));
  }
  void deallocate(T* memory, std::size_t count) noexcept { RecycledMemory::release(memory, count * sizeof(T)); }

  friend bool operator==(const RecyclingAllocator& /*a*/, const RecyclingAllocator& /*b*/) { return true; }
};

}  // namespace vesk
