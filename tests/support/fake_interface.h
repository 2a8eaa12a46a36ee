#pragma once

#include <memory>

#include "support/fake_table_screen.h"
#include "toolkit/interface_layout.h"

namespace vesk {

/// The screens of FakeInterface, told apart by the identifiers of their cells.
class FakeAreas : public FakeTableScreen {
 public:
  FakeAreas() {
    identifier = "LaunchView";
    content = {{std::nullopt, {{"Device Info"_text, {}}, {"LTE"_text, {}}, {"UMTS"_text, {}}, {"GSM"_text, {}}}}};
  }
};

class FakeCategories : public FakeTableScreen {
 public:
  FakeCategories() {
    identifier = "FirstClickView";
    content = {{std::nullopt, {}}};
    for (const char* name : {"NAS", "RRC State", "Serving Cell Info", "Serving Cell Meas", "Tx Power",
                             "Sel Resel Parameters", "EUTRA Neighbor Info", "C-DRX", "LTE Neighbor Cell Meas"}) {
      content[0].rows.push_back({Text::copy(name), {}});
    }
  }
};

/// Areas, then categories, then fields: a stack of fake screens that selecting rows walks through.
class FakeInterface {
 public:
  FakeInterface()
      : layout_({
            .rootStack = makeStackOf<NavigationController>,
            .firstScreen = "Areas",
            .screens = {{"Areas", makeScreenOf<FakeAreas>, "Vesk"},
                        {"Categories", makeScreenOf<FakeCategories>, ""},
                        {"Fields", makeScreenOf<FakeTableScreen>, ""}},
            .cells = {{"LaunchView", CellStyle::Basic, CellAccessory::Disclosure},
                      {"FirstClickView", CellStyle::Basic, CellAccessory::Disclosure}},
            .transitions = {{"Areas", "showArea", "Categories"}, {"Categories", "showCategory", "Fields"}},
        }),
        stack_(layout_.makeRootStack()) {
    stack_->loadViewIfNeeded();
  }

  [[nodiscard]] const InterfaceLayout& layout() const { return layout_; }
  [[nodiscard]] NavigationController& stack() { return *stack_; }
  [[nodiscard]] FakeTableScreen& top() { return dynamic_cast<FakeTableScreen&>(*stack_->stack().back()); }

  /// Walks to the fields of a category of the second area and fills them.
  FakeTableScreen& showFields(std::size_t category, std::vector<FakeTableScreen::Section> content) {
    top().selectRow({0, 1});
    top().selectRow({0, category});
    FakeTableScreen& fields = top();
    fields.content = std::move(content);
    fields.tableView().reloadData();
    return fields;
  }

 private:
  InterfaceLayout layout_;
  std::shared_ptr<NavigationController> stack_;
};

}  // namespace vesk
