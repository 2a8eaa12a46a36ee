#pragma once

#include <cstddef>
#include <cstdint>
#include <stdexcept>
#include <string>
#include <vector>

#include "values/recycled_memory.h"
#include "values/value.h"

namespace vesk {

/// The values of a repeated scalar field, one after another and unboxed, in the order in which they arrived.
template <class Number>
class RepeatedScalar {
 public:
  [[nodiscard]] std::size_t count() const { return values_.size(); }
  /// The first of count() values; may be null when there are none.
  [[nodiscard]] const Number* values() const { return values_.data(); }
  /// Throws std::out_of_range, "idx (3) is out of range (2)", for an index that is not below count().
  [[nodiscard]] Number at(std::size_t index) const {
    if (index >= count()) {
      throw std::out_of_range("idx (" + std::to_string(index) + ") is out of range (" + std::to_string(count()) + ")");
    }
    return values_[index];
  }

  void add(Number value) {
    if (values_.capacity() == 0) values_.reserve(kLeastCapacity);
    values_.push_back(value);
  }
  /// Takes the values out and gives their storage back.
  void clear() { Values().swap(values_); }
  /// Replaces the values by a copy of `count` others, which may be some of those held.
  void set(const Number* values, std::size_t count) { values_ = Values(values, values + count); }
  void append(const RepeatedScalar& other) {
    const std::size_t added = other.count();
    for (std::size_t index = 0; index < added; ++index)
      add(other.values_[index]);
  }

  [[nodiscard]] bool isEqual(const RepeatedScalar& other) const { return values_ == other.values_; }
  [[nodiscard]] std::uint64_t hash() const {
    std::uint64_t result = count();
    for (const Number value : values_)
      result = (result ^ static_cast<std::uint32_t>(value)) * 0x9E3779B97F4A7C15;
    return result;
  }

  [[nodiscard]] Array toArray() const {
    Array array;
    array.reserve(count());
    for (const Number value : values_)
      array.append(value);
    return array;
  }

 private:
  using Values = std::vector<Number, RecyclingAllocator<Number>>;
  /// As much as the smallest recycled block holds.
  static constexpr std::size_t kLeastCapacity = 8;

  Values values_;
};

using RepeatedInt32 = RepeatedScalar<std::int32_t>;
using RepeatedUInt32 = RepeatedScalar<std::uint32_t>;

}  // namespace vesk
