#pragma once

#include <cmath>
#include <compare>
#include <cstdint>
#include <limits>
#include <optional>

namespace vesk {

/// A number that may be absent, like std::optional of it, which it may be made of and made into. It takes no more room
/// than the number and is copied in one piece; to read a std::optional whole just after its two parts were written
/// stalls the processor. The least std::int64_t and a NaN stand for absent: it is not for numbers from outside that may
/// be these. To be compared with its like only, not with a std::optional.
template <class Number>
class OptionalNumber {
 public:
  constexpr OptionalNumber() = default;
  constexpr OptionalNumber(std::nullopt_t /*absent*/) {}
  constexpr OptionalNumber(Number number) : number_(number) {}
  constexpr OptionalNumber(const std::optional<Number>& other) : number_(other ? *other : kAbsent) {}

  constexpr operator std::optional<Number>() const { return has_value() ? std::optional(number_) : std::nullopt; }

  // NOLINTBEGIN(readability-identifier-naming): named as they are in std::optional
  [[nodiscard]] constexpr bool has_value() const {
    if constexpr (std::numeric_limits<Number>::has_quiet_NaN) return !std::isnan(number_);
    return number_ != kAbsent;
  }
  [[nodiscard]] constexpr Number value_or(Number other) const { return has_value() ? number_ : other; }
  // NOLINTEND(readability-identifier-naming)
  constexpr explicit operator bool() const { return has_value(); }
  /// To be asked for when there is one.
  constexpr const Number& operator*() const { return number_; }
  constexpr void reset() { number_ = kAbsent; }

  friend constexpr bool operator==(const OptionalNumber& one, const OptionalNumber& other) {
    return one.number_ == other.number_ || (!one && !other);
  }
  /// An absent one comes before every number.
  friend constexpr auto operator<=>(const OptionalNumber& one, const OptionalNumber& other)
      -> std::compare_three_way_result_t<Number> {
    if (one && other) return one.number_ <=> other.number_;
    return one.has_value() <=> other.has_value();
  }

 private:
  static constexpr Number kAbsent = std::numeric_limits<Number>::has_quiet_NaN
                                        ? std::numeric_limits<Number>::quiet_NaN()
                                        : std::numeric_limits<Number>::min();

  Number number_ = kAbsent;
};

}  // namespace vesk
