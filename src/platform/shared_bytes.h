#pragma once

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <string_view>
#include <utility>

namespace vesk {

/// Immutable bytes counted by reference: what Text and Data are made of. Copies share the bytes and may be
/// used from several threads at once. An empty one owns nothing.
class SharedBytes {
 public:
  /// The owner of the bytes. A block of static storage is immortal: it is never counted and never freed.
  struct Block {
    static constexpr std::uint32_t kImmortal = UINT32_MAX;

    const char* bytes;
    std::uint32_t size;
    std::atomic<std::uint32_t> owners;
  };

  constexpr SharedBytes() = default;
  /// Takes over one count of `block`, or an immortal block.
  constexpr explicit SharedBytes(Block* block) : block_(block) {}
  /// A copy of `bytes`, at most 4 GiB; throws std::length_error beyond that.
  static SharedBytes copy(std::string_view bytes);

  SharedBytes(const SharedBytes& other) noexcept : block_(other.block_) {
    if (isCounted()) block_->owners.fetch_add(1, std::memory_order_relaxed);
  }
  SharedBytes(SharedBytes&& other) noexcept : block_(std::exchange(other.block_, nullptr)) {}
  SharedBytes& operator=(SharedBytes other) noexcept {
    std::swap(block_, other.block_);
    return *this;
  }
  ~SharedBytes() {
    if (isCounted()) release();
  }

  [[nodiscard]] std::string_view view() const {
    return block_ == nullptr ? std::string_view{} : std::string_view{block_->bytes, block_->size};
  }

  friend bool operator==(const SharedBytes& a, const SharedBytes& b) {
    return a.block_ == b.block_ || a.view() == b.view();
  }

 private:
  [[nodiscard]] bool isCounted() const {
    return block_ != nullptr && block_->owners.load(std::memory_order_acquire) != Block::kImmortal;
  }
  void release() noexcept;

  Block* block_ = nullptr;
};

}  // namespace vesk
