#include "values/value.h"

#include <algorithm>
#include <cmath>

namespace vesk {

namespace {

/// 2^63: the first double beyond the signed 64-bit numbers.
constexpr double kBeyondInt64 = 9223372036854775808.0;
/// 2^64: the first float beyond the unsigned 64-bit numbers.
constexpr float kBeyondUInt64 = 18446744073709551616.0F;

std::optional<std::int64_t> integerOf(double number) {
  if (std::trunc(number) != number || number < -kBeyondInt64 || number >= kBeyondInt64) return std::nullopt;
  return static_cast<std::int64_t>(number);
}

/// A float that stands for an integer is compared as that integer, so that no rounding makes numbers equal.
bool isSameNumber(const Value& a, const Value& b) {
  const std::optional<std::int64_t> left = a.integer();
  const std::optional<std::int64_t> right = b.integer();
  if (left || right) return left == right;
  if (a.held().index() == b.held().index()) return a.held() == b.held();
  const std::optional<float> leftFloat = a.exactFloat();
  return leftFloat && leftFloat == b.exactFloat();
}

}  // namespace

Array::Array(std::initializer_list<Value> values) {
  reserve(values.size());
  for (const Value& value : values)
    append(value);
}

bool operator==(const Array& a, const Array& b) {
  return a.values_ == b.values_;
}

Dictionary::Dictionary(std::initializer_list<Entry> entries) {
  reserve(entries.size());
  for (const Entry& entry : entries)
    set(entry.key, entry.value);
}

const Dictionary::Entry* Dictionary::findEntry(const Text& key, const Entry* from) const {
  bool areAllLiterals = key.isLiteral();
  const auto findAmong = [&areAllLiterals](const Entry* first, const Entry* last, auto isMeant) {
    for (; first != last; ++first) {
      if (isMeant(first->key)) return first;
      areAllLiterals &= first->key.isLiteral();
    }
    return static_cast<const Entry*>(nullptr);
  };
  // Literals are equal only when they are the same, so addresses decide unless a key is a copy.
  const auto isSame = [&key](const Text& each) { return each.isSameAs(key); };
  if (const Entry* foundBehind = findAmong(from, end(), isSame)) return foundBehind;
  if (const Entry* foundBefore = findAmong(begin(), from, isSame)) return foundBefore;
  if (areAllLiterals) return nullptr;
  return findAmong(begin(), end(), [&key](const Text& each) { return each == key; });
}

const Value* Dictionary::find(std::string_view key) const {
  const Entry* found = std::find_if(begin(), end(), [&](const Entry& each) { return each.key == key; });
  return found == end() ? nullptr : &found->value;
}

const Value* Dictionary::find(const Text& key) const {
  const Entry* found = findEntry(key, begin());
  return found == nullptr ? nullptr : &found->value;
}

std::optional<std::size_t> Dictionary::indexOf(const Text& key) const {
  const Entry* found = findEntry(key, begin());
  return found == nullptr ? std::nullopt : std::optional(static_cast<std::size_t>(found - begin()));
}

Value* Dictionary::findForChange(const Text& key) {
  const std::optional<std::size_t> index = indexOf(key);
  return index ? &entries_.mutableItems()[*index].value : nullptr;
}

void Dictionary::set(Text key, Value value) {
  if (Value* present = findForChange(key)) {
    *present = std::move(value);
  } else {
    append(std::move(key), std::move(value));
  }
}

void Dictionary::erase(const Text& key) {
  if (const std::optional<std::size_t> index = indexOf(key)) entries_.erase(*index);
}

bool operator==(const Dictionary& a, const Dictionary& b) {
  if (a.size() != b.size()) return false;
  return std::all_of(a.begin(), a.end(), [&](const Dictionary::Entry& entry) {
    const Value* other = b.find(entry.key);
    return other != nullptr && *other == entry.value;
  });
}

std::optional<std::int64_t> Value::integerOfFloat() const {
  const auto* number = std::get_if<float>(&held_);
  return number == nullptr ? std::nullopt : integerOf(double{*number});
}

std::optional<std::int32_t> Value::integer32() const {
  const std::optional<std::int64_t> number = integer();
  if (!number || !std::in_range<std::int32_t>(*number)) return std::nullopt;
  return static_cast<std::int32_t>(*number);
}

std::optional<float> Value::exactFloat() const {
  if (const auto* number = std::get_if<float>(&held_)) return *number;
  if (const auto* integral = std::get_if<std::int64_t>(&held_)) {
    const auto rounded = static_cast<float>(*integral);
    if (integerOf(double{rounded}) == *integral) return rounded;
  } else if (const auto* large = std::get_if<std::uint64_t>(&held_)) {
    const auto rounded = static_cast<float>(*large);
    if (rounded < kBeyondUInt64 && static_cast<std::uint64_t>(rounded) == *large) return rounded;
  }
  return std::nullopt;
}

bool operator==(const Value& a, const Value& b) {
  if (a.number() && b.number()) return isSameNumber(a, b);
  return a.held() == b.held();
}

}  // namespace vesk
