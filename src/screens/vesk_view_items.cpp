#include "screens/vesk_view_items.h"

#include "screens/category_sources.h"

namespace vesk {

VeskViewItems::VeskViewItems() {
  for (const CategorySource& source : categorySources()) {
    std::vector<Text>& categories = firstLevelViewItems[source.area];
    if (categories.empty()) launchViewItemNames.push_back(Text::copy(source.area));
    categories.push_back(Text::copy(source.category));
  }
}

const std::vector<Text>& VeskViewItems::categoriesOf(std::string_view area) const {
  static const std::vector<Text> kNone;
  const auto found = firstLevelViewItems.find(area);
  return found == firstLevelViewItems.end() ? kNone : found->second;
}

const VeskViewItems& VeskViewItems::shared() {
  static const VeskViewItems theItems;
  return theItems;
}

}  // namespace vesk
