#pragma once

#include <map>
#include <string_view>
#include <vector>

#include "values/text.h"

namespace vesk {

/// The menu: the areas, and the categories of each, in the order in which they are shown. The labels are also what a
/// selection is known by. A plain value; every copy is alike.
struct VeskViewItems {
  VeskViewItems();

  std::vector<Text> launchViewItemNames;
  std::map<std::string_view, std::vector<Text>> firstLevelViewItems;

  /// The categories of an area; none of one that does not exist.
  [[nodiscard]] const std::vector<Text>& categoriesOf(std::string_view area) const;

  /// The one of the process, for the launch screen.
  static const VeskViewItems& shared();
};

}  // namespace vesk
