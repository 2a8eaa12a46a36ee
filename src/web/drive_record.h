#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <map>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "insight/insight.h"
#include "web/stretches.h"
#include "web/thinned.h"

namespace vesk::web {

/// What was measured of a KPI around a position: the least and the greatest value, each where it was measured.
struct MeasuredPoint {
  std::int64_t position;
  std::int64_t leastAt;
  double least;
  std::int64_t greatestAt;
  double greatest;

  void absorb(const MeasuredPoint& later);
};

/// From here on that cell serves.
struct ServingPoint {
  std::int64_t position;
  /// Which of DriveRecord::cells(); absent while none is known.
  std::optional<std::size_t> cell;

  void absorb(const ServingPoint& later) { cell = later.cell; }
};

/// Something that a chart marks happened here.
struct MarkPoint {
  std::int64_t position;

  void absorb(const MarkPoint& /*later*/) {}
};

/// The kinds of marks in a chart.
enum class Mark : std::uint8_t { cellChange, reestablishment, drop, technologyChange };
inline constexpr std::size_t kMarkCount = 4;

/// How much of a drive is kept.
struct RecordLimits {
  /// Of each KPI: as many as a wide screen has pixels.
  std::size_t points;
  /// Of serving cells, and of each mark.
  std::size_t changes;
  /// Of each kind of event. The last are kept.
  std::size_t eventsOfKind;
  std::size_t stretches = 10'000;
  /// Of how long a time before the last event all points are kept: milliseconds.
  std::int64_t whole = 0;
};

inline constexpr RecordLimits kWholeDrive{.points = 4096, .changes = 32'768, .eventsOfKind = 2000};

/// What a page shows of a drive, or of a part of it: the course of the KPIs, the serving cells, marks and events. Its
/// memory is bounded. Positions are milliseconds of counted time, times are milliseconds since 1970-01-01 00:00:00 UTC.
class DriveRecord {
 public:
  struct Event {
    /// In which order the events came.
    std::uint64_t number;
    insight::TimelineEvent event;
  };

  explicit DriveRecord(const RecordLimits& limits);

  /// A step of the drive that `insight` follows, as its handler is told it.
  void take(const insight::Insight& insight, const insight::Report& report, const insight::Step& step);
  /// Lets go of all that happened; the cells keep their numbers.
  void clear();
  /// Nothing was taken since it was made or cleared.
  [[nodiscard]] bool isEmpty() const { return !hasTaken_; }

  [[nodiscard]] const Stretches& stretches() const { return stretches_; }
  [[nodiscard]] std::vector<MeasuredPoint> course(insight::Kpi kpi) const {
    return courses_[insight::indexOf(kpi)].points();
  }
  [[nodiscard]] std::vector<ServingPoint> serving() const { return serving_.points(); }
  /// Of cells that served one after the other within so many milliseconds only the last is told.
  [[nodiscard]] std::int64_t servingWidth() const { return serving_.width(); }
  [[nodiscard]] const std::vector<std::string>& cells() const { return cells_; }
  /// Where in cells() those begin that served for the first time since it was made or cleared.
  [[nodiscard]] std::size_t firstNewCell() const { return firstNewCell_; }
  [[nodiscard]] std::vector<MarkPoint> marks(Mark mark) const {
    return marks_[static_cast<std::size_t>(mark)].points();
  }
  /// In the order in which they happened.
  [[nodiscard]] std::vector<const Event*> events() const;

 private:
  /// Cells beyond these have no name in the band; damage alone brings so many.
  static constexpr std::size_t kMostCells = 4096;

  void takeServing(const std::optional<insight::ServingCell>& cell, std::int64_t position);
  [[nodiscard]] std::optional<std::size_t> numberOf(const insight::ServingCell& cell);
  void takeEvent(const insight::TimelineEvent& event);

  RecordLimits limits_;
  bool hasTaken_ = false;
  std::uint64_t stretchCount_ = 0;
  Stretches stretches_;
  std::vector<Thinned<MeasuredPoint>> courses_;
  Thinned<ServingPoint> serving_;
  /// The cell of the step before.
  std::optional<std::pair<insight::Technology, insight::CellIdentity>> servingNow_;
  std::vector<std::string> cells_;
  std::size_t firstNewCell_ = 0;
  std::map<std::string, std::size_t, std::less<>> cellNumbers_;
  std::vector<Thinned<MarkPoint>> marks_;
  std::uint64_t eventCount_ = 0;
  std::array<std::deque<Event>, insight::kEventKindCount> events_;
};

}  // namespace vesk::web
