#pragma once

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string_view>
#include <utility>

#include "intake/date_format.h"
#include "intake/technology_stores.h"
#include "link/corvik_wrapper.h"
#include "messages/registry/metric_identifiers.h"
#include "values/value.h"

namespace vesk {

/// Takes in every metric event: decodes it, keeps it as the latest record of its kind, and fills the technology
/// stores. The one object of the process is shared(); everything happens on the main queue. Whoever shows the stores
/// reads them here.
class MetricValidator : public CorvikWrapperDelegate {
 public:
  /// The latest record of a kind of metric; absent until the first one.
  using LatestRecord = std::optional<Dictionary>;

  /// The one of the process. Made on the first call; it then listens to the shared wrapper and is its delegate.
  static const std::shared_ptr<MetricValidator>& shared();
  /// Another one, which listens to `wrapper` (null for none) and becomes its delegate: for tests.
  static std::shared_ptr<MetricValidator> listeningTo(std::shared_ptr<CorvikWrapper> wrapper);

  void metricsDidUpdate(const std::optional<Dictionary>& event) override;
  void eventsDidUpdate(const std::optional<Dictionary>& event) override;

  /// `observer` is told of every metric that was stored; for whoever wants to know when, which no store tells.
  void setArrivalObserver(std::function<void(std::int64_t metricId)> observer) {
    arrivalObserver_ = std::move(observer);
  }

  /// Decodes and stores the event. False, with nothing stored, for a metric that is not handled and for a payload that
  /// cannot be decoded.
  bool validateMetric(const Dictionary& event);

  /// Turns the record's "timestamp", milliseconds since 1970-01-01 00:00:00 UTC, into a date in words. One that is
  /// missing or no number stays as it is.
  void formatTimestampOf(Record& record);

  [[nodiscard]] const std::shared_ptr<CorvikWrapper>& sharedCorvikInstance() const { return mySharedCorvikInstance; }

  /// The metric identifier of the latest event; absent when it had none.
  std::optional<std::int64_t> metricID;

  LTE myLTE;
  UMTS myUMTS;
  GSM myGSM;
  Common myCommon;

  LatestRecord myLTERRCStateDict;
  LatestRecord myLTECDRXConfigDict;
  LatestRecord myLTESCellInfoDict;
  /// Stays absent: its metric is not handled.
  LatestRecord myLTESCellMeasDict;
  LatestRecord myLTESelReselDict;
  LatestRecord myLTERsrpRsrqSinrDict;
  LatestRecord myLTECompCarrDict;
  LatestRecord myLTETxPowerDict;
  LatestRecord myLTEInterRatMeasDict;
  LatestRecord myLTEIntraRatMeasDict;
  LatestRecord myLTECAStatusDict;
  LatestRecord myLTEEMMContextDict;
  LatestRecord myCellularMMCommonInfoDict;
  LatestRecord myCellularActiveBearerDict;
  LatestRecord myGMMContextDict;
  LatestRecord myMMContextDict;
  LatestRecord myUMTSRRCStateDict;
  LatestRecord myUMTSRRCConfigDict;
  LatestRecord myUMTSCellInfoDict;
  LatestRecord myUMTSCellMeasDict;
  LatestRecord myUMTSTxPowerDict;
  LatestRecord myUMTSSelReselDict;
  LatestRecord myUMTSNbrMeasDict;
  LatestRecord myGSMScellInfoDict;
  LatestRecord myGSMIdleConfigInfoDict;
  LatestRecord myGSMIdleScellMeasDict;
  LatestRecord myGSMConnRfMeasDict;
  LatestRecord myGSMNbrMeasDict;
  LatestRecord myGSMGPRSConfigDict;
  LatestRecord mySIMFileInfoDict;

 private:
  MetricValidator() = default;

  std::shared_ptr<CorvikWrapper> mySharedCorvikInstance;
  DateFormat dateFormat_;
  /// The date written last, kept for its storage.
  std::string date_;
  std::function<void(std::int64_t)> arrivalObserver_;
};

/// The names of the latest records and where they are, in the order of their declaration.
inline constexpr std::array<std::pair<std::string_view, MetricValidator::LatestRecord MetricValidator::*>, 30>
    kLatestRecords{{
        {"myLTERRCStateDict", &MetricValidator::myLTERRCStateDict},
        {"myLTECDRXConfigDict", &MetricValidator::myLTECDRXConfigDict},
        {"myLTESCellInfoDict", &MetricValidator::myLTESCellInfoDict},
        {"myLTESCellMeasDict", &MetricValidator::myLTESCellMeasDict},
        {"myLTESelReselDict", &MetricValidator::myLTESelReselDict},
        {"myLTERsrpRsrqSinrDict", &MetricValidator::myLTERsrpRsrqSinrDict},
        {"myLTECompCarrDict", &MetricValidator::myLTECompCarrDict},
        {"myLTETxPowerDict", &MetricValidator::myLTETxPowerDict},
        {"myLTEInterRatMeasDict", &MetricValidator::myLTEInterRatMeasDict},
        {"myLTEIntraRatMeasDict", &MetricValidator::myLTEIntraRatMeasDict},
        {"myLTECAStatusDict", &MetricValidator::myLTECAStatusDict},
        {"myLTEEMMContextDict", &MetricValidator::myLTEEMMContextDict},
        {"myCellularMMCommonInfoDict", &MetricValidator::myCellularMMCommonInfoDict},
        {"myCellularActiveBearerDict", &MetricValidator::myCellularActiveBearerDict},
        {"myGMMContextDict", &MetricValidator::myGMMContextDict},
        {"myMMContextDict", &MetricValidator::myMMContextDict},
        {"myUMTSRRCStateDict", &MetricValidator::myUMTSRRCStateDict},
        {"myUMTSRRCConfigDict", &MetricValidator::myUMTSRRCConfigDict},
        {"myUMTSCellInfoDict", &MetricValidator::myUMTSCellInfoDict},
        {"myUMTSCellMeasDict", &MetricValidator::myUMTSCellMeasDict},
        {"myUMTSTxPowerDict", &MetricValidator::myUMTSTxPowerDict},
        {"myUMTSSelReselDict", &MetricValidator::myUMTSSelReselDict},
        {"myUMTSNbrMeasDict", &MetricValidator::myUMTSNbrMeasDict},
        {"myGSMScellInfoDict", &MetricValidator::myGSMScellInfoDict},
        {"myGSMIdleConfigInfoDict", &MetricValidator::myGSMIdleConfigInfoDict},
        {"myGSMIdleScellMeasDict", &MetricValidator::myGSMIdleScellMeasDict},
        {"myGSMConnRfMeasDict", &MetricValidator::myGSMConnRfMeasDict},
        {"myGSMNbrMeasDict", &MetricValidator::myGSMNbrMeasDict},
        {"myGSMGPRSConfigDict", &MetricValidator::myGSMGPRSConfigDict},
        {"mySIMFileInfoDict", &MetricValidator::mySIMFileInfoDict},
    }};

}  // namespace vesk
