#pragma once

#include <string>
#include <string_view>

#include "screens/category_sources.h"
#include "toolkit/table_data_source.h"

namespace vesk {

/// The most telling value of a category, as short as a menu needs it: "CONNECTED", "-96 dBm, fair", "PCI 338"; of a
/// list the greatest one, or how many elements it has. Empty while there is none.
[[nodiscard]] std::string headlineOf(const CategorySource& source, const Stores& stores);

/// What the row `at` of a category's screen means; empty for a row that has no reading, or no longer the name `name`.
[[nodiscard]] std::string readingOfRow(const CategorySource& source, const Stores& stores, IndexPath at,
                                       std::string_view name);

}  // namespace vesk
