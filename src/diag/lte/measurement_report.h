#pragma once

#include <cstdint>

#include "diag/layout/bit_reader.h"
#include "diag/packet.h"

namespace vesk::diag {

class EventBatch;

/// Reads a measurement report of LTE's RRC, from its first bit on: the serving cell, whose identity the report does not
/// hold, and the neighbours of one technology as far as they can be read.
[[nodiscard]] Reading readMeasurementReport(BitReader message, std::uint32_t servingPci, EventBatch& events);

}  // namespace vesk::diag
