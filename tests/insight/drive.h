#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "insight/insight.h"
#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/registry/metric_of_message.h"
#include "messages/wcdma/wcdma.h"
#include "support/metric_events.h"
#include "system/output_lines.h"

/// Drives made up of a few events, told in the words of the tests.
namespace vesk::insight {

using namespace metrics;

/// 2018-01-20 21:52:40 UTC: the time 0 of the drives.
inline constexpr std::int64_t kStart = 1516485160000;

/// An event of a drive: encoded, with everything but its time.
struct DriveEvent {
  std::int64_t at;
  std::function<Dictionary(std::uint64_t timestamp)> make;
};

/// `fill` sets the fields of the message. Times are milliseconds since kStart.
template <class M, class Fill>
DriveEvent event(std::int64_t at, std::int64_t metricId, Fill fill) {
  return {at, [metricId, fill](std::uint64_t timestamp) {
            M message;
            message.setTimestamp(timestamp);
            fill(message);
            return metricEvent(metricId, message);
          }};
}

using Part = std::optional<std::uint32_t>;

/// `bandwidth` is in units of 0.5 MHz.
inline DriveEvent lteCell(std::int64_t at, Part channel, Part code, Part cellId = {}, Part trackingArea = {},
                          Part bandwidth = {}) {
  return event<KCellularLteScellInfo>(at, K_LTE_SCELL_INFO, [=](auto& message) {
    if (channel) message.setDlFreq(*channel);
    if (code) message.setPhyCellId(*code);
    if (cellId) message.setCellId(*cellId);
    if (bandwidth) message.setDlBw(*bandwidth);
    if (!trackingArea) return;
    message.setTrackingAreaCode(*trackingArea);
    message.setSelPlmnMcc(310);
    message.setSelPlmnMnc(410);
  });
}

inline DriveEvent lteSelection(std::int64_t at, std::int32_t leastLevelCode) {
  return event<KCellularLteSelReselCellInfo>(at, K_LTE_SEL_RESEL_INFO,
                                             [=](auto& message) { message.setQRxLevMin(leastLevelCode); });
}

inline DriveEvent lteRrc(std::int64_t at, LteRrcState state, std::optional<LteRrcCause> cause = {},
                         std::optional<LteRrcState> previous = {}, Part duration = {}) {
  return event<KCellularLteRrcState>(at, K_LTE_RRC_STATE, [=](auto& message) {
    message.setState(state);
    if (cause) message.setCause(*cause);
    if (previous) message.setPrevState(*previous);
    if (duration) message.setPrevStateDurMs(*duration);
  });
}

inline DriveEvent lteLevel(std::int64_t at, std::int32_t rsrp, std::int32_t rsrq = -10, Part code = {}) {
  return event<KCellularLteRsrpRsrqSinr>(at, K_LTE_RSRP_RSRQ_SINR, [=](auto& message) {
    auto sample = std::make_shared<RsrpRsrqSinr>();
    sample->setRsrp0(rsrp);
    sample->setRsrq0(rsrq);
    if (code) sample->setPhyCellId(*code);
    message.addInstValues(sample);
  });
}

struct LteNeighbor {
  Part channel;
  Part code;
  std::int32_t rsrp;
  std::optional<std::int32_t> rsrqCode{};
};

inline DriveEvent lteNeighbors(std::int64_t at, const std::vector<LteNeighbor>& neighbors) {
  return event<KCellularLteNbrEutraCellMeas>(at, K_LTE_INTRARAT_MEAS, [=](auto& message) {
    for (const LteNeighbor& each : neighbors) {
      auto cell = std::make_shared<EgwErrcNbrEutraMeas>();
      if (each.channel) cell->setNbrEarfcn(*each.channel);
      if (each.code) cell->setNbrPhysCellId(*each.code);
      cell->setNbrRsrp(each.rsrp + 140);
      if (each.rsrqCode) cell->setNbrRsrq(*each.rsrqCode);
      message.addMeasNbrEutra(cell);
    }
  });
}

struct CarrierElement {
  Part index;
  std::optional<SccState> state;
  Part channel{};
  Part code{};
  std::optional<std::int32_t> rsrp{};
};

inline DriveEvent carriers(std::int64_t at, const std::vector<CarrierElement>& elements) {
  return event<KCellularLteCarrierAggregationStatus>(at, K_LTE_CA_STATUS, [=](auto& message) {
    for (const CarrierElement& each : elements) {
      auto carrier = std::make_shared<SecondaryComponentCarrier>();
      if (each.index) carrier->setIndex(*each.index);
      if (each.state) carrier->setState(*each.state);
      if (each.channel) carrier->setDlEarfcn(*each.channel);
      if (each.code) carrier->setPci(*each.code);
      if (each.rsrp) carrier->setRsrp(*each.rsrp * 100);
      carrier->setDlBandwidth(2);
      message.addSccList(carrier);
    }
  });
}

inline DriveEvent cdrx(std::int64_t at, std::uint32_t status, Part onDuration = {},
                       std::optional<LteRrcState> state = {}) {
  return event<KCellularLteCdrxConfig>(at, K_LTE_CDRX_CONFIG, [=](auto& message) {
    message.setCdrxConfigStatus(status);
    if (onDuration) message.setOnDurationMs(*onDuration);
    message.setLongDrxCycleMs(320);
    if (state) message.setRrcState(*state);
  });
}

inline DriveEvent umtsCell(std::int64_t at, Part channel, Part code, Part cellId = {}) {
  return event<KCellularWcdmaCellInfo>(at, K_UMTS_SCELL_INFO, [=](auto& message) {
    if (channel) message.setDlUarfcn(*channel);
    if (code) message.setPsc(*code);
    if (cellId) message.setCellId(*cellId);
  });
}

inline DriveEvent umtsRrc(std::int64_t at, WcdmaRrcConnState state, std::optional<RrcReleaseCause> cause = {}) {
  return event<KCellularWcdmaRrcConnectionState>(at, K_UMTS_RRC_STATE, [=](auto& message) {
    message.setState(state);
    if (cause) message.setReleaseCause(*cause);
  });
}

inline DriveEvent umtsLevel(std::int64_t at, std::int32_t rssi, std::uint32_t ecNoCode,
                            std::optional<bool> isConnected = {}) {
  return event<KCellularWcdmaScellMeasurement>(at, K_UMTS_SCELL_MEAS, [=](auto& message) {
    auto chain = std::make_shared<RxInfo>();
    chain->setRssi(rssi);
    chain->setRsrqRange(ecNoCode);
    message.addRxInfo(chain);
    if (isConnected) message.setConnectedMode(*isConnected);
  });
}

inline DriveEvent gsmCell(std::int64_t at, Part channel, Part code, std::optional<GsmDedicatedState> state = {},
                          Part area = {}) {
  return event<KCellularGsmScellInfo>(at, K_GSM_SCELL_INFO, [=](auto& message) {
    if (channel) message.setArfcn(*channel);
    if (code) message.setBsic(*code);
    if (state) message.setState(*state);
    if (!area) return;
    message.setMcc(460);
    message.setMnc(0);
    message.setLac(*area);
  });
}

inline DriveEvent emm(std::int64_t at, RegStatus status, std::optional<EmmCause> reject = {},
                      std::optional<EmmProc> procedure = {}) {
  return event<KCellularEmmContext>(at, K_LTE_EMM_CTXT, [=](auto& message) {
    message.setRegStatus(status);
    if (reject) message.setRejectCause(*reject);
    if (procedure) message.setRegProc(*procedure);
  });
}

inline DriveEvent mm(std::int64_t at, RegStatus status) {
  return event<KCellularMmContext>(at, K_CELLULAR_MM_CTXT, [=](auto& message) { message.setRegStatus(status); });
}

inline DriveEvent gmm(std::int64_t at, RegStatus status) {
  return event<KCellularGmmContext>(at, K_CELLULAR_GMM_CTXT, [=](auto& message) {
    message.setRegStatus(status);
    auto area = std::make_shared<RoutingAreaId>();
    area->setEncodedPlmn(Data::copy(std::vector<std::uint8_t>{0x64, 0xF0, 0x00}));
    area->setLac(4566);
    area->setRac(100);
    message.setRai(area);
  });
}

/// By nsapi.
inline DriveEvent bearers(std::int64_t at, const std::vector<std::uint32_t>& numbers) {
  return event<KCellularActivatedBearerContexts>(at, K_CELLULAR_ACTIVE_BEARER, [=](auto& message) {
    message.setBearerContextCount(static_cast<std::uint32_t>(numbers.size()));
    for (const std::uint32_t number : numbers) {
      auto bearer = std::make_shared<BearerContext>();
      bearer->setNsapi(number);
      if (number == 5) bearer->setApn("internet"_text);
      if (number == 5) bearer->setPdpType(PdpType::PDP_TYPE_IPv4_PDN);
      message.addBearerContexts(bearer);
    }
  });
}

/// An intake with insight watching it.
class Drive {
 public:
  explicit Drive(const std::vector<DriveEvent>& events = {}, std::vector<Rule> rules = {}) {
    OutputLines::setSink(nullptr);
    insight.setRules(std::move(rules));
    insight.observeEventsOf(*intake_);
    insight.setStepHandler(
        [this](const Report&, const Step& step) { timeline.insert(timeline.end(), step.begin(), step.end()); });
    play(events);
  }
  ~Drive() { intake_->setEventObserver(nullptr); }
  Drive(const Drive&) = delete;
  Drive& operator=(const Drive&) = delete;

  void play(const std::vector<DriveEvent>& events) {
    for (const DriveEvent& each : events)
      take(each.make(static_cast<std::uint64_t>(kStart + each.at)));
  }
  void take(const Dictionary& event) { intake_->validateMetric(event); }

  /// "handover  PCI 328 B17 5815 -> …", one a line.
  [[nodiscard]] std::string lines() const {
    std::string out;
    for (const TimelineEvent& each : timeline)
      out += std::string(nameOf(each.kind)) + "  " + textOf(each) + "\n";
    return out;
  }

  [[nodiscard]] const Stores& stores() const { return intake_->stores; }

  Insight insight;
  std::vector<TimelineEvent> timeline;

 private:
  std::shared_ptr<MetricValidator> intake_ = MetricValidator::listeningTo(nullptr);
};

}  // namespace vesk::insight
