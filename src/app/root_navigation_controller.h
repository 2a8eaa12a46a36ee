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
  static constexpr std::string_view myAppID = "vesk";
  /// The resource that holds the metric configuration.
  static constexpr std::string_view metricFileName = "ice_test_lte";
  static constexpr std::string_view metricFileType = "deviceconfig";

  void viewDidLoad() override;

 private:
  void startMetrics();

  const std::shared_ptr<CorvikWrapper> myCorvikWrapper = CorvikWrapper::sharedInstance();
  const std::shared_ptr<MetricValidator> myMetricValidator = MetricValidator::shared();
};

}  // namespace vesk
