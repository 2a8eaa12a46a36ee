#include "toolkit/interface_layout.h"

#include <algorithm>

namespace vesk {

namespace {

template <class Row, class Predicate>
const Row* findRow(const std::vector<Row>& table, Predicate predicate) {
  const auto found = std::find_if(table.begin(), table.end(), predicate);
  return found != table.end() ? &*found : nullptr;
}

}  // namespace

std::shared_ptr<NavigationController> InterfaceLayout::makeRootStack() const {
  std::shared_ptr<NavigationController> stack = tables_.rootStack();
  if (const std::shared_ptr<ViewController> first = makeScreen(tables_.firstScreen)) stack->push(first);
  return stack;
}

std::shared_ptr<ViewController> InterfaceLayout::makeScreen(std::string_view name) const {
  const auto* declared = findRow(tables_.screens, [&](const ScreenDeclaration& each) { return each.name == name; });
  if (declared == nullptr) return nullptr;
  std::shared_ptr<ViewController> screen = declared->make();
  screen->wasMade(*this, declared->name);
  if (!declared->title.empty()) screen->setTitle(Text::copy(declared->title));
  return screen;
}

const TransitionDeclaration* InterfaceLayout::transition(std::string_view from, std::string_view identifier) const {
  return findRow(tables_.transitions,
                 [&](const TransitionDeclaration& each) { return each.from == from && each.identifier == identifier; });
}

const TransitionDeclaration* InterfaceLayout::firstTransition(std::string_view from) const {
  return findRow(tables_.transitions, [&](const TransitionDeclaration& each) { return each.from == from; });
}

}  // namespace vesk
