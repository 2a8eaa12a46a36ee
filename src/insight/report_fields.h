#pragma once

#include <algorithm>
#include <cstdint>
#include <optional>

#include "insight/channels.h"
#include "insight/quantities.h"
#include "values/optional_number.h"
#include "values/ordered_lookup.h"

/// What a record holds under a key, as far as it is possible; absent for anything else.
namespace vesk::insight {

using Integer = OptionalNumber<std::int64_t>;
using Number = OptionalNumber<double>;

/// A number, unless it is one of those that stand for no value in 32 bits.
[[nodiscard]] Integer integerOf(OrderedLookup& record, const Text& key);
[[nodiscard]] Integer integerIn(OrderedLookup& record, const Text& key, std::int64_t first, std::int64_t last);
/// Any number: of a row that says nothing of what is possible.
[[nodiscard]] Integer anyInteger(OrderedLookup& record, const Text& key);

/// A new band may have any EARFCN: one that lies in no known band is a channel all the same.
[[nodiscard]] inline Integer earfcnOf(OrderedLookup& record, const Text& key) {
  return integerOf(record, key);
}
[[nodiscard]] Integer uarfcnOf(OrderedLookup& record, const Text& key);
/// `indicated` tells which band is meant where two share the number; absent if nothing says.
[[nodiscard]] Integer arfcnOf(OrderedLookup& record, std::optional<SharedGsmBand> indicated);
[[nodiscard]] Integer pciOf(OrderedLookup& record, const Text& key);
[[nodiscard]] Integer pscOf(OrderedLookup& record, const Text& key);
[[nodiscard]] Integer bsicOf(OrderedLookup& record);

[[nodiscard]] inline Number levelOf(const Quantity& quantity, OrderedLookup& record, const Text& key) {
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
[[nodiscard]] std::optional<Text> nameIn(OrderedLookup& record, const Text& key);

}  // namespace vesk::insight
