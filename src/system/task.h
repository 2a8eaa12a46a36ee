#pragma once

#include <cstddef>
#include <memory>
#include <new>
#include <type_traits>
#include <utility>

namespace vesk {

/// Something to be done once or more, moved from queue to queue. What a task captures lies within it up to
/// kRoom bytes, so that scheduling an event costs no allocation.
class Task {
 public:
  static constexpr std::size_t kRoom = 48;

  Task() = default;
  template <class Callable>
  requires(!std::is_same_v<std::remove_cvref_t<Callable>, Task> && std::is_invocable_v<Callable&>)
      // NOLINTNEXTLINE(bugprone-forwarding-reference-overload): the constraint leaves Task itself out
      Task(Callable&& callable) {
    using Held = std::remove_cvref_t<Callable>;
    if constexpr (fits<Held>()) {
      new (room_) Held(std::forward<Callable>(callable));
      operations_ = &kInside<Held>;
    } else {
      new (room_) std::unique_ptr<Held>(std::make_unique<Held>(std::forward<Callable>(callable)));
      operations_ = &kOutside<Held>;
    }
  }

  Task(Task&& other) noexcept : operations_(std::exchange(other.operations_, nullptr)) {
    if (operations_ != nullptr) operations_->move(room_, other.room_);
  }
  Task& operator=(Task&& other) noexcept {
    if (this != &other) {
      reset();
      operations_ = std::exchange(other.operations_, nullptr);
      if (operations_ != nullptr) operations_->move(room_, other.room_);
    }
    return *this;
  }
  ~Task() { reset(); }

  /// Must hold something.
  void operator()() { operations_->run(room_); }
  /// Runs it for the last time: what it holds goes before anything else runs.
  void runOnce() {
    (*this)();
    reset();
  }
  explicit operator bool() const { return operations_ != nullptr; }

 private:
  struct Operations {
    void (*run)(void* held);
    /// Leaves nothing at `from`.
    void (*move)(void* to, void* from);
    void (*destroy)(void* held);
  };

  template <class Held>
  static constexpr bool fits() {
    // NOLINTNEXTLINE(misc-redundant-expression): true of some types only
    return sizeof(Held) <= kRoom && alignof(Held) <= alignof(std::max_align_t) &&
           std::is_nothrow_move_constructible_v<Held>;
  }
  template <class Held>
  static void move(void* to, void* from) {
    auto* source = static_cast<Held*>(from);
    new (to) Held(std::move(*source));
    std::destroy_at(source);
  }
  template <class Held>
  static void destroy(void* held) {
    std::destroy_at(static_cast<Held*>(held));
  }

  template <class Held>
  static constexpr Operations kInside{[](void* held) { (*static_cast<Held*>(held))(); }, &move<Held>, &destroy<Held>};
  template <class Held>
  static constexpr Operations kOutside{[](void* held) { (**static_cast<std::unique_ptr<Held>*>(held))(); },
                                       &move<std::unique_ptr<Held>>, &destroy<std::unique_ptr<Held>>};

  void reset() noexcept {
    if (operations_ != nullptr) std::exchange(operations_, nullptr)->destroy(room_);
  }

  const Operations* operations_ = nullptr;
  alignas(std::max_align_t) std::byte room_[kRoom];
};

}  // namespace vesk
