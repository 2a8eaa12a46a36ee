#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string>
#include <string_view>

#include "values/data.h"

/// Taking out of metrics who was there: subscriber, addresses, access points. Cells, areas and times stay, for they are
/// what is measured.
namespace vesk::insight {

/// The message in the payload written anew, with its known fields only and every identity masked: zeros where it stood,
/// of the same length. Absent for a metric of no known class and for a payload that is no encoding of one: they could
/// hold anything. What is masked stays so: masking it again changes nothing.
[[nodiscard]] std::optional<Data> redactedPayload(std::int64_t metricId, std::span<const std::uint8_t> payload);

/// An access point name with an "x" for every byte of the labels that may tell whose it is.
[[nodiscard]] std::string redactedAccessPoint(std::string_view name);

}  // namespace vesk::insight
