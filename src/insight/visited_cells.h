#pragma once

#include <cstddef>
#include <cstdint>
#include <memory>
#include <vector>

#include "insight/cell_identity.h"
#include "insight/histogram.h"
#include "insight/kpis.h"

namespace vesk::insight {

/// A cell that served, with all that was measured of it.
struct VisitedCell {
  Technology technology;
  CellIdentity identity;
  /// Milliseconds for which it served.
  std::int64_t time = 0;
  std::uint64_t visits = 0;
  Histogram level{};
  Histogram quality{};
  Histogram sinr{};
};

/// The cells that served on the drive.
class VisitedCells {
 public:
  /// The cell serves from now on.
  void enter(Technology technology, const CellIdentity& identity);
  /// More is known of the cell that serves.
  void fillIn(const CellIdentity& identity);
  /// No cell is known to serve.
  void leave() { serving_ = nullptr; }
  void addTime(std::int64_t passed);
  /// What was measured of it.
  void take(const KpiReport& kpis);

  [[nodiscard]] std::size_t count() const { return cells_.size(); }
  /// Where the phone was longest first; where that is equal, in the order in which they first served.
  [[nodiscard]] std::vector<const VisitedCell*> byTime() const;

 private:
  /// A drive across a country has fewer. When there are more, those that served shortest are forgotten.
  static constexpr std::size_t kMostCells = 4096;

  void makeRoom();

  /// In the order in which they first served.
  std::vector<std::unique_ptr<VisitedCell>> cells_;
  /// Null while none is known to serve.
  VisitedCell* serving_ = nullptr;
};

}  // namespace vesk::insight
