#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "app/program/app_delegate.h"
#include "app/program/vesk_interface.h"
#include "corvik/service.h"
#include "intake/metric_validator.h"
#include "link/corvik_wrapper.h"
#include "system/run_loop.h"
#include "values/text_form.h"

namespace vesk {

using Lines = std::vector<std::string>;

/// Notes the commands it executes or refuses, and lets the test raise events.
class NotingService : public corvik::Service {
 public:
  corvik::Result perform(const Text& command, const InterProcessDictionary& message) override {
    if (notes != nullptr) notes->push_back(std::string(command.view()) + ' ' + textOf(message.ordinary().value()));
    return Service::perform(command, message);
  }

  Lines* notes = nullptr;
  corvik::EventStream* events = nullptr;

 private:
  void start(corvik::EventStream& stream) override { events = &stream; }
  void stop() override { events = nullptr; }
  corvik::Result answer(const corvik::MetricQuery&, corvik::EventStream&) override { return {}; }
};

/// The process's link and intake, made over a service of the test's.
struct ProcessConnection {
  ProcessConnection() {
    corvik::installService(service);
    MetricValidator::shared();
  }

  std::shared_ptr<NotingService> service = std::make_shared<NotingService>();

  static ProcessConnection& shared() {
    static ProcessConnection theConnection;
    return theConnection;
  }
};

/// The whole program in this process, over a service of the test's. The link and the intake are the process's, and stay
/// connected to that service; each of these starts with empty stores.
class ConnectedProgram {
 public:
  ConnectedProgram() { intake->stores = {}; }
  ConnectedProgram(const ConnectedProgram&) = delete;
  ConnectedProgram& operator=(const ConnectedProgram&) = delete;
  ~ConnectedProgram() {
    deliverAll();
    service.refuseAll(std::nullopt);
  }

  /// Its exit status; `use` is what its user does between launch and end.
  int run(const std::function<void(NavigationController& root)>& use) {
    return Application(veskInterface(), delegate_).run(use);
  }

  [[nodiscard]] const Window& window() const { return *delegate_.window(); }

  void raise(std::int64_t metricId, std::span<const std::uint8_t> payload) {
    service.events->raise(corvik::kEventMetric, corvik::makeMetricEvent(metricId, payload));
  }
  /// Runs until everything raised before is in the stores.
  void deliverAll() {
    service.events->afterDelivery([this] { loop_.stop(); });
    loop_.run();
  }

  NotingService& service = *ProcessConnection::shared().service;
  const std::shared_ptr<MetricValidator>& intake = MetricValidator::shared();

 private:
  const SteadyClock clock_;
  RunLoop loop_{clock_};
  AppDelegate delegate_;
};

}  // namespace vesk
