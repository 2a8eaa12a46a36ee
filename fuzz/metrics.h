#pragma once

#include <cstdint>

#include "messages/registry/metric_identifiers.h"

namespace vesk {

/// Those that are handled, those that are known, and some that are neither.
inline constexpr std::int64_t kMetrics[] = {
    K_LTE_CDRX_CONFIG,
    K_LTE_RRC_STATE,
    K_LTE_SCELL_INFO,
    K_LTE_RLF,
    K_LTE_SEL_RESEL_INFO,
    K_LTE_SCELL_MEAS,
    K_LTE_TX_POWER,
    K_LTE_RSRP_RSRQ_SINR,
    K_LTE_COMPCARR_INFO,
    K_LTE_CA_STATUS,
    K_LTE_INTERRAT_MEAS,
    K_LTE_INTRARAT_MEAS,
    K_CELLULAR_MM_INFO,
    K_CELLULAR_MM_CTXT,
    K_LTE_EMM_CTXT,
    K_CELLULAR_ACTIVE_BEARER,
    K_CELLULAR_GMM_CTXT,
    K_UMTS_RRC_STATE,
    K_UMTS_RRC_CONFIG,
    K_UMTS_SCELL_INFO,
    K_UMTS_SCELL_MEAS,
    K_UMTS_TX_POWER,
    K_UMTS_NCELL_MEAS,
    K_UMTS_SEL_RESEL_INFO,
    K_GSM_SCELL_INFO,
    K_GSM_IDLE_CONFIG,
    K_GSM_CS_RF_MEAS,
    K_GSM_IDLE_SCELL_MEAS,
    K_GSM_NCELL_MEAS,
    K_GSM_GPRS_CONFIG,
    K_SIM_FILE_INFO,
    K_LTE_RRC_STATE + 1,
    K_LTE_RRC_STATE >> 16,
    K_LTE_RRC_STATE << 8,
    0,
    -1,
};

}  // namespace vesk
