#include "toolkit/walk.h"

namespace vesk {

TableViewController& topTable(const NavigationController& stack) {
  return dynamic_cast<TableViewController&>(*stack.topViewController());
}

bool openRow(const NavigationController& stack, std::string_view label) {
  TableViewController& screen = topTable(stack);
  for (std::size_t row = 0; row < screen.tableView().numberOfRows(0); ++row) {
    const TableViewCell* cell = screen.tableView().cellForRow({0, row});
    if (cell != nullptr && cell->mainText() == std::optional(Text::copy(label))) return screen.selectRow({0, row});
  }
  return false;
}

std::vector<ShownSection> sectionsOf(TableView& table) {
  std::vector<ShownSection> sections;
  for (std::size_t section = 0; section < table.numberOfSections(); ++section) {
    ShownSection& shown = sections.emplace_back(ShownSection{table.headerTitle(section), {}});
    for (std::size_t row = 0; row < table.numberOfRows(section); ++row) {
      const TableViewCell* cell = table.cellForRow({section, row});
      shown.rows.push_back(cell == nullptr ? ShownRow{} : ShownRow{cell->mainText(), cell->detailText()});
    }
  }
  return sections;
}

}  // namespace vesk
