#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <optional>
#include <string_view>
#include <vector>

#include "insight/cell_identity.h"
#include "insight/kpis.h"
#include "insight/plmn.h"
#include "values/optional_number.h"
#include "values/text.h"

/// What one metric event says, in the terms of this room: everything that is impossible is already absent.
namespace vesk::insight {

struct ServingCellReport {
  Technology technology;
  CellIdentity identity;
};

enum class Area : std::uint8_t { tracking, location, routing };

/// "TAI", "LAI", "RAI".
[[nodiscard]] constexpr std::string_view nameOf(Area area) {
  constexpr std::array<std::string_view, 3> kNames{"TAI", "LAI", "RAI"};
  return kNames[static_cast<std::size_t>(area)];
}

struct AreaReport {
  Area area;
  AreaIdentity identity;
};

/// Names are whole: "KLTE_RRC_STATE_CONNECTED".
struct RrcReport {
  Technology technology;
  Text state;
  std::optional<Text> previous{};
  /// Milliseconds.
  OptionalNumber<std::int64_t> previousDuration{};
  std::optional<Text> cause{};
  /// Told beside something else: it is known from then on, and is no change.
  bool isMention = false;
};

enum class Registration : std::uint8_t { emm, mm, gmm };

/// "EMM", "MM", "GMM".
[[nodiscard]] constexpr std::string_view nameOf(Registration registration) {
  constexpr std::array<std::string_view, 3> kNames{"EMM", "MM", "GMM"};
  return kNames[static_cast<std::size_t>(registration)];
}

struct RegistrationReport {
  Registration registration;
  std::optional<Text> status;
  std::optional<Text> rejectCause;
  std::optional<Text> procedure;
};

enum class CarrierState : std::uint8_t { released, configured, activated };

/// An element of the carrier aggregation list, in the order of its fields.
struct CarrierReport {
  OptionalNumber<std::int64_t> index;
  std::optional<CarrierState> state;
  OptionalNumber<std::int64_t> code;
  OptionalNumber<std::int64_t> channel;
  OptionalNumber<double> bandwidth;
  OptionalNumber<double> level;
  OptionalNumber<double> quality;
};

struct Bearer {
  std::int64_t number;
  std::optional<Text> accessPoint{};
  std::optional<Text> type{};
};

/// Milliseconds.
struct CdrxParameters {
  OptionalNumber<std::int64_t> onDuration;
  OptionalNumber<std::int64_t> inactivity;
  OptionalNumber<std::int64_t> longCycle;
  OptionalNumber<std::int64_t> shortCycle;

  friend bool operator==(const CdrxParameters&, const CdrxParameters&) = default;
};

struct CdrxReport {
  bool isSetUp;
  CdrxParameters parameters;
};

/// A cell as a list of neighbours has it.
struct NeighborReport {
  Technology technology;
  OptionalNumber<std::int64_t> channel;
  OptionalNumber<std::int64_t> code;
  OptionalNumber<double> level;
  OptionalNumber<double> quality;
};

struct Report {
  /// The technology that the event shows in use.
  std::optional<Technology> technology;
  KpiReport kpis;
  /// Of the LTE sample that the KPIs are of.
  OptionalNumber<std::int64_t> samplePci;
  /// Of a UMTS measurement.
  std::optional<bool> isConnectedMode;
  std::optional<ServingCellReport> servingCell;
  std::optional<AreaReport> area;
  std::optional<RrcReport> rrc;
  std::optional<RegistrationReport> registration;
  std::vector<CarrierReport> carriers;
  std::optional<std::vector<Bearer>> bearers;
  std::optional<CdrxReport> cdrx;
  OptionalNumber<std::int64_t> transmissionMode;
  /// Of the serving LTE cell's downlink, MHz.
  OptionalNumber<double> bandwidth;
  /// The least level to stay on the LTE cell, dBm.
  OptionalNumber<double> leastLevel;
  std::optional<std::size_t> simFiles;
  std::vector<NeighborReport> neighbors;
};

/// Whether what an event reports is of the cell that serves: an LTE sample may still be of the one before.
[[nodiscard]] inline bool isOfServingCell(const Report& report, const CellIdentity& serving) {
  return !report.samplePci || !serving.code || report.samplePci == serving.code;
}

}  // namespace vesk::insight
