#include "corvik/client.h"

#include <utility>

#include "corvik/manager.h"

namespace corvik::client {

// NOLINTBEGIN(readability-identifier-naming): the library's own names

std::shared_ptr<Manager> CreateManager(const std::string& name, vesk::WorkQueue& queue) {
  return std::make_shared<Manager>(name, queue, installedService());
}

Result PerformCommand(const std::shared_ptr<Manager>& manager, const vesk::Text& command,
                      const vesk::InterProcessDictionary& message,
                      [[maybe_unused]] vesk::InterProcessDictionary& reply) {
  return manager->perform(command, message);
}

void RegisterEventHandler(const std::shared_ptr<Manager>& manager, const vesk::Text& event, EventHandler handler) {
  manager->channel().setHandler(event, std::move(handler));
}

void EventsOff(const std::shared_ptr<Manager>& manager) {
  manager->channel().setEventsOn(false);
}

void EventsOn(const std::shared_ptr<Manager>& manager) {
  manager->channel().setEventsOn(true);
}

// NOLINTEND(readability-identifier-naming)

}  // namespace corvik::client
