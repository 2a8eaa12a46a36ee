#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <memory>
#include <optional>

#include "messages/nas/nas.h"

namespace vesk::diag {

/// A bearer that the network has asked the phone to activate.
struct RequestedBearer {
  std::shared_ptr<metrics::BearerContext> context;
  /// The identity of the bearer that a dedicated one belongs to.
  std::optional<std::uint8_t> linkedTo;
};

/// The EPS bearers of one SIM, by identity (0 to 15).
class Bearers {
 public:
  static constexpr std::size_t kIdentities = 16;

  /// There is none, which makes all that come from now on all that there are.
  void reset();
  void request(std::uint8_t identity, RequestedBearer bearer) { requested_[identity] = std::move(bearer); }
  void dropRequest(std::uint8_t identity) { requested_[identity].reset(); }
  /// What was requested becomes active, and so does what it is linked to. False, and nothing happens, when nothing was.
  [[nodiscard]] bool accept(std::uint8_t identity);
  /// False when the bearer was not active.
  [[nodiscard]] bool deactivate(std::uint8_t identity);

  /// The active bearers, counted only when all are known.
  [[nodiscard]] metrics::KCellularActivatedBearerContexts report() const;

 private:
  std::array<std::shared_ptr<metrics::BearerContext>, kIdentities> active_;
  std::array<std::optional<RequestedBearer>, kIdentities> requested_;
  bool areAllKnown_ = false;
};

}  // namespace vesk::diag
