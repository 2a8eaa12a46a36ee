#pragma once

#include <cstdint>
#include <functional>
#include <optional>
#include <string>
#include <string_view>

#include "app/program/drive_time.h"
#include "app/program/metric_arrivals.h"
#include "insight/present.h"
#include "intake/stores.h"
#include "system/clock.h"
#include "terminal/view/surroundings.h"

namespace vesk {

/// The moment of the drive that the table screens show: the latest, or one that is held while the intake goes on. Main
/// queue only.
class ShownMoment {
 public:
  /// `pace` tells how many seconds of the drive pass in one. All must outlive this.
  ShownMoment(const Clock& clock, const insight::Present& drive, std::function<double()> pace)
      : clock_(clock), drive_(drive), pace_(std::move(pace)) {}
  ShownMoment(const ShownMoment&) = delete;
  ShownMoment& operator=(const ShownMoment&) = delete;
  ~ShownMoment() { release(); }

  /// A metric was stored, and the drive has taken it.
  void noteArrival(std::int64_t metricId, const Stores& stores);
  /// Forgets all that came, for a drive that is followed from its start again.
  void startAnew();
  /// The source has gone to a moment so long after the drive's last event.
  void setSinceLastEvent(std::chrono::milliseconds passed);
  /// To be called before the pace becomes another one.
  void keepTime();

  /// Holds what shows, the screens' stores included; once more for what is now.
  void hold();
  void release();
  [[nodiscard]] bool isHeld() const { return held_.has_value(); }

  [[nodiscard]] std::optional<Arrivals> arrivals(std::string_view area, std::string_view category) const;
  [[nodiscard]] DriveMoment time() const;
  /// What has passed of the drive since its last event, held or not: milliseconds.
  [[nodiscard]] std::int64_t sinceLastEvent() const {
    return time_.passedSince(drive_.clock().now(), clock_.now(), pace_());
  }
  /// "2018-01-20 21:53:05 UTC"; empty for a drive without dates.
  [[nodiscard]] std::string date() const;
  /// What the handset is on in place of the technology that a category is of; empty while it is on that, and for what
  /// all technologies have in common.
  [[nodiscard]] std::string technologyInstead(std::string_view area, std::string_view category) const;

  /// Fills in all that this tells.
  void addTo(Surroundings& surroundings) const;

 private:
  struct Held {
    MetricArrivals arrivals;
    DriveMoment time;
    bool isDated;
    std::optional<insight::Technology> technology;
  };

  [[nodiscard]] Held now() const;

  const Clock& clock_;
  const insight::Present& drive_;
  std::function<double()> pace_;
  MetricArrivals arrivals_;
  DriveTime time_;
  std::optional<Held> held_;
};

}  // namespace vesk
