#pragma once

#include <atomic>
#include <condition_variable>
#include <cstddef>
#include <mutex>
#include <stop_token>
#include <utility>
#include <vector>

namespace vesk {

/// Items on their way from any thread to the one that takes them, all at once, in the order they came. It has
/// no bound of its own: a source that may be faster than the taker waits for room before it adds.
template <class Item>
class Backlog {
 public:
  /// Adds `item` behind the others. True when it is the first, so that the taker has to be woken.
  [[nodiscard]] bool add(Item item) {
    const std::lock_guard lock(mutex_);
    items_.push_back(std::move(item));
    count_.store(items_.size(), std::memory_order_release);
    return items_.size() == 1;
  }

  /// Puts all items into `taken`, which must be empty and whose storage serves the next ones.
  void take(std::vector<Item>& taken) {
    const std::lock_guard lock(mutex_);
    taken.swap(items_);
    count_.store(0, std::memory_order_release);
    if (waitingSources_ > 0) taken_.notify_all();
  }

  /// Blocks the calling thread until fewer than `count` items wait. False when a stop was requested.
  [[nodiscard]] bool waitUntilFewerThan(std::size_t count, const std::stop_token& stop) {
    if (count_ >= count) {
      std::unique_lock lock(mutex_);
      ++waitingSources_;
      taken_.wait(lock, stop, [&] { return items_.size() < count; });
      --waitingSources_;
    }
    return !stop.stop_requested();
  }

  [[nodiscard]] bool isEmpty() const { return count_ == 0; }

 private:
  std::mutex mutex_;
  std::condition_variable_any taken_;
  std::size_t waitingSources_ = 0;
  std::vector<Item> items_;
  /// How many they are, to be read without the lock.
  std::atomic<std::size_t> count_ = 0;
};

}  // namespace vesk
