#pragma once

#include <cstdint>
#include <optional>
#include <span>

#include "messages/nas/nas.h"

namespace vesk::diag {

/// What a state of a registration, with one of its substates or with any, means.
struct StatusOfState {
  std::uint32_t state;
  std::optional<std::uint32_t> substate;
  metrics::RegStatus status;
};

/// By the first row that fits; none when none does.
[[nodiscard]] inline std::optional<metrics::RegStatus> statusOf(std::span<const StatusOfState> rows,
                                                                std::uint32_t state, std::uint32_t substate) {
  for (const StatusOfState& row : rows) {
    if (row.state == state && row.substate.value_or(substate) == substate) return row.status;
  }
  return std::nullopt;
}

}  // namespace vesk::diag
