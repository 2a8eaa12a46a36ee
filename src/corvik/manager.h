#pragma once

#include <memory>
#include <string>

#include "corvik/channel.h"
#include "corvik/service.h"

namespace corvik::client {

/// One client's connection to a service, for as long as it lives. On the main thread, where it must also end:
/// the service's source has then ended too.
class Manager {
 public:
  /// `service` may be null: every command then fails.
  Manager(std::string name, vesk::WorkQueue& queue, std::shared_ptr<Service> service);
  ~Manager();
  Manager(const Manager&) = delete;
  Manager& operator=(const Manager&) = delete;

  [[nodiscard]] Result perform(const vesk::Text& command, const vesk::InterProcessDictionary& message);
  [[nodiscard]] Channel& channel() { return *channel_; }

 private:
  std::string name_;
  std::shared_ptr<Service> service_;
  /// Deliveries under way hold it too, but never the manager.
  std::shared_ptr<Channel> channel_;
};

}  // namespace corvik::client
