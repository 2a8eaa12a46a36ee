#pragma once

#include <functional>
#include <memory>
#include <string>

#include "corvik/constants.h"
#include "corvik/inter_process_dictionary.h"
#include "corvik/service.h"
#include "system/work_queue.h"

/// The client library of the baseband manager service, under the library's own names. It stands in for the
/// library where there is none: behind it is whatever service the program has installed.
namespace corvik::client {

class Manager;

/// Lets a handler tell the library of work that it leaves unfinished. Nothing here waits for such work.
class WorkGroup {};

using EventHandler = std::function<void(const vesk::InterProcessDictionary& event, const WorkGroup& group)>;

// NOLINTBEGIN(readability-identifier-naming): the library's own names

/// A manager for the client called `name`, connected to the installed service, whose events it delivers in the turn of
/// `queue`, on the queue's thread or on the service's. The queue must outlive the manager.
[[nodiscard]] std::shared_ptr<Manager> CreateManager(const std::string& name, vesk::WorkQueue& queue);

/// Sends one command and waits for its outcome. `reply` is left as it is: this service has none.
[[nodiscard]] Result PerformCommand(const std::shared_ptr<Manager>& manager, const vesk::Text& command,
                                    const vesk::InterProcessDictionary& message, vesk::InterProcessDictionary& reply);

/// Has `handler` called with each event of the name `event`, in the place of the handler registered before, which may
/// be running and so is kept as long as the manager.
void RegisterEventHandler(const std::shared_ptr<Manager>& manager, const vesk::Text& event, EventHandler handler);

/// Stops and starts the delivery of events: off at first. Those raised while it is off are delivered when it
/// is on again.
void EventsOff(const std::shared_ptr<Manager>& manager);
void EventsOn(const std::shared_ptr<Manager>& manager);

// NOLINTEND(readability-identifier-naming)

}  // namespace corvik::client
