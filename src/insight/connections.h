#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "insight/cause_counts.h"
#include "insight/kpis.h"
#include "insight/rrc_states.h"
#include "insight/step.h"
#include "values/optional_number.h"

namespace vesk::insight {

struct ServingCell;

/// What became of a technology's connections on the whole drive.
struct ConnectionCounts {
  std::uint64_t attempted = 0;
  std::uint64_t established = 0;
  CauseCounts failed;
  CauseCounts dropped;
  CauseCounts released;
  /// Attempted, by the cause of each.
  CauseCounts reestablishments;
  std::uint64_t reestablished = 0;
};

/// The radio connection of each technology: its state, and how it was set up, re-established, released or lost.
class Connections {
 public:
  /// The state's whole name; absent while unknown.
  [[nodiscard]] const std::optional<Text>& state(Technology technology) const { return of(technology).state; }
  /// When it began, as far as was seen; to be asked for a known state.
  [[nodiscard]] std::int64_t stateSince(Technology technology) const { return of(technology).since; }
  /// Why the state was entered; absent when it was not told.
  [[nodiscard]] const std::optional<Text>& cause(Technology technology) const { return of(technology).cause; }
  /// Whether LTE is looking for a cell to go on with its connection.
  [[nodiscard]] bool isReestablishing() const;
  [[nodiscard]] const ConnectionCounts& counts(Technology technology) const { return counts_[indexOf(technology)]; }

  /// Whether the connection of the technology became idle. `serving` is the cell that serves now.
  bool take(const RrcReport& report, const std::optional<ServingCell>& serving, const KnownKpis& kpis, Step& step);
  /// The states; what was counted stays.
  void forget() {
    for (const Technology each : kTechnologies)
      forget(each);
  }
  void forget(Technology technology) {
    Connection& connection = connections_[indexOf(technology)];
    connection.state.reset();
    connection.cause.reset();
    connection.attempt.reset();
  }

 private:
  /// An attempt under way whose begin was seen.
  struct Attempt {
    AttemptKind kind;
    std::optional<Text> cause;
    /// Of a re-establishment: where it was needed.
    std::optional<CellIdentity> cell{};
    OptionalNumber<double> level{};
  };

  /// While the state is unknown so is the rest.
  struct Connection {
    std::optional<Text> state;
    std::int64_t since = 0;
    std::optional<Text> cause;
    std::optional<Attempt> attempt;
  };

  struct Change;

  [[nodiscard]] const Connection& of(Technology technology) const { return connections_[indexOf(technology)]; }
  /// What follows from the change, and counts it.
  void begin(const Change& change, Step& step);
  void succeed(const Change& change, Step& step);
  void fail(const Change& change, Step& step);
  void end(const Change& change, Step& step);
  [[nodiscard]] Attempt beginUnseen(const Change& change);
  void drop(const Change& change, const std::optional<Text>& cause, Step& step);

  std::array<Connection, kTechnologies.size()> connections_;
  std::array<ConnectionCounts, kTechnologies.size()> counts_;
};

}  // namespace vesk::insight
