#pragma once

#include <array>
#include <cstdint>
#include <optional>

#include "insight/connections.h"
#include "insight/kpis.h"
#include "insight/report.h"
#include "insight/step.h"

namespace vesk::insight {

struct ServingCell {
  Technology technology;
  CellIdentity identity;
  /// Milliseconds since 1970-01-01 00:00:00 UTC.
  std::int64_t since;
};

/// Which technology is in use, which cell serves, in which area, and how the phone came there.
class Mobility {
 public:
  [[nodiscard]] const std::optional<Technology>& technology() const { return technology_; }
  /// Of the technology in use.
  [[nodiscard]] const std::optional<ServingCell>& cell() const { return cell_; }
  /// Absent while unknown.
  [[nodiscard]] const std::optional<AreaIdentity>& area(Area area) const {
    return areas_[static_cast<std::size_t>(area)];
  }

  /// The technology that the report shows in use. The one left, when it is a change of one known.
  std::optional<Technology> takeTechnology(const Report& report, Step& step);
  /// The serving cell and the area. `connections` are those before the report.
  void take(const Report& report, const Connections& connections, const KnownKpis& kpis, Step& step);
  void forget();

 private:
  struct Way {
    EventKind kind;
    std::optional<CellEntry> how{};
  };

  void takeCell(const ServingCellReport& report, const Connections& connections, const KnownKpis& kpis, Step& step);
  [[nodiscard]] Way wayToNewCell(Technology technology, const Connections& connections) const;
  void forgetCells();
  void takeArea(const AreaReport& report, Step& step);

  std::optional<Technology> technology_;
  std::optional<ServingCell> cell_;
  /// The cell before, in the same technology.
  std::optional<CellIdentity> previous_;
  std::optional<bool> isConnectedMode_;
  std::array<std::optional<AreaIdentity>, 3> areas_;
};

}  // namespace vesk::insight
