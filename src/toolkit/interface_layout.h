#pragma once

#include <memory>
#include <span>
#include <string_view>
#include <vector>

#include "toolkit/navigation_controller.h"
#include "toolkit/table_view.h"
#include "toolkit/view_controller.h"

namespace vesk {

/// A screen that a layout can make.
struct ScreenDeclaration {
  std::string_view name;
  std::shared_ptr<ViewController> (*make)();
  /// Empty: the screen takes the text of the cell that led to it.
  std::string_view title;
};

/// Selecting a row of a screen runs the first transition that is declared from it.
struct TransitionDeclaration {
  std::string_view from;
  std::string_view identifier;
  std::string_view to;
};

/// `makeScreenOf<LaunchScreen>` is what a declaration takes as its `make`.
template <class Screen>
std::shared_ptr<ViewController> makeScreenOf() {
  return std::make_shared<Screen>();
}
template <class Stack>
std::shared_ptr<NavigationController> makeStackOf() {
  return std::make_shared<Stack>();
}

/// The tables that an interface is built from: which stack is the root, which screens there are, how their
/// cells look and how one leads to another. The layout outlives every screen that it makes.
///
///     const InterfaceLayout layout({
///         .rootStack = makeStackOf<RootStack>,
///         .firstScreen = "Launch",
///         .screens = {{"Launch", makeScreenOf<LaunchScreen>, "Start"}},
///         .cells = {{"LaunchView", CellStyle::Basic, CellAccessory::Disclosure}},
///         .transitions = {{"Launch", "showList", "List"}},
///     });
class InterfaceLayout {
 public:
  struct Tables {
    std::shared_ptr<NavigationController> (*rootStack)();
    std::string_view firstScreen;
    std::vector<ScreenDeclaration> screens;
    std::vector<CellDeclaration> cells;
    std::vector<TransitionDeclaration> transitions;
  };

  explicit InterfaceLayout(Tables tables) : tables_(std::move(tables)) {}
  InterfaceLayout(const InterfaceLayout&) = delete;
  InterfaceLayout& operator=(const InterfaceLayout&) = delete;

  /// The root stack with the first screen on it; nothing is loaded yet.
  [[nodiscard]] std::shared_ptr<NavigationController> makeRootStack() const;
  /// The screen that stands first on the root stack, for another stack to walk from.
  [[nodiscard]] std::shared_ptr<ViewController> makeFirstScreen() const { return makeScreen(tables_.firstScreen); }
  /// A new screen; null for a name that is not declared.
  [[nodiscard]] std::shared_ptr<ViewController> makeScreen(std::string_view name) const;

  [[nodiscard]] std::span<const CellDeclaration> cells() const { return tables_.cells; }
  /// The transition of that name from a screen, or the first one declared; null where there is none.
  [[nodiscard]] const TransitionDeclaration* transition(std::string_view from, std::string_view identifier) const;
  [[nodiscard]] const TransitionDeclaration* firstTransition(std::string_view from) const;

 private:
  Tables tables_;
};

}  // namespace vesk
