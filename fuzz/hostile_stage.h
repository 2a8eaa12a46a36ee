#pragma once

#include <cstdlib>
#include <string>

#include "app/connected_program.h"
#include "hostile_recording.h"
#include "property.h"
#include "shrinking_screen.h"
#include "support/pictures.h"
#include "terminal/device/capabilities.h"
#include "terminal/view/diagnostic_lines.h"
#include "toolkit/table_view_controller.h"

namespace vesk {

/// The program's screens over stores and diagnostic lines that hostile events have filled.
class HostileStage {
 public:
  HostileStage() {
    setenv("TERM", "xterm-256color", 1);
    std::string reason;
    auto capabilities = readCapabilities(STDOUT_FILENO, kHasUtf8Locale, reason);
    require(capabilities.has_value(), "there is an xterm");
    terminal_ = std::move(*capabilities);
    OutputLines::setSink(std::make_unique<DiagnosticSink>(lines_));
    for (const auto& [metricId, payload] : hostileEvents())
      program_.raise(metricId, payload.bytes());
    program_.deliverAll();
    filled_ = program_.intake->stores;
    stack_->loadViewIfNeeded();
  }

  [[nodiscard]] NavigationController& stack() { return *stack_; }
  [[nodiscard]] const Capabilities& terminal() const { return terminal_; }
  [[nodiscard]] Surroundings surroundings() {
    Surroundings surroundings;
    surroundings.diagnostics = &lines_;
    return surroundings;
  }

  /// Goes on to the next category of all areas.
  void openNextScreen() {
    leave();
    top().selectRow({0, area_});
    top().selectRow({0, category_});
    whole_ = picture();
    const auto& menu = dynamic_cast<TableViewController&>(*stack_->stack()[1]).tableView();
    if (++category_ < menu.numberOfRows(0)) return;
    category_ = 0;
    const auto& areas = dynamic_cast<TableViewController&>(*stack_->stack()[0]).tableView();
    area_ = (area_ + 1) % areas.numberOfRows(0);
  }

  static void shrink() { ShrinkingScreen::isShrinking = true; }

  /// Fills the stores again; what was opened then looks as it did.
  void leave() {
    ShrinkingScreen::isShrinking = false;
    program_.intake->stores = filled_;
    if (stack_->stack().size() == 3) {
      top().tableView().reloadData();
      require(picture() == whole_, "a store that is filled again is shown as before");
    }
    stack_->popToDepth(1);
  }

 private:
  TableViewController& top() { return dynamic_cast<TableViewController&>(*stack_->topViewController()); }
  std::string picture() { return Desk(*stack_, {60, 20}).picture(); }

  DiagnosticLines lines_;
  Capabilities terminal_;
  ConnectedProgram program_;
  Stores filled_;
  const InterfaceLayout layout_ = shrinkingInterface();
  const std::shared_ptr<NavigationController> stack_ = layout_.makeRootStack();
  std::size_t area_ = 0;
  std::size_t category_ = 0;
  std::string whole_;
};

}  // namespace vesk
