#pragma once

#include <cstdint>
#include <optional>

#include "diag/layout/byte_reader.h"
#include "diag/nas/bearers.h"

namespace vesk::diag {

/// A message about a bearer.
struct EsmMessage {
  /// Of the bearer.
  std::uint8_t identity;
  std::uint8_t type;
  /// What a request to activate a bearer asks for.
  std::optional<RequestedBearer> requested;
};

/// None when the message is cut off.
[[nodiscard]] std::optional<EsmMessage> readEsmMessage(ByteSpan bytes);
/// Does to the bearers what the message says. Whether that is to be told: which bearers are active has changed.
[[nodiscard]] bool apply(const EsmMessage& message, Bearers& bearers);

}  // namespace vesk::diag
