#pragma once

#include <string>
#include <string_view>

#include "schema.h"

namespace messagegen {

/// The name of a field's accessors: "Thres_X_highP" is thresXHighP, and a list has a final s (multi_band_info
/// is multiBandInfos, inst_values is instValues).
[[nodiscard]] std::string propertyOf(const Field& field);
/// The name of one element of a list: multiBandInfo, instValues.
[[nodiscard]] std::string elementOf(const Field& field);
/// With its first letter raised.
[[nodiscard]] std::string capitalized(std::string_view name);

/// Whether C++ keeps the word for itself.
[[nodiscard]] bool isKeyword(std::string_view name);
/// Whether C++ takes it for a word at all.
[[nodiscard]] bool isIdentifier(std::string_view name);

}  // namespace messagegen
