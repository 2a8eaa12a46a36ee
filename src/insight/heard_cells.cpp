#include "insight/heard_cells.h"

#include <algorithm>
#include <array>
#include <limits>
#include <tuple>

#include "insight/json_fields.h"

namespace vesk::insight {

namespace {

std::optional<HeardKey> keyOf(const std::optional<ServingCell>& cell) {
  if (!cell || (!cell->identity.channel && !cell->identity.code)) return std::nullopt;
  return HeardKey{cell->technology, cell->identity.channel, cell->identity.code};
}

/// Two cells seldom share one: whoever finds it compares the keys, too.
std::uint64_t digestOf(const HeardKey& key) {
  const auto channel = static_cast<std::uint64_t>(key.channel.value_or(-1)) + 1;
  const auto code = static_cast<std::uint64_t>(key.code.value_or(-1)) + 1;
  return channel << 12U ^ code << 2U ^ static_cast<std::uint64_t>(key.technology);
}

/// Unknown is weakest.
double strengthOf(const OptionalNumber<double>& level) {
  return level.value_or(-std::numeric_limits<double>::infinity());
}

}  // namespace

std::string_view nameOf(HeardRole role) {
  constexpr std::array<std::string_view, 3> kNames{"serving", "secondary", "neighbour"};
  return kNames[static_cast<std::size_t>(role)];
}

void HeardCells::take(const Report& report, const Timeline& timeline, std::int64_t now) {
  // Dropping goes through all rows, so it is done only now and then; until then find() may come upon an old row.
  constexpr std::int64_t kTidyInterval = 5000;
  if (now - tidiedAt_ >= kTidyInterval) dropOld(now);
  const std::optional<HeardKey> serving = keyOf(timeline.mobility().cell());
  if (serving != serving_) {
    if (Row* left = serving_ ? find(*serving_) : nullptr) left->servedUntil = now;
    serving_ = serving;
  }
  if (serving_) takeServing(report, timeline, now);
  for (const CarrierReport& each : report.carriers)
    if (each.level || timeline.carriers().isConfigured(each.index))
      hear({Technology::lte, each.channel, each.code}, each.level, each.quality, now);
  if (!report.neighbors.empty()) takeNeighbors(report.neighbors, now);
}

void HeardCells::takeNeighbors(std::span<const NeighborReport> neighbors, std::int64_t now) {
  std::vector<NeighborReport> strongest;
  if (neighbors.size() > kMostCells) {
    strongest.assign(neighbors.begin(), neighbors.end());
    std::nth_element(strongest.begin(), strongest.begin() + kMostCells, strongest.end(),
                     [](const NeighborReport& one, const NeighborReport& other) {
                       return strengthOf(one.level) > strengthOf(other.level);
                     });
    neighbors = std::span(strongest).first(kMostCells);
  }
  for (const NeighborReport& each : neighbors)
    hear({each.technology, each.channel, each.code}, each.level, each.quality, now);
}

void HeardCells::takeServing(const Report& report, const Timeline& timeline, std::int64_t now) {
  if (report.servingCell && !report.servingCell->identity.isUnknown()) {
    if (Row* row = findOrAdd(*serving_, std::nullopt, now)) row->heardAt = now;
  }
  const auto level = report.kpis.find(levelOf(serving_->technology));
  if (!level || !isOfServingCell(report, timeline.mobility().cell()->identity)) return;
  const auto quality = qualityOf(serving_->technology);
  hear(*serving_, level, quality ? report.kpis.find(*quality) : std::nullopt, now);
}

void HeardCells::hear(const HeardKey& key, const OptionalNumber<double>& level, const OptionalNumber<double>& quality,
                      std::int64_t now) {
  if (!key.channel && !key.code) return;
  Row* row = findOrAdd(key, level, now);
  if (row == nullptr) return;
  row->level = level;
  row->quality = quality;
  row->heardAt = now;
}

void HeardCells::dropOld(std::int64_t now) {
  tidiedAt_ = now;
  std::size_t kept = 0;
  for (std::size_t index = 0; index < rows_.size(); ++index) {
    if (isOld(rows_[index], now)) continue;
    rows_[kept] = rows_[index];
    digests_[kept++] = digests_[index];
  }
  rows_.erase(rows_.begin() + static_cast<std::ptrdiff_t>(kept), rows_.end());
  digests_.resize(kept);
}

HeardCells::Row* HeardCells::find(const HeardKey& key) {
  const std::uint64_t digest = digestOf(key);
  for (auto place = std::find(digests_.begin(), digests_.end(), digest); place != digests_.end();
       place = std::find(place + 1, digests_.end(), digest)) {
    Row& row = rows_[static_cast<std::size_t>(place - digests_.begin())];
    if (row.key == key) return &row;
  }
  return nullptr;
}

HeardCells::Row* HeardCells::findOrAdd(const HeardKey& key, const OptionalNumber<double>& level, std::int64_t now) {
  Row* row = find(key);
  if (row != nullptr && !isOld(*row, now)) return row;
  if (row != nullptr || rows_.size() == kMostCells) dropOld(now);
  const Row heard{key, std::nullopt, std::nullopt, now, std::nullopt};
  if (rows_.size() < kMostCells) {
    digests_.push_back(digestOf(key));
    return &rows_.emplace_back(heard);
  }
  row = weakest();
  if (key != serving_ && strengthOf(row->level) >= strengthOf(level)) return nullptr;
  digests_[static_cast<std::size_t>(row - rows_.data())] = digestOf(key);
  *row = heard;
  return row;
}

HeardCells::Row* HeardCells::weakest() {
  const auto rank = [this](const Row& row) { return std::pair(row.key == serving_, strengthOf(row.level)); };
  return &*std::min_element(rows_.begin(), rows_.end(),
                            [&](const Row& one, const Row& other) { return rank(one) < rank(other); });
}

void HeardCells::forget() {
  rows_.clear();
  digests_.clear();
  tidiedAt_ = 0;
  serving_.reset();
}

std::vector<HeardCell> HeardCells::cells(const Timeline& timeline, std::int64_t now) const {
  const auto carriers = timeline.carriers().configured();
  const auto roleOf = [&](const HeardKey& key) {
    if (key == serving_) return HeardRole::serving;
    const bool isSecondary =
        key.technology == Technology::lte && std::any_of(carriers.begin(), carriers.end(), [&](const Carrier& each) {
          return each.channel == key.channel && each.code == key.code;
        });
    return isSecondary ? HeardRole::secondary : HeardRole::neighbor;
  };
  const auto serving =
      std::find_if(rows_.begin(), rows_.end(), [&](const Row& row) { return row.key == serving_ && !isOld(row, now); });
  std::vector<HeardCell> cells;
  for (const Row& row : rows_) {
    if (isOld(row, now)) continue;
    HeardCell& cell = cells.emplace_back(
        HeardCell{row.key, roleOf(row.key), row.level, row.quality, std::nullopt, now - row.heardAt, std::nullopt});
    const bool isComparable = serving != rows_.end() && serving->key.technology == row.key.technology;
    if (isComparable && serving->level && row.level) cell.difference = *row.level - *serving->level;
    if (cell.role == HeardRole::serving) {
      cell.servedAgo = 0;
    } else if (row.servedUntil) {
      cell.servedAgo = now - *row.servedUntil;
    }
  }
  const auto rank = [](const HeardCell& cell) {
    return std::tuple(cell.role, cell.key.technology, -strengthOf(cell.level), cell.key.channel, cell.key.code);
  };
  std::sort(cells.begin(), cells.end(),
            [&](const HeardCell& one, const HeardCell& other) { return rank(one) < rank(other); });
  return cells;
}

void writeJson(JsonWriter& json, const std::vector<HeardCell>& cells) {
  writeJsonArray(json, cells, [&](const HeardCell& cell) {
    JsonObject fields(json);
    writeField(json, fields, "technology", nameOf(cell.key.technology));
    writeField(json, fields, "channel", cell.key.channel);
    writeField(json, fields, "code", cell.key.code);
    writeField(json, fields, "role", nameOf(cell.role));
    writeField(json, fields, "level", cell.level);
    writeField(json, fields, "quality", cell.quality);
    writeField(json, fields, "difference", cell.difference);
    writeField(json, fields, "age_ms", std::optional(cell.age));
    writeField(json, fields, "served_ms_ago", cell.servedAgo);
    fields.end();
  });
}

}  // namespace vesk::insight
