#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <new>

namespace vesk {

#if defined(__has_feature)
#if __has_feature(address_sanitizer) || __has_feature(memory_sanitizer) || __has_feature(thread_sanitizer)
#define VESK_SANITIZED
#endif
#elif defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
#define VESK_SANITIZED
#endif

#ifdef VESK_SANITIZED
inline constexpr bool kIsSanitized = true;
#else
inline constexpr bool kIsSanitized = false;
#endif

/// A thread cache for the many small objects that an event is made of and that live no longer than it does: what a
/// thread gives back is kept, within bounds, for its next request of about that size. Under a sanitizer of memory or
/// threads every block comes from the heap, in the size that was asked for, so that its checks see them all. Without
/// the cache, `vesk decode` takes 7 % more time and `vesk stores` 13 %.
class RecycledMemory {
 public:
  /// `size` bytes, aligned for every ordinary type; throws std::bad_alloc.
  [[nodiscard]] static void* allocate(std::size_t size) {
    if constexpr (kIsSanitized) return ::operator new(size);
    const std::size_t kind = kindOf(size);
    if (kind >= kKinds) return ::operator new(size);
    Blocks& blocks = cache_[kind];
    if (blocks.count == 0) return ::operator new((kind + 1) * kStep);
    return blocks.blocks[--blocks.count];
  }

  /// Gives back what allocate() gave for the same size.
  static void release(void* memory, std::size_t size) noexcept {
    if constexpr (kIsSanitized) return ::operator delete(memory);
    const std::size_t kind = kindOf(size);
    if (kind >= kKinds) return ::operator delete(memory);
    Blocks& blocks = cache_[kind];
    if (blocks.count == blocks.room) return releaseBeyondRoom(memory, kind);
    blocks.blocks[blocks.count++] = memory;
  }

 private:
  /// Blocks of one kind that are a multiple of this in size.
  static constexpr std::size_t kStep = 32;
  static constexpr std::size_t kKinds = 32;
  /// How many blocks of one kind a thread keeps.
  static constexpr std::uint32_t kMost = 64;

  struct Blocks {
    std::uint32_t count;
    /// None before the thread's first use and after its end.
    std::uint32_t room;
    std::array<void*, kMost> blocks;
  };
  struct Keeper;

  static std::size_t kindOf(std::size_t size) { return (size - 1) / kStep; }
  static void releaseBeyondRoom(void* memory, std::size_t kind) noexcept;

  static inline constinit thread_local std::array<Blocks, kKinds> cache_{};
};

/// RecycledMemory for the standard containers and std::allocate_shared.
template <class T>
struct RecyclingAllocator {
  static_assert(alignof(T) <= alignof(std::max_align_t));
  using value_type = T;

  RecyclingAllocator() = default;
  template <class Other>
  RecyclingAllocator(const RecyclingAllocator<Other>& /*other*/) {}

  // NOLINTBEGIN(bugprone-sizeof-expression): a container may keep pointers, too
  [[nodiscard]] T* allocate(std::size_t count) {
    if (count > SIZE_MAX / sizeof(T)) throw std::bad_array_new_length();
    return static_cast<T*>(RecycledMemory::allocate(count * sizeof(T)));
  }
  void deallocate(T* memory, std::size_t count) noexcept { RecycledMemory::release(memory, count * sizeof(T)); }
  // NOLINTEND(bugprone-sizeof-expression)

  friend bool operator==(const RecyclingAllocator& /*a*/, const RecyclingAllocator& /*b*/) { return true; }
};

}  // namespace vesk
