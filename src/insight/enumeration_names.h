#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

/// The names of enumeration values, from the form that records hold ("KLTE_RRC_STATE_CONNECTED") to shorter ones.
namespace vesk::insight {

/// The name without the prefix of its enumeration: "CONNECTED". A name without one stays whole; a value that its
/// enumeration does not have, "(unknown: 77)", too.
[[nodiscard]] std::string_view shortName(std::string_view name);

/// A short name as people read it, with blanks for its underscores.
[[nodiscard]] std::string withBlanks(std::string_view name);

/// "(unknown: 77)", which stands for a value that the enumeration does not have.
[[nodiscard]] bool isUnknownName(std::string_view name);

/// The number of an EMM cause or of an MM reject cause; absent for what is neither.
[[nodiscard]] std::optional<std::int32_t> causeCode(std::string_view name);

/// The name of the radio band with that number; absent for a number that no band has.
[[nodiscard]] std::optional<std::string_view> bandName(std::int64_t number);

}  // namespace vesk::insight
