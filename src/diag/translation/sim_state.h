#pragma once

#include <cstdint>
#include <optional>

#include "diag/nas/bearers.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"

namespace vesk::diag {

/// The LTE RRC connection, as its messages have left it.
struct RrcConnection {
  struct State {
    metrics::LteRrcState state;
    std::uint64_t sinceMs;
  };
  /// Absent before the first message.
  std::optional<State> last;
  /// Why a connection was last asked for, when the request said so.
  std::optional<metrics::LteRrcCause> requestCause;
};

/// The GSM cell that the modem camped on last.
struct GsmCell {
  std::uint32_t mcc;
  std::uint32_t mnc;
  std::uint32_t lac;
  std::uint32_t cellId;
  std::uint32_t arfcn;
  std::uint32_t bsic;
};

/// What is remembered of one SIM. The contexts hold every field that is known so far.
struct SimState {
  RrcConnection rrc;
  metrics::KCellularEmmContext emm;
  metrics::KCellularMmContext mm;
  metrics::KCellularGmmContext gmm;
  Bearers bearers;
  std::optional<GsmCell> gsmCell;
};

}  // namespace vesk::diag
