#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <vector>

#include "insight/drive_clock.h"
#include "insight/heard_cells.h"
#include "insight/serving_details.h"
#include "insight/summary.h"
#include "insight/timeline.h"
#include "insight/trend.h"

namespace vesk::insight {

/// What is known of a drive at a moment, and what led there: everything but the figures of the whole drive. A copy
/// stays as it is while the drive goes on.
class Present {
 public:
  /// The drive's time: milliseconds since 1970-01-01 00:00:00 UTC; absent before the first event with a time.
  [[nodiscard]] std::optional<std::int64_t> now() const {
    return clock_.now() ? std::optional(*clock_.now() + later_) : std::nullopt;
  }
  /// Looks at it so many milliseconds after the last event, until the next one comes: for whoever knows that time
  /// passes while none comes.
  void setLater(std::int64_t later) { later_ = later; }
  [[nodiscard]] const DriveClock& clock() const { return clock_; }
  /// Where that lies in the drive's counted time, without its gaps: milliseconds.
  [[nodiscard]] std::int64_t position() const { return clock_.counted() + later_; }
  [[nodiscard]] const EventCounts& counts() const { return counts_; }

  /// What is known now: technology, serving cell, area, connection, registration, carriers, bearers, C-DRX.
  [[nodiscard]] const Timeline& timeline() const { return timeline_; }
  /// The value of a KPI while it is known, and its age in milliseconds.
  [[nodiscard]] std::optional<double> value(Kpi kpi) const { return timeline_.kpis().at(kpi, seen()); }
  [[nodiscard]] std::optional<std::int64_t> age(Kpi kpi) const { return timeline_.kpis().age(kpi, seen()); }
  [[nodiscard]] std::vector<HeardCell> cellsHeard() const { return heard_.cells(timeline_, seen()); }

  [[nodiscard]] const ServingDetails& servingDetails() const { return details_; }

  /// The last events, oldest first.
  [[nodiscard]] const Happenings& happenings() const { return happenings_; }
  /// How many there were before the first of these.
  [[nodiscard]] std::uint64_t happenedBefore() const { return happenedBefore_; }
  [[nodiscard]] const Trend& trend() const { return trend_; }

 protected:
  /// Of the last event.
  [[nodiscard]] std::int64_t time() const { return clock_.now().value_or(0); }
  /// Drops the oldest beyond kMostHappenings.
  void forgetOldHappenings();

  DriveClock clock_;
  EventCounts counts_;
  Timeline timeline_;
  ServingDetails details_;
  HeardCells heard_;
  Trend trend_;
  Happenings happenings_;
  std::int64_t later_ = 0;

 private:
  static constexpr std::size_t kMostHappenings = 2000;

  [[nodiscard]] std::int64_t seen() const { return time() + later_; }

  std::uint64_t happenedBefore_ = 0;
};

}  // namespace vesk::insight
