#pragma once

#include <optional>
#include <string_view>

#include "insight/reading.h"
#include "values/value.h"

namespace vesk::insight {

/// The reading of the value under `key` of a record of that message class (for an element of a list, the class of the
/// elements), as the stores hold it. It may look at the record's other keys. Absent for a key without a rule, and for a
/// value of another type than the rule reads.
[[nodiscard]] std::optional<Reading> readingOf(std::string_view messageClass, const Dictionary& record,
                                               std::string_view key);
/// The same of one of the record's entries.
[[nodiscard]] std::optional<Reading> readingOf(std::string_view messageClass, const Dictionary& record,
                                               const Dictionary::Entry& entry);

}  // namespace vesk::insight
