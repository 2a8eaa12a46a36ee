#pragma once

#include <cstdint>

/// The metrics that the program knows, as events carry them: K_LTE_RRC_STATE and its like.
namespace vesk {

#define KNOWN_METRIC(constant, identifier, label) inline constexpr std::int64_t constant = identifier;
#include "messages/registry/metrics.def"

}  // namespace vesk
