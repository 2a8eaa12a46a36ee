#include "app/program/root_navigation_controller.h"

#include <cstdint>

#include "app/program/bundle.h"
#include "system/output_lines.h"

namespace vesk {

namespace {

/// What the service answers with the SIM files.
constexpr std::int32_t kTriggerRef = 9999;
constexpr std::int32_t kTriggerType = 0;
constexpr std::int32_t kSimFilesTrigger = 0x7F0013;

}  // namespace

void RootNavigationController::viewDidLoad() {
  NavigationController::viewDidLoad();
  startMetrics();
}

void RootNavigationController::startMetrics() {
  if (myCorvikWrapper != nullptr) myCorvikWrapper->removeQuodraConfigForAppid(myAppID);

  const auto path = Bundle::main().pathForResource(metricFileName, metricFileType);
  if (!path) {
    OutputLines::print({"Metric Log File path doesnt exist"});
    return;
  }
  OutputLines::print({"pushing metric file"});
  isConfigurationAccepted_ = myCorvikWrapper != nullptr && myCorvikWrapper->addQuodraConfigForAppId(myAppID, *path);
  if (!isConfigurationAccepted_) return;
  if (const auto& wrapper = myMetricValidator->sharedCorvikInstance()) wrapper->listen();

  OutputLines::print({"Querying SIM files"});
  myCorvikWrapper->querySpecificMetric(myAppID, kTriggerRef, kTriggerType, kSimFilesTrigger, 0, 0);
}

}  // namespace vesk
