#pragma once

#include <algorithm>
#include <atomic>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <utility>

#include "values/recycled_memory.h"

namespace vesk {

/// A growable sequence with the price of a pointer, copied on write: copies share one block, and the first
/// change through a copy gives that copy a block of its own. Copies may be used from several
/// threads, one object may not.
template <class T>
class SharedVector {
 public:
  SharedVector() = default;
  SharedVector(const SharedVector& other) noexcept : block_(other.block_) {
    if (block_ != nullptr) block_->owners.fetch_add(1, std::memory_order_relaxed);
  }
  SharedVector(SharedVector&& other) noexcept : block_(std::exchange(other.block_, nullptr)) {}
  SharedVector& operator=(SharedVector other) noexcept {
    std::swap(block_, other.block_);
    return *this;
  }
  ~SharedVector() { release(); }

  [[nodiscard]] std::size_t size() const { return block_ == nullptr ? 0 : block_->size; }
  [[nodiscard]] const T* begin() const { return block_ == nullptr ? nullptr : block_->items(); }
  [[nodiscard]] const T* end() const { return begin() + size(); }
  [[nodiscard]] const T& operator[](std::size_t index) const { return block_->items()[index]; }

  /// The items for changing; those of copies stay as they are.
  [[nodiscard]] std::span<T> mutableItems() {
    if (block_ == nullptr) return {};
    if (!isOnlyOwner()) reallocate(block_->size);
    return {block_->items(), block_->size};
  }

  /// Makes room for `capacity` items in all.
  void reserve(std::size_t capacity) {
    if (capacity <= size()) return;
    if (block_ == nullptr || !isOnlyOwner() || capacity > block_->capacity) {
      reallocate(capacity);
    }
  }

  T& append(T item) { return emplace(std::move(item)); }

  /// Adds an item at the end, made of `parts`.
  template <class... Parts>
  T& emplace(Parts&&... parts) {
    const std::size_t count = size();
    if (block_ == nullptr || count == block_->capacity || !isOnlyOwner()) [[unlikely]] {
      return *emplaceInNewBlock(std::forward<Parts>(parts)...);
    }
    return *place(count, std::forward<Parts>(parts)...);
  }

  /// Takes the item out; the order of the others stays.
  void erase(std::size_t index) {
    const std::span<T> items = mutableItems();
    std::move(items.begin() + static_cast<std::ptrdiff_t>(index) + 1, items.end(),
              items.begin() + static_cast<std::ptrdiff_t>(index));
    std::destroy_at(&items.back());
    --block_->size;
  }

  void clear() {
    release();
    block_ = nullptr;
  }

  friend bool operator==(const SharedVector& a, const SharedVector& b) {
    return a.block_ == b.block_ || std::equal(a.begin(), a.end(), b.begin(), b.end());
  }

 private:
  static constexpr std::size_t kLeastCapacity = 4;

  struct Block {
    std::atomic<std::uint32_t> owners{1};
    std::size_t size = 0;
    std::size_t capacity;

    explicit Block(std::size_t room) : capacity(room) {}
    static constexpr std::size_t itemsOffset() { return (sizeof(Block) + alignof(T) - 1) / alignof(T) * alignof(T); }
    static constexpr std::size_t bytesFor(std::size_t capacity) { return itemsOffset() + capacity * sizeof(T); }
    T* items() { return reinterpret_cast<T*>(reinterpret_cast<std::byte*>(this) + itemsOffset()); }
  };

  [[nodiscard]] bool isOnlyOwner() const { return block_->owners.load(std::memory_order_acquire) == 1; }

  template <class... Parts>
  T* place(std::size_t index, Parts&&... parts) {
    T* item = new (block_->items() + index) T{std::forward<Parts>(parts)...};
    ++block_->size;
    return item;
  }

  /// Not a part of emplace(): with an item on its stack, every call of that would set up and check a stack guard, 3 %
  /// of the instructions of `vesk stores`.
  template <class... Parts>
  [[gnu::noinline]] T* emplaceInNewBlock(Parts&&... parts) {
    const std::size_t count = size();
    // Made first: the parts may be of this very sequence.
    T item{std::forward<Parts>(parts)...};
    reallocate(std::max<std::size_t>({kLeastCapacity, count + 1, count * 2}));
    return place(count, std::move(item));
  }

  void reallocate(std::size_t capacity) {
    void* storage = RecycledMemory::allocate(Block::bytesFor(capacity));
    auto* block = new (storage) Block(capacity);
    if (block_ != nullptr) {
      if (isOnlyOwner()) {
        std::uninitialized_move_n(block_->items(), block_->size, block->items());
      } else {
        std::uninitialized_copy_n(block_->items(), block_->size, block->items());
      }
      block->size = block_->size;
      release();
    }
    block_ = block;
  }

  void release() noexcept {
    if (block_ == nullptr) return;
    // The only owner need not pay for a locked decrement, which takes 1.5 % of the time of `vesk decode` and `vesk
    // stores`: nobody else can take a count any more.
    if (isOnlyOwner() || block_->owners.fetch_sub(1, std::memory_order_acq_rel) == 1) {
      std::destroy_n(block_->items(), block_->size);
      const std::size_t capacity = block_->capacity;
      block_->~Block();
      RecycledMemory::release(block_, Block::bytesFor(capacity));
    }
  }

  Block* block_ = nullptr;
};

}  // namespace vesk
