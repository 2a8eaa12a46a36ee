#pragma once

#include <optional>
#include <string_view>

#include "toolkit/responder.h"
#include "toolkit/system_appearance.h"
#include "values/text.h"

namespace vesk {

class InterfaceLayout;
class NavigationController;
class ViewController;

/// A change from one screen to another, about to happen.
struct Transition {
  std::string_view identifier;
  ViewController& source;
  /// New, and not loaded yet: what is set on it now is there when its view loads.
  ViewController& destination;
};

/// One screen. Main queue only.
class ViewController : public Responder {
 public:
  /// Loads the view, once: the first call runs viewDidLoad.
  virtual void loadViewIfNeeded();
  [[nodiscard]] bool isViewLoaded() const { return isViewLoaded_; }

  /// The view has loaded. An override calls the base's first.
  virtual void viewDidLoad() {}
  /// The screen left the navigation stack for good: the place to stop timers.
  virtual void didLeaveNavigationStack() {}
  /// Memory is short. An override calls the base's.
  virtual void didReceiveMemoryWarning() {}
  /// The place to hand the destination what it needs. `sender` is what started the transition, often a
  /// TableViewCell; null when nothing did.
  virtual void prepareForTransition(const Transition& transition, Responder* sender);

  /// Makes the destination that the interface layout declares for `identifier`, prepares and pushes it. A
  /// destination without a title takes the main text of the cell that sent it there. False when the layout
  /// declares no such transition or the screen is on no navigation stack.
  bool performTransition(std::string_view identifier, Responder* sender);

  /// The name on the way to this screen.
  [[nodiscard]] const std::optional<Text>& title() const { return title_; }
  void setTitle(std::optional<Text> title) { title_ = std::move(title); }
  /// Absent: the toolkit's own.
  [[nodiscard]] std::optional<Color> backgroundColor() const { return backgroundColor_; }
  void setBackgroundColor(std::optional<Color> color) { backgroundColor_ = color; }

  /// What the screen shows is not what it should show any more. Said for a screen whose table was reloaded.
  void setNeedsDisplay();

  /// The stack that the screen is on; null when on none.
  [[nodiscard]] NavigationController* navigationController() const { return navigationController_; }
  /// The layout that the screen was made from and its name there; null and empty for one made by hand.
  [[nodiscard]] const InterfaceLayout* interfaceLayout() const { return layout_; }
  [[nodiscard]] std::string_view nameInLayout() const { return nameInLayout_; }

 protected:
  friend class InterfaceLayout;
  friend class NavigationController;

  /// The layout made this screen and will outlive it. An override calls the base's.
  virtual void wasMade(const InterfaceLayout& layout, std::string_view name);

 private:
  bool isViewLoaded_ = false;
  std::optional<Text> title_;
  std::optional<Color> backgroundColor_;
  NavigationController* navigationController_ = nullptr;
  const InterfaceLayout* layout_ = nullptr;
  std::string_view nameInLayout_;
};

}  // namespace vesk
