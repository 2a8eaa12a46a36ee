#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "handset/model/network.h"
#include "handset/reports/outbox.h"

namespace vesk::handset {

/// Who the subscriber is, in digits.
struct Subscriber {
  std::string imsi;
  std::string iccid;
  std::string msisdn;
};

/// The names that the network has given the handset, and the areas that it knows it in.
struct TemporaryIdentity {
  std::uint32_t mmeGroupId;
  std::uint32_t mmeCode;
  std::uint32_t mTmsi;
  std::uint32_t tmsi;
  std::uint32_t pTmsi;
  std::uint32_t trackingAreaCode;
  std::uint32_t locationAreaCode;
};

/// An area that a handset registers in: a tracking area of LTE, a location and routing area of the others.
struct Area {
  bool isTrackingArea;
  std::uint32_t code;

  friend bool operator==(const Area&, const Area&) = default;
};

/// Mobility management and the bearers. Tells its contexts whenever they change.
class Registration {
 public:
  explicit Registration(Random& random);

  /// Not registered yet: tells who the subscriber is.
  void switchOn(Outbox& outbox);
  [[nodiscard]] bool isRegisteredIn(const Area& area) const { return area_ == area; }
  /// To be called at every step while there is a signalling connection in `area`: registers there where that is
  /// needed, which takes a moment.
  void keepUp(const Area& area, std::int64_t nowMs, Outbox& outbox, Random& random);

  [[nodiscard]] const Subscriber& subscriber() const { return subscriber_; }
  [[nodiscard]] const TemporaryIdentity& identity() const { return identity_; }

 private:
  struct Update {
    Area area;
    std::int64_t completeMs;
  };

  void begin(const Area& area, Outbox& outbox) const;
  void complete(const Area& area, Outbox& outbox, Random& random);
  void tellContexts(Outbox& outbox) const;
  void tellBearers(bool isOnLte, Outbox& outbox) const;

  Subscriber subscriber_;
  TemporaryIdentity identity_;
  std::uint64_t interfaceId_;
  std::uint32_t internetAddress_;
  std::optional<Area> area_;
  std::optional<Update> update_;
};

}  // namespace vesk::handset
