#pragma once

#include "values/value.h"

namespace vesk {

/// A value as a row shows it: one that has no parts on one line, as in logs; a dictionary with one entry a line, a list
/// of dictionaries with one element after another, each begun by a dash.
[[nodiscard]] Text detailTextOf(const Value& value);

}  // namespace vesk
