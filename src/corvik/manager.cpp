#include "corvik/manager.h"

#include <utility>

namespace corvik::client {

Manager::Manager(std::string name, vesk::WorkQueue& queue, std::shared_ptr<Service> service)
    : name_(std::move(name)), service_(std::move(service)), channel_(std::make_shared<Channel>(queue)) {
  if (service_ != nullptr) service_->connect(*channel_);
}

Manager::~Manager() {
  if (service_ != nullptr) service_->disconnect(*channel_);
  channel_->setEventsOn(false);
}

Result Manager::perform(const vesk::Text& command, const vesk::InterProcessDictionary& message) {
  if (service_ == nullptr) return {kStatusNoService, "no service for the client " + name_};
  Result result = service_->perform(command, message);
  if (result.code == 0 && command == kCommandAddConfiguration) channel_->setConfigured(true);
  if (result.code == 0 && command == kCommandClearConfiguration) channel_->setConfigured(false);
  return result;
}

}  // namespace corvik::client
