#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <utility>

#include "insight/technology.h"
#include "values/optional_number.h"

namespace vesk::insight {

/// Who a cell is, as far as it is known.
struct CellIdentity {
  /// EARFCN, UARFCN or ARFCN.
  OptionalNumber<std::int64_t> channel;
  /// PCI, PSC or BSIC.
  OptionalNumber<std::int64_t> code;
  OptionalNumber<std::int64_t> cellId;

  [[nodiscard]] bool isUnknown() const { return !channel && !code && !cellId; }
  /// Takes over what is unknown here and known there.
  void fillIn(const CellIdentity& other);

  friend bool operator==(const CellIdentity&, const CellIdentity&) = default;
};

/// Whether they are two cells for sure: some part is known of both, and is not the same.
[[nodiscard]] bool differ(const CellIdentity& one, const CellIdentity& other);

/// "PCI 338 B17 5815", "PSC 145 UARFCN 10637", "CI 6758"; parts unknown are left out. `withCellId` adds " CI 6758"
/// where it is known and not there yet.
[[nodiscard]] std::string textOf(Technology technology, const CellIdentity& cell, bool withCellId = false);

/// Both, told apart by their cell identities where code and channel do not.
[[nodiscard]] std::pair<std::string, std::string> textsOf(Technology technology, const CellIdentity& from,
                                                          const CellIdentity& to);

}  // namespace vesk::insight
