#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <new>

namespace vesk {

#if defined(__SANITIZE_ADDRESS__) || defined(__SANITIZE_THREAD__)
inline constexpr bool kIsSanitized = true;
#elif defined(__has_feature)
inline constexpr bool kIsSanitized =
    __has_feature(address_sanitizer) || __has_feature(memory_sanitizer) || __has_feature(thread_sanitizer);
#else
inline constexpr bool kIsSanitized = false;
#endif

/// Memory for the many small objects that an event is made of and that live no longer than it does: what a thread gives
/// back is kept, within bounds, for its next request of about that size. An event is made by one thread and ends on
/// another, so what one has too much of goes to those that have none, many blocks at a time. Under a sanitizer of
/// memory or threads every block comes from the heap, in the size that was asked for, so that its checks see them all.
class RecycledMemory {
 public:
  /// `size` bytes, aligned for every ordinary type; throws std::bad_alloc.
  [[nodiscard]] static void* allocate(std::size_t size) {
    const std::size_t kind = kindOf(size);
    if (kIsSanitized || kind >= kKinds) return ::operator new(size);
    Stock& stock = stocks_[kind];
    if (stock.count == 0) return allocateFromOutside(kind);
    // The next one may lie where another core has it.
    if (stock.count > 1) __builtin_prefetch(stock.blocks[stock.count - 2], 1);
    return stock.blocks[--stock.count];
  }

  /// Gives back what allocate() gave for the same size.
  static void release(void* memory, std::size_t size) noexcept {
    const std::size_t kind = kindOf(size);
    if (kIsSanitized || kind >= kKinds) return ::operator delete(memory);
    Stock& stock = stocks_[kind];
    if (stock.count == stock.room) return releaseToOutside(memory, kind);
    stock.blocks[stock.count++] = memory;
  }

 private:
  /// Blocks of one kind that are a multiple of this in size.
  static constexpr std::size_t kStep = 32;
  static constexpr std::size_t kKinds = 32;
  /// How many blocks go from one thread to another.
  static constexpr std::uint32_t kLot = 32;

  /// The blocks of one kind that a thread has.
  struct Stock {
    std::uint32_t count;
    /// None before the thread's first use and after its end.
    std::uint32_t room;
    std::array<void*, std::size_t{2} * kLot> blocks;
  };
  struct Keeper;

  static std::size_t kindOf(std::size_t size) { return (size - 1) / kStep; }
  static void* allocateFromOutside(std::size_t kind);
  static void releaseToOutside(void* memory, std::size_t kind) noexcept;
  /// Whether this thread keeps blocks.
  static bool isOpen();

  static inline constinit thread_local std::array<Stock, kKinds> stocks_{};
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
