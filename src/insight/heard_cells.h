#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>
#include <vector>

#include "insight/report.h"
#include "insight/timeline.h"
#include "values/json_form.h"
#include "values/optional_number.h"

namespace vesk::insight {

/// Tells the rows of the cells heard apart.
struct HeardKey {
  Technology technology;
  /// EARFCN, UARFCN or ARFCN.
  OptionalNumber<std::int64_t> channel;
  /// PCI, PSC or BSIC.
  OptionalNumber<std::int64_t> code;

  /// By code first, in which the cells of a list differ most.
  friend bool operator==(const HeardKey& one, const HeardKey& other) {
    return one.code == other.code && one.channel == other.channel && one.technology == other.technology;
  }
};

enum class HeardRole : std::uint8_t { serving, secondary, neighbor };

/// "serving", "secondary", "neighbour".
[[nodiscard]] std::string_view nameOf(HeardRole role);

/// A cell as it was last heard.
struct HeardCell {
  HeardKey key;
  HeardRole role;
  /// dBm.
  OptionalNumber<double> level;
  /// dB.
  OptionalNumber<double> quality;
  /// To the level of the serving cell of the same technology, dB.
  OptionalNumber<double> difference;
  /// Milliseconds since the last report.
  std::int64_t age;
  /// Milliseconds since it ceased to serve, 0 while it serves; absent when it did not serve since it was first heard.
  OptionalNumber<std::int64_t> servedAgo;
};

/// The cells heard in the last half minute, of all technologies.
class HeardCells {
 public:
  /// `timeline` is as the report left it.
  void take(const Report& report, const Timeline& timeline, std::int64_t now);
  void forget();

  /// In the order in which they are shown: by role, technology and level.
  [[nodiscard]] std::vector<HeardCell> cells(const Timeline& timeline, std::int64_t now) const;

 private:
  static constexpr std::int64_t kKeptFor = 30'000;
  /// Lists of thousands of cells come from damage; of those the strongest are kept.
  static constexpr std::size_t kMostCells = 512;

  struct Row {
    HeardKey key;
    OptionalNumber<double> level;
    OptionalNumber<double> quality;
    std::int64_t heardAt;
    /// When it last ceased to serve.
    OptionalNumber<std::int64_t> servedUntil;
  };

  [[nodiscard]] static bool isOld(const Row& row, std::int64_t now) { return now - row.heardAt > kKeptFor; }
  void dropOld(std::int64_t now);
  void takeServing(const Report& report, const Timeline& timeline, std::int64_t now);
  void takeNeighbors(std::span<const NeighborReport> neighbors, std::int64_t now);
  /// The row of the key, which may be old; null when there is none.
  [[nodiscard]] Row* find(const HeardKey& key);
  /// The row, a new one when there is none; null when there is no room for one of that level.
  [[nodiscard]] Row* findOrAdd(const HeardKey& key, const OptionalNumber<double>& level, std::int64_t now);
  /// The serving cell's comes last.
  [[nodiscard]] Row* weakest();
  void hear(const HeardKey& key, const OptionalNumber<double>& level, const OptionalNumber<double>& quality,
            std::int64_t now);

  std::vector<Row> rows_;
  /// A digest of each row's key, in the order of the rows: a search looks at these first.
  std::vector<std::uint64_t> digests_;
  /// When the old rows were dropped last.
  std::int64_t tidiedAt_ = 0;
  std::optional<HeardKey> serving_;
};

/// Writes a JSON array of them.
void writeJson(JsonWriter& json, const std::vector<HeardCell>& cells);

}  // namespace vesk::insight
