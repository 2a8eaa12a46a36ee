#include "intake/metric_table.h"

#include <algorithm>
#include <array>

#include "intake/extra_steps.h"
#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"

namespace vesk {

namespace {

using namespace metrics;
using enum StepOrder;
using Intake = MetricValidator;

// clang-format off
constexpr std::array<HandledMetric, 29> kHandledMetrics{{
    {K_LTE_CDRX_CONFIG, decodePayload<KCellularLteCdrxConfig>, &Intake::myLTECDRXConfigDict,
     "Current CDRX Config is ", timestampLogExtra, nullptr},
    {K_LTE_RRC_STATE, decodePayload<KCellularLteRrcState>, &Intake::myLTERRCStateDict,
     "Current RRC state is ", timestampLogExtra, nullptr},
    {K_LTE_SCELL_INFO, decodePayload<KCellularLteScellInfo>, &Intake::myLTESCellInfoDict,
     "Current Serving Cell Info is ", timestampExtraLog, takeLteServingCell},
    {K_LTE_SEL_RESEL_INFO, decodePayload<KCellularLteSelReselCellInfo>, &Intake::myLTESelReselDict,
     "Received LTE Cell Resel Info is ", logExtra, takeLteSelectionParameters},
    {K_LTE_TX_POWER, decodePayload<KCellularLteTxPower>, &Intake::myLTETxPowerDict,
     "Received LTE Tx Power is ", timestampLogExtra, takeLteTxPower},
    {K_LTE_RSRP_RSRQ_SINR, decodePayload<KCellularLteRsrpRsrqSinr>, &Intake::myLTERsrpRsrqSinrDict,
     "Received RSRP RSRQ SINR is : ", logExtra, takeLteRsrpRsrqSinr},
    {K_LTE_COMPCARR_INFO, decodePayload<KCellularLteComponentCarrierInfo>, &Intake::myLTECompCarrDict,
     "Received Component Carrier info is ", timestampLogExtra, nullptr},
    {K_LTE_CA_STATUS, decodePayload<KCellularLteCarrierAggregationStatus>, &Intake::myLTECAStatusDict,
     "Received CA Status Dict is ", timestampLogExtra, takeLteCarrierAggregation},
    {K_LTE_INTERRAT_MEAS, decodePayload<KCellularLteNbrInterRatCellMeas>, &Intake::myLTEInterRatMeasDict,
     "Received LTE InterRat Meas Info is ", timestampLogExtra, takeLteInterRatNeighbors},
    {K_LTE_INTRARAT_MEAS, decodePayload<KCellularLteNbrEutraCellMeas>, &Intake::myLTEIntraRatMeasDict,
     "Received LTE IRAT Meas is ", timestampLogExtra, takeLteNeighbors},
    {K_CELLULAR_MM_INFO, decodePayload<KCellularMmCommonInfo>, &Intake::myCellularMMCommonInfoDict,
     "Received MM Common Info Dict is : ", timestampLogExtra, nullptr},
    {K_CELLULAR_ACTIVE_BEARER, decodePayload<KCellularActivatedBearerContexts>, &Intake::myCellularActiveBearerDict,
     "Received Bearer Context Info is ", logTimestampExtra, takeActiveBearers},
    {K_LTE_EMM_CTXT, decodePayload<KCellularEmmContext>, &Intake::myLTEEMMContextDict,
     "Received EMM Context is ", timestampExtraLog, takeEmmContext},
    {K_CELLULAR_MM_CTXT, decodePayload<KCellularMmContext>, &Intake::myMMContextDict,
     "Received MM Context Info is ", timestampLogExtra, nullptr},
    {K_CELLULAR_GMM_CTXT, decodePayload<KCellularGmmContext>, &Intake::myGMMContextDict,
     "Received GMM Context Info is ", timestampLogExtra, nullptr},
    {K_UMTS_RRC_STATE, decodePayload<KCellularWcdmaRrcConnectionState>, &Intake::myUMTSRRCStateDict,
     "Received UMTS RRC Connection State is ", timestampLogExtra, nullptr},
    {K_UMTS_RRC_CONFIG, decodePayload<KCellularWcdmaRrcConfiguration>, &Intake::myUMTSRRCConfigDict,
     "Received UMTS RRC Configuration is ", timestampLogExtra, nullptr},
    {K_UMTS_SCELL_INFO, decodePayload<KCellularWcdmaCellInfo>, &Intake::myUMTSCellInfoDict,
     "Received UMTS Serving Cell Info is ", timestampLogExtra, nullptr},
    {K_UMTS_SCELL_MEAS, decodePayload<KCellularWcdmaScellMeasurement>, &Intake::myUMTSCellMeasDict,
     "Received UMTS Serving Cell Meas is ", timestampLogExtra, takeUmtsServingCellMeasurement},
    {K_UMTS_TX_POWER, decodePayload<KCellularWcdmaTxPower>, &Intake::myUMTSTxPowerDict,
     "Received Tx Power is ", timestampLogExtra, takeUmtsTxPower},
    {K_UMTS_SEL_RESEL_INFO, decodePayload<KCellularWcdmaSelReselCellInfo>, &Intake::myUMTSSelReselDict,
     "Received UMTS Cell Resel Info is ", timestampLogExtra, takeUmtsSelectionParameters},
    {K_UMTS_NCELL_MEAS, decodePayload<KCellularWcdmaNbrCellMeas>, &Intake::myUMTSNbrMeasDict,
     "Received UMTS InterRat Meas Info is ", timestampLogExtra, takeUmtsNeighbors},
    {K_GSM_SCELL_INFO, decodePayload<KCellularGsmScellInfo>, &Intake::myGSMScellInfoDict,
     "Received GSM Serving Cell Info ", timestampLogExtra, nullptr},
    {K_GSM_IDLE_CONFIG, decodePayload<KCellularGsmIdleConfig>, &Intake::myGSMIdleConfigInfoDict,
     "Received GSM Idle Config Info is ", timestampLogExtra, nullptr},
    {K_GSM_IDLE_SCELL_MEAS, decodePayload<KCellularGsmIdleScellMeasurement>, &Intake::myGSMIdleScellMeasDict,
     "Received GSM Idle Serving Cell Meas Info is ", timestampLogExtra, nullptr},
    {K_GSM_CS_RF_MEAS, decodePayload<KCellularGsmCsRfMeasurement>, &Intake::myGSMConnRfMeasDict,
     "Received GSM Connected Serving Cell Meas Info is ", timestampLogExtra, nullptr},
    {K_GSM_NCELL_MEAS, decodePayload<KCellularGsmGrrEventMeasCr>, &Intake::myGSMNbrMeasDict,
     "Received GSM Nbr Cell Meas Info is ", timestampLogExtra, takeGsmNeighbors},
    {K_GSM_GPRS_CONFIG, decodePayload<KCellularGsmGprsConfig>, &Intake::myGSMGPRSConfigDict,
     "Received GSM GPRS Config Info is ", timestampLogExtra, nullptr},
    {K_SIM_FILE_INFO, decodePayload<KCellularSimCardFiles>, &Intake::mySIMFileInfoDict,
     "Received SIM Card File Info is ", timestampLogExtra, takeSimFiles},
}};
// clang-format on

}  // namespace

const HandledMetric* findHandledMetric(std::int64_t id) {
  const auto* found = std::find_if(kHandledMetrics.begin(), kHandledMetrics.end(),
                                   [id](const HandledMetric& metric) { return metric.id == id; });
  return found == kHandledMetrics.end() ? nullptr : found;
}

}  // namespace vesk
