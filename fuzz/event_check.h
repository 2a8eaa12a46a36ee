#pragma once

#include <cstdint>
#include <span>

#include "app/connected_program.h"

namespace vesk {

/// Raises the event and holds the stores against what the rules of the wire make of its payload: an event that is not
/// taken changes nothing, one that is changes no other metric's record.
void checkEvent(ConnectedProgram& program, std::int64_t metricId, std::span<const std::uint8_t> payload);

/// Nothing of the latest records acts on a terminal when it is printed as JSON.
void checkRecordsAsJson(const Stores& stores);

}  // namespace vesk
