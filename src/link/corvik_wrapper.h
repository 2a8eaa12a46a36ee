#pragma once

#include <atomic>
#include <cstdint>
#include <memory>
#include <string>
#include <string_view>

#include "corvik/client.h"
#include "link/corvik_wrapper_delegate.h"
#include "system/work_queue.h"

namespace vesk {

/// The program's only connection to the baseband manager service: sends commands, and forwards each event to
/// its delegate on the main queue. Operations are for the main queue.
///
/// Commands are sent only for the application identifier "vesk", and are false at once for any other. The
/// outcome of one that was sent goes to the system log; true means that the service accepted it.
class CorvikWrapper : public std::enable_shared_from_this<CorvikWrapper> {
 public:
  /// The wrapper of the process, made on first call, which connects to the service installed then.
  static std::shared_ptr<CorvikWrapper> sharedInstance();
  /// The serial queue in whose turn the client library delivers events, one for the process.
  static WorkQueue& queue();

  /// One that connects to the service installed now. Once nobody holds it, it ends on the main queue, behind the events
  /// that it has scheduled there; that of the process at the queue's own end, before which the service must be shut
  /// down.
  static std::shared_ptr<CorvikWrapper> make();
  CorvikWrapper(const CorvikWrapper&) = delete;
  CorvikWrapper& operator=(const CorvikWrapper&) = delete;

  /// Sends the content of the file at `protofFilePath` as the metric configuration. False, and nothing sent,
  /// when it cannot be read.
  bool addQuodraConfigForAppId(std::string_view appId, const std::string& protofFilePath);
  bool removeQuodraConfigForAppid(std::string_view appId);
  /// Asks for one metric, which comes as an event.
  bool querySpecificMetric(std::string_view appId, std::int32_t triggerRef, std::int32_t triggerType,
                           std::int32_t triggerId, std::int32_t profileId, std::int32_t metricId);

  /// Registers for metric and trigger events, and switches them off and on.
  void listen();

  /// Null when there is none, or none any more.
  [[nodiscard]] std::shared_ptr<CorvikWrapperDelegate> delegate() const { return delegate_.lock(); }
  /// Held weakly. Without a delegate events are dropped.
  void setDelegate(std::weak_ptr<CorvikWrapperDelegate> delegate);

 private:
  using Deliver = void (CorvikWrapperDelegate::*)(const std::optional<Dictionary>& event);

  CorvikWrapper();

  bool perform(const char* operation, const Text& command, const InterProcessDictionary& message);
  /// Has the events called `event` forwarded by `deliver`; `label` is what the log calls them.
  void forward(const Text& event, const char* label, Deliver deliver);
  void forward(const InterProcessDictionary& event, const char* label, Deliver deliver);

  std::shared_ptr<corvik::client::Manager> corvikManager_;
  std::weak_ptr<CorvikWrapperDelegate> delegate_;
  /// What the handlers ask, on whatever thread they run; the delegate may have gone since.
  std::atomic<bool> isDelegateSet_ = false;
};

}  // namespace vesk
