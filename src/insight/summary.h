#pragma once

#include <array>
#include <cstdint>
#include <numeric>
#include <optional>
#include <vector>

#include "insight/drive_clock.h"
#include "insight/histogram.h"
#include "insight/timeline.h"
#include "insight/visited_cells.h"

namespace vesk::insight {

/// How many events came, by what became of them.
struct EventCounts {
  std::uint64_t all = 0;
  std::uint64_t stored = 0;
  std::uint64_t undecodable = 0;
  std::uint64_t ignored = 0;
  /// Stored, but before the first one with a time.
  std::uint64_t untimed = 0;
};

/// What was measured of a KPI on the whole drive.
struct KpiSummary {
  Histogram values;
  /// Milliseconds for which it was known: of a graded KPI by grade, of a transmit power by kNotHigh and kHigh.
  std::array<std::int64_t, 4> times{};

  static constexpr std::uint8_t kNotHigh = 0;
  static constexpr std::uint8_t kHigh = 1;

  [[nodiscard]] std::int64_t known() const { return std::accumulate(times.begin(), times.end(), std::int64_t{}); }
  [[nodiscard]] std::int64_t graded(Grade grade) const { return times[static_cast<std::size_t>(grade)]; }
  [[nodiscard]] std::int64_t high() const { return times[kHigh]; }
};

/// How the phone changed cells in a technology.
struct MobilityCounts {
  std::uint64_t handovers = 0;
  std::uint64_t reselections = 0;
  std::uint64_t reestablishments = 0;
  std::uint64_t unknown = 0;
  std::uint64_t pingPongs = 0;
};

/// A whole drive in figures that stay small whatever its length. An interval belongs wholly to what held at its start.
/// Times are milliseconds.
class Summary {
 public:
  /// Time that passed while `timeline` was as it is, up to the time `from`.
  void pass(std::int64_t passed, std::int64_t from, const Timeline& timeline);
  void takeGap(const Gap& gap);
  /// What was reported at a step, and what happened; `timeline` is as it left it.
  void take(const Report& report, const Step& step, const Timeline& timeline);

  /// Without a technology: the time in which none was known.
  [[nodiscard]] std::int64_t time(const std::optional<Technology>& technology) const;
  [[nodiscard]] const VisitedCells& cells() const { return cells_; }
  [[nodiscard]] const KpiSummary& kpi(Kpi kpi) const { return kpis_[indexOf(kpi)]; }
  [[nodiscard]] const MobilityCounts& mobility(Technology technology) const { return mobility_[indexOf(technology)]; }
  [[nodiscard]] std::int64_t carriersConfigured() const { return carriersConfigured_; }
  [[nodiscard]] std::int64_t carriersActivated() const { return carriersActivated_; }
  [[nodiscard]] std::int64_t noService() const { return noService_; }
  [[nodiscard]] const std::vector<Gap>& gaps() const { return gaps_; }
  [[nodiscard]] std::uint64_t count(EventKind kind) const { return kinds_[static_cast<std::size_t>(kind)]; }

 private:
  /// Of a longer drive the first are kept.
  static constexpr std::size_t kMostGaps = 10'000;

  void passKpis(std::int64_t passed, std::int64_t from, const KnownKpis& known);
  void takeCellEvent(const TimelineEvent& event);

  /// The last is the time without a technology.
  std::array<std::int64_t, kTechnologies.size() + 1> times_{};
  VisitedCells cells_;
  std::array<KpiSummary, kKpiCount> kpis_;
  /// Under which of its times a KPI's last value counts.
  std::array<std::uint8_t, kKpiCount> placeOfTime_{};
  std::array<MobilityCounts, kTechnologies.size()> mobility_;
  std::int64_t carriersConfigured_ = 0;
  std::int64_t carriersActivated_ = 0;
  std::int64_t noService_ = 0;
  std::vector<Gap> gaps_;
  std::array<std::uint64_t, kEventKindCount> kinds_{};
};

}  // namespace vesk::insight
