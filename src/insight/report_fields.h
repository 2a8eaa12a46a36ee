#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>

#include "insight/quantities.h"
#include "values/value.h"

/// What a record holds under a key, as far as it is possible; absent for anything else.
namespace vesk::insight {

using Integer = std::optional<std::int64_t>;
using Number = std::optional<double>;

/// A number, unless it is one of those that stand for no value in 32 bits.
[[nodiscard]] Integer integerOf(const Dictionary& record, const Text& key);
[[nodiscard]] Integer integerIn(const Dictionary& record, const Text& key, std::int64_t first, std::int64_t last);
/// Any number: of a row that says nothing of what is possible.
[[nodiscard]] Integer anyInteger(const Dictionary& record, const Text& key);

/// A new band may have any EARFCN: one that lies in no known band is a channel all the same.
[[nodiscard]] inline Integer earfcnOf(const Dictionary& record, const Text& key) {
  return integerOf(record, key);
}
[[nodiscard]] Integer uarfcnOf(const Dictionary& record, const Text& key);
[[nodiscard]] Integer arfcnOf(const Dictionary& record);
[[nodiscard]] Integer pciOf(const Dictionary& record, const Text& key);
[[nodiscard]] Integer pscOf(const Dictionary& record, const Text& key);
[[nodiscard]] Integer bsicOf(const Dictionary& record);

[[nodiscard]] inline Number levelOf(const Quantity& quantity, const Dictionary& record, const Text& key) {
  return possibleValue(quantity, record.find(key));
}
/// What a code in steps of `step` above `offset` stands for; null is absent.
[[nodiscard]] Number decodedLevel(const Quantity& quantity, const Value* code, double step, double offset);

[[nodiscard]] inline Number greater(const Number& one, const Number& other) {
  if (!one || !other) return one ? one : other;
  return std::max(*one, *other);
}
/// The greatest of what `levelIn` finds in the records.
template <class Records, class LevelIn>
[[nodiscard]] Number greatest(const Records& records, LevelIn levelIn) {
  Number found;
  for (const auto& record : records)
    found = greater(found, levelIn(record));
  return found;
}

/// The whole name of an enumeration value.
[[nodiscard]] std::optional<Text> nameIn(const Dictionary& record, const Text& key);

}  // namespace vesk::insight
