#include "toolkit/view_controller.h"

#include <memory>

#include "toolkit/interface_layout.h"
#include "toolkit/navigation_controller.h"
#include "toolkit/table_view_cell.h"

namespace vesk {

void ViewController::loadViewIfNeeded() {
  if (isViewLoaded_) return;
  isViewLoaded_ = true;
  viewDidLoad();
}

void ViewController::prepareForTransition(const Transition& /*transition*/, Responder* /*sender*/) {}

bool ViewController::performTransition(std::string_view identifier, Responder* sender) {
  if (layout_ == nullptr || navigationController_ == nullptr) return false;
  const TransitionDeclaration* declared = layout_->transition(nameInLayout_, identifier);
  if (declared == nullptr) return false;
  const std::shared_ptr<ViewController> destination = layout_->makeScreen(declared->to);
  if (destination == nullptr) return false;
  prepareForTransition({declared->identifier, *this, *destination}, sender);
  if (const auto* cell = dynamic_cast<const TableViewCell*>(sender); cell != nullptr && !destination->title()) {
    destination->setTitle(cell->mainText());
  }
  navigationController_->push(destination);
  return true;
}

void ViewController::setNeedsDisplay() {
  if (navigationController_ != nullptr) navigationController_->screenNeedsDisplay(*this);
}

void ViewController::wasMade(const InterfaceLayout& layout, std::string_view name) {
  layout_ = &layout;
  nameInLayout_ = name;
}

}  // namespace vesk
