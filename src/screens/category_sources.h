#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "intake/stores.h"

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

/// A category of the menu, and where its values come from.
struct CategorySource {
  std::string_view area;
  std::string_view category;
  SourceKind kind;
  /// What the kind reads, from the stores as they are at the time of the call; null for the other kinds.
  LatestRecord (*latestRecord)(const Stores& stores) = nullptr;
  Record (*storeRecord)(const Stores& stores) = nullptr;
  RecordList (*list)(const Stores& stores) = nullptr;
  /// What stands before the number of an element in the header of its section.
  std::string_view headerPrefix{};
  /// The message class of a list's elements.
  std::string_view elementClass{};
  /// What the metric's record has the list under.
  std::string_view listKey{};
  /// The metric that changes the source; absent for a placeholder.
  std::optional<std::int64_t> metric{};
};

/// The categories of all areas, in the order in which the menu shows them.
[[nodiscard]] std::span<const CategorySource> categorySources();

/// The source of a pair of labels. A pair that no menu has is a placeholder.
[[nodiscard]] const CategorySource& sourceOf(std::string_view area, std::string_view category);

/// What the source's records are decoded from: the message class of each; empty for a placeholder.
[[nodiscard]] std::string_view messageClassOf(const CategorySource& source);

/// The records that the source's screen shows, one a section; none for a placeholder, and for a kind of metric that has
/// not come.
[[nodiscard]] RecordList shownRecords(const CategorySource& source, const Stores& stores);

/// Whether that record of the source's metric changed what the source shows: a list stays where a record has none.
[[nodiscard]] bool isFilledBy(const CategorySource& source, const Record& record);

/// False while no metric has filled the source's list, which then has nothing or only what stands in for an element.
/// True for a source that is no list.
[[nodiscard]] bool isListFilled(const CategorySource& source, const Stores& stores);

}  // namespace vesk
