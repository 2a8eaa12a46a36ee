#pragma once

#include <functional>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "corvik/service.h"
#include "recording/record_file.h"

namespace vesk {

/// A service that does what another does, and keeps the metrics that come of it as a recording.
class RecordingService final : public corvik::Service, private corvik::EventStream {
 public:
  /// Called on the main queue, once.
  using FailureHandler = std::function<void(const std::string& reason)>;

  /// `seconds` tells how far the service's own time has come, from any thread.
  RecordingService(std::shared_ptr<corvik::Service> service, std::unique_ptr<RecordFile> file,
                   std::function<double()> seconds, FailureHandler onFailure);
  ~RecordingService() override { service_->shutDown(); }
  RecordingService(const RecordingService&) = delete;
  RecordingService& operator=(const RecordingService&) = delete;

  [[nodiscard]] corvik::Result perform(const Text& command, const InterProcessDictionary& message) override;

 private:
  void start(corvik::EventStream& events) override;
  void stop() override;
  [[nodiscard]] corvik::Result answer(const corvik::MetricQuery& query, corvik::EventStream& events) override;

  void raise(const Text& event, InterProcessDictionary message) override;
  void deliver(const Text& event, InterProcessDictionary message) override;
  void afterDelivery(Task task) override;
  [[nodiscard]] bool waitUntilWanted(const std::stop_token& stop) override;

  void record(const Text& event, const InterProcessDictionary& message);

  std::shared_ptr<corvik::Service> service_;
  std::unique_ptr<RecordFile> file_;
  std::function<double()> seconds_;
  FailureHandler onFailure_;
  corvik::EventStream* client_ = nullptr;

  /// Guards what lies below it: events come from the service's thread, and answers from the main one.
  std::mutex mutex_;
  /// Of the last event; absent before the first.
  std::optional<double> last_;
  double at_ = 0;
  std::string line_;
};

}  // namespace vesk
