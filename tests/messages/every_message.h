#pragma once

#include <gtest/gtest.h>

#include "messages/gsm/gsm.h"
#include "messages/lte/lte.h"
#include "messages/nas/nas.h"
#include "messages/wcdma/wcdma.h"

namespace vesk::metrics {

using EveryMessage = testing::Types<
    KCellularLteRrcState, KCellularLteCdrxConfig, KCellularLteScellInfo, KCellularLteSelReselCellInfo,
    KCellularLteServingCellMeasurement, KCellularLteTxPower, KCellularLteRsrpRsrqSinr, KCellularLteComponentCarrierInfo,
    KCellularLteCarrierAggregationStatus, KCellularLteNbrEutraCellMeas, KCellularLteNbrInterRatCellMeas, NbrEutra,
    TxPowerInfo, RxInfo, RsrpRsrqSinr, SecondaryComponentCarrier, EgwErrcNbrEutraMeas, EgwErrcNbrUtraMeas,
    EgwErrcNbrGeranMeas, LteCellMeasResult, UtraCellMeasResult, GsmCellMeasResult, EutraFreqInfo, UtraFreqInfo,
    GsmFreqInfo, KCellularWcdmaRrcConnectionState, KCellularWcdmaCellInfo, KCellularWcdmaScellMeasurement,
    KCellularWcdmaTxPower, KCellularWcdmaNbrCellMeas, KCellularWcdmaSelReselCellInfo, KCellularWcdmaRrcConfiguration,
    GsmNcellMeas, UmtsNcellMeas, LteNcellMeas, KCellularGsmScellInfo, KCellularGsmIdleConfig,
    KCellularGsmIdleScellMeasurement, KCellularGsmCsRfMeasurement, KCellularGsmGrrEventMeasCr, KCellularGsmGprsConfig,
    KCellularMmCommonInfo, KCellularEmmContext, KCellularMmContext, KCellularGmmContext,
    KCellularActivatedBearerContexts, KCellularSimCardFiles, Plmn, KCellularLocationAreaId, KCellularTrackingAreaId,
    RoutingAreaId, Guti, BearerContext, ElementaryFile>;

}  // namespace vesk::metrics
