#include "insight/report_reader.h"

#include <array>

#include "insight/report_steps.h"
#include "messages/registry/metric_identifiers.h"
#include "messages/registry/metric_rows.h"

namespace vesk::insight {

namespace {

struct MetricReading {
  std::int64_t metricId;
  void (*read)(Report& report, OrderedLookup& record, const Stores& stores);
};

/// The others say nothing here.
constexpr MetricRows kReadings(std::array{
    MetricReading{K_LTE_RSRP_RSRQ_SINR, readLteMeasurement},
    MetricReading{K_LTE_INTRARAT_MEAS, readNeighborsOfLte},
    MetricReading{K_UMTS_SCELL_MEAS, readUmtsMeasurement},
    MetricReading{K_LTE_TX_POWER, readLteTxPower},
    MetricReading{K_UMTS_TX_POWER, readUmtsTxPower},
    MetricReading{K_LTE_CDRX_CONFIG, readCdrx},
    MetricReading{K_LTE_SEL_RESEL_INFO, readLteSelection},
    MetricReading{K_LTE_RRC_STATE, readLteRrcState},
    MetricReading{K_LTE_SCELL_INFO, readLteServingCell},
    MetricReading{K_LTE_CA_STATUS, readCarriers},
    MetricReading{K_LTE_INTERRAT_MEAS, readOtherNeighborsOfLte},
    MetricReading{K_CELLULAR_ACTIVE_BEARER, readBearers},
    MetricReading{K_LTE_EMM_CTXT, readRegistration<Registration::emm>},
    MetricReading{K_CELLULAR_MM_CTXT, readRegistration<Registration::mm>},
    MetricReading{K_CELLULAR_GMM_CTXT, readGmmContext},
    MetricReading{K_UMTS_RRC_STATE, readUmtsRrcState},
    MetricReading{K_UMTS_SCELL_INFO, readUmtsServingCell},
    MetricReading{K_UMTS_NCELL_MEAS, readNeighborsOfUmts},
    MetricReading{K_GSM_SCELL_INFO, readGsmServingCell},
    MetricReading{K_GSM_IDLE_SCELL_MEAS, readGsmIdleMeasurement},
    MetricReading{K_GSM_CS_RF_MEAS, readGsmConnectedMeasurement},
    MetricReading{K_GSM_NCELL_MEAS, readNeighborsOfGsm},
    MetricReading{K_SIM_FILE_INFO, readSimFiles},
});

/// Nothing is said; the lists keep their storage.
void clear(Report& report) {
  report.technology.reset();
  report.kpis.clear();
  report.samplePci.reset();
  report.isConnectedMode.reset();
  report.servingCell.reset();
  report.area.reset();
  report.rrc.reset();
  report.registration.reset();
  report.carriers.clear();
  report.bearers.reset();
  report.cdrx.reset();
  report.transmissionMode.reset();
  report.bandwidth.reset();
  report.leastLevel.reset();
  report.simFiles.reset();
  report.neighbors.clear();
}

}  // namespace

const Report& ReportReader::read(std::int64_t metricId, const Dictionary& record, const Stores& stores) {
  clear(report_);
  if (const MetricReading* reading = kReadings.find(metricId)) {
    OrderedLookup fields(record);
    reading->read(report_, fields, stores);
  }
  return report_;
}

}  // namespace vesk::insight
