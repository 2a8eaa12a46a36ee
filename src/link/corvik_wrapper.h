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

/// The program's only connection to the baseband manager service. It sends commands to the service, and hands each
/// event to its delegate on the main queue. Call it on the main queue only.
///
/// A command answers true when the service has accepted it; the outcome is logged. For any application identifier but
/// "vesk" it sends nothing and answers false.
class CorvikWrapper : public std::enable_shared_from_this<CorvikWrapper> {
 public:
  /// The wrapper of the process, made on first call, which connects to the service installed then.
  static std::shared_ptr<CorvikWrapper> sharedInstance();
  /// The serial queue on which the client library delivers events. There is one for the process.
  static WorkQueue& queue();

  /// A wrapper that connects to the service installed now. When its last owner lets go, it is destroyed on the main
  /// queue, behind the events that it has posted there. The wrapper of the process is destroyed with the queue itself:
  /// shut the service down before.
  static std::shared_ptr<CorvikWrapper> make();
  CorvikWrapper(const CorvikWrapper&) = delete;
  CorvikWrapper& operator=(const CorvikWrapper&) = delete;

  /// Sends the file at `protofFilePath` as the metric configuration. When it cannot be read, sends nothing and answers
  /// false.
  bool addQuodraConfigForAppId(std::string_view appId, const std::string& protofFilePath);
  bool removeQuodraConfigForAppid(std::string_view appId);
  /// Asks for one metric. The answer comes as an event.
  bool querySpecificMetric(std::string_view appId, std::int32_t triggerRef, std::int32_t triggerType,
                           std::int32_t triggerId, std::int32_t profileId, std::int32_t metricId);

  /// Registers for metric and trigger events, then switches events off and on.
  void listen();

  /// Null when none was set, or when it is gone.
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
  /// Read by the handlers, on any thread. The delegate may be gone by then.
  std::atomic<bool> isDelegateSet_ = false;
};

}  // namespace vesk
