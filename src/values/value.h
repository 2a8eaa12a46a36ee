#pragma once

#include <concepts>
#include <cstdint>
#include <initializer_list>
#include <optional>
#include <string>
#include <string_view>
#include <type_traits>
#include <utility>
#include <variant>

#include "values/data.h"
#include "values/shared_vector.h"
#include "values/text.h"

namespace vesk {

class Value;

/// A list of values. Copies share their content until one of them changes.
class Array {
 public:
  Array() = default;
  Array(std::initializer_list<Value> values);

  [[nodiscard]] std::size_t size() const { return values_.size(); }
  [[nodiscard]] bool empty() const { return size() == 0; }
  [[nodiscard]] const Value* begin() const;
  [[nodiscard]] const Value* end() const;
  /// `index` must be below size().
  [[nodiscard]] const Value& operator[](std::size_t index) const;

  void reserve(std::size_t capacity);
  /// Adds a value, or whatever makes one.
  template <class Held>
  void append(Held&& value);

  friend bool operator==(const Array& a, const Array& b);

 private:
  SharedVector<Value> values_;
};

/// Text keys to values, in the order in which the keys first came. Copies share their content until one of
/// them changes. Meant for a message's worth of entries: a lookup compares keys one after another, literal ones by
/// their address.
class Dictionary {
 public:
  struct Entry;

  Dictionary() = default;
  Dictionary(std::initializer_list<Entry> entries);

  [[nodiscard]] std::size_t size() const { return entries_.size(); }
  [[nodiscard]] bool empty() const { return size() == 0; }
  [[nodiscard]] const Entry* begin() const;
  [[nodiscard]] const Entry* end() const;

  /// The value under `key`, or null; valid until the dictionary changes.
  [[nodiscard]] const Value* find(std::string_view key) const;
  [[nodiscard]] const Value* find(const Text& key) const;
  /// The entry under `key`, looked for from `from` on and then before it; null when there is none.
  [[nodiscard]] const Entry* findEntry(const Text& key, const Entry* from) const;
  /// The same, for changing it.
  [[nodiscard]] Value* findForChange(const Text& key);
  [[nodiscard]] bool contains(std::string_view key) const { return find(key) != nullptr; }

  void reserve(std::size_t capacity);
  /// Replaces the value in its place, or adds the entry at the end.
  void set(Text key, Value value);
  /// Adds an entry under a key, a Text, that the dictionary does not hold yet, without looking; `value` is a value, or
  /// whatever makes one.
  template <class Key, class Held>
  void append(Key&& key, Held&& value);
  /// Takes the entry out, if there is one.
  void erase(const Text& key);
  void clear() { entries_.clear(); }

  /// Equal keys and values, in any order.
  friend bool operator==(const Dictionary& a, const Dictionary& b);

 private:
  [[nodiscard]] std::optional<std::size_t> indexOf(const Text& key) const;

  SharedVector<Entry> entries_;
};

/// Whatever a dictionary holds. A number has a value, not a width: ask for the form that is needed, and it is
/// given where the number has it exactly.
class Value {
 public:
  /// Unsigned numbers up to the largest signed one are held as signed, so that equal numbers are held
  /// equally.
  using Held = std::variant<bool, std::int64_t, std::uint64_t, float, Text, Data, Array, Dictionary>;

  Value(std::same_as<bool> auto value) : held_(value) {}
  Value(std::signed_integral auto value) : held_(std::int64_t{value}) {}
  template <std::unsigned_integral Number>
  requires(!std::same_as<Number, bool>) Value(Number value)
      : held_(std::in_range<std::int64_t>(value) ? Held(static_cast<std::int64_t>(value))
                                                 : Held(std::uint64_t{value})) {}
  Value(std::same_as<float> auto value) : held_(value) {}
  Value(Text value) : held_(std::move(value)) {}
  Value(Data value) : held_(std::move(value)) {}
  Value(Array value) : held_(std::move(value)) {}
  Value(Dictionary value) : held_(std::move(value)) {}

  [[nodiscard]] const Held& held() const { return held_; }

  /// The number, when it is integral and fits. A boolean is no integer.
  [[nodiscard]] std::optional<std::int64_t> integer() const {
    if (const auto* number = std::get_if<std::int64_t>(&held_)) return *number;
    return integerOfFloat();
  }
  [[nodiscard]] std::optional<std::int32_t> integer32() const;
  /// The number, when single precision holds it exactly.
  [[nodiscard]] std::optional<float> exactFloat() const;
  /// Any number, rounded where double precision does not hold it.
  [[nodiscard]] std::optional<double> number() const {
    if (const auto* number = std::get_if<std::int64_t>(&held_)) return static_cast<double>(*number);
    if (const auto* number = std::get_if<float>(&held_)) return double{*number};
    if (const auto* number = std::get_if<std::uint64_t>(&held_)) return static_cast<double>(*number);
    return std::nullopt;
  }

  [[nodiscard]] const bool* boolean() const { return std::get_if<bool>(&held_); }
  [[nodiscard]] const Text* text() const { return std::get_if<Text>(&held_); }
  [[nodiscard]] const Data* data() const { return std::get_if<Data>(&held_); }
  [[nodiscard]] const Array* array() const { return std::get_if<Array>(&held_); }
  [[nodiscard]] const Dictionary* dictionary() const { return std::get_if<Dictionary>(&held_); }

  /// Numbers are equal when their values are, however they are held; a boolean equals only a boolean.
  friend bool operator==(const Value& a, const Value& b);

 private:
  [[nodiscard]] std::optional<std::int64_t> integerOfFloat() const;

  Held held_;
};

struct Dictionary::Entry {
  Text key;
  Value value;

  friend bool operator==(const Entry&, const Entry&) = default;
};

inline const Value* Array::begin() const {
  return values_.begin();
}
inline const Value* Array::end() const {
  return values_.end();
}
inline const Value& Array::operator[](std::size_t index) const {
  return values_[index];
}
inline void Array::reserve(std::size_t capacity) {
  values_.reserve(capacity);
}
template <class Held>
void Array::append(Held&& value) {
  values_.emplace(std::forward<Held>(value));
}

inline const Dictionary::Entry* Dictionary::begin() const {
  return entries_.begin();
}
inline const Dictionary::Entry* Dictionary::end() const {
  return entries_.end();
}
inline void Dictionary::reserve(std::size_t capacity) {
  entries_.reserve(capacity);
}
template <class Key, class Held>
void Dictionary::append(Key&& key, Held&& value) {
  entries_.emplace(std::forward<Key>(key), std::forward<Held>(value));
}

}  // namespace vesk
