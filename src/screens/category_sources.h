#pragma once

#include <cstdint>
#include <optional>
#include <string_view>

#include "intake/metric_validator.h"

namespace vesk {

/// How a category's source becomes rows.
enum class SourceKind {
  /// The latest record of a kind of metric, if there was one.
  metricRecord,
  /// A record of a store.
  storeRecord,
  /// A list of a store, one section an element.
  storeList,
  /// Only the first element of a list.
  firstElement,
  /// Nothing to show.
  placeholder,
};

/// Where the values of one category come from.
struct CategorySource {
  std::string_view area;
  std::string_view category;
  SourceKind kind;
  /// What the kind reads, from the intake as it is at the time of the call; null for the other kinds.
  MetricValidator::LatestRecord (*latestRecord)(const MetricValidator& intake) = nullptr;
  Record (*storeRecord)(const MetricValidator& intake) = nullptr;
  RecordList (*list)(const MetricValidator& intake) = nullptr;
  /// What stands before the number of an element in the header of its section.
  std::string_view headerPrefix{};
  /// The message class of a list's elements.
  std::string_view elementClass{};
  /// The metric that changes the source; absent for a placeholder.
  std::optional<std::int64_t> metric{};
};

/// The source of a pair of labels. A pair that no menu has is a placeholder.
[[nodiscard]] const CategorySource& sourceOf(std::string_view area, std::string_view category);

/// What the source's records are decoded from: the message class of each; empty for a placeholder.
[[nodiscard]] std::string_view messageClassOf(const CategorySource& source);

/// The records that the source's screen shows, one a section; none for a placeholder, and for a kind of metric that has
/// not come.
[[nodiscard]] RecordList shownRecords(const CategorySource& source, const MetricValidator& intake);

}  // namespace vesk
