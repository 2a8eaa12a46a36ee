#pragma once

#include <memory>
#include <string_view>

#include "intake/metric_validator.h"
#include "link/corvik_wrapper.h"
#include "toolkit/navigation_controller.h"

namespace vesk {

/// The stack that all screens are on. Making it connects the program to the service; loading it pushes the metric
/// configuration and asks once for the SIM files.
class RootNavigationController : public NavigationController {
 public:
  void viewDidLoad() override;

  /// Whether the service took the configuration, which is asked for when the view loads: without it no metric arrives.
  [[nodiscard]] bool isConfigurationAccepted() const { return isConfigurationAccepted_; }

 private:
  void startMetrics();

  static constexpr std::string_view myAppID = "vesk";
  static constexpr std::string_view metricFileName = "ice_test_lte";
  static constexpr std::string_view metricFileType = "deviceconfig";

  const std::shared_ptr<CorvikWrapper> myCorvikWrapper = CorvikWrapper::sharedInstance();
  const std::shared_ptr<MetricValidator> myMetricValidator = MetricValidator::shared();
  bool isConfigurationAccepted_ = false;
};

}  // namespace vesk
