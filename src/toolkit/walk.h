#pragma once

#include <optional>
#include <string_view>
#include <vector>

#include "toolkit/navigation_controller.h"
#include "toolkit/table_view_controller.h"
#include "values/text.h"

/// Walking the table screens of a stack by the labels of their rows, and reading what the top one shows: for whoever
/// prints screens and does not draw them.
namespace vesk {

struct ShownRow {
  std::optional<Text> key;
  std::optional<Text> value;
};

struct ShownSection {
  std::optional<Text> header;
  std::vector<ShownRow> rows;
};

/// The screen that shows; every screen of the stack must be a table.
[[nodiscard]] TableViewController& topTable(const NavigationController& stack);

/// Goes on from the top screen by the first row with that label, as its user would. False when there is none.
bool openRow(const NavigationController& stack, std::string_view label);

[[nodiscard]] std::vector<ShownSection> sectionsOf(TableView& table);

}  // namespace vesk
