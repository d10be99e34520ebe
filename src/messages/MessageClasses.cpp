// Every message class by its name.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageClasses.h"

#include "messages/gsm/GsmNcellMeas.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/gsm/LteNcellMeas.h"
#include "messages/gsm/UmtsNcellMeas.h"
#include "messages/lte/EgwErrcNbrEutraMeas.h"
#include "messages/lte/EgwErrcNbrGeranMeas.h"
#include "messages/lte/EgwErrcNbrUtraMeas.h"
#include "messages/lte/Guti.h"
#include "messages/lte/KCellularEmmContext.h"
#include "messages/lte/KCellularLteCarrierAggregationStatus.h"
#include "messages/lte/KCellularLteCdrxConfig.h"
#include "messages/lte/KCellularLteComponentCarrierInfo.h"
#include "messages/lte/KCellularLteNbrEutraCellMeas.h"
#include "messages/lte/KCellularLteNbrInterRatCellMeas.h"
#include "messages/lte/KCellularLteRrcState.h"
#include "messages/lte/KCellularLteRsrpRsrqSinr.h"
#include "messages/lte/KCellularLteScellInfo.h"
#include "messages/lte/KCellularLteSelReselCellInfo.h"
#include "messages/lte/KCellularLteServingCellMeasurement.h"
#include "messages/lte/KCellularLteTxPower.h"
#include "messages/lte/KCellularTrackingAreaId.h"
#include "messages/lte/NbrEutra.h"
#include "messages/lte/RsrpRsrqSinr.h"
#include "messages/lte/RxInfo.h"
#include "messages/lte/SecondaryComponentCarrier.h"
#include "messages/lte/TxPowerInfo.h"
#include "messages/mobility/BearerContext.h"
#include "messages/mobility/ElementaryFile.h"
#include "messages/mobility/KCellularActivatedBearerContexts.h"
#include "messages/mobility/KCellularGmmContext.h"
#include "messages/mobility/KCellularLocationAreaId.h"
#include "messages/mobility/KCellularMmCommonInfo.h"
#include "messages/mobility/KCellularMmContext.h"
#include "messages/mobility/KCellularSimCardFiles.h"
#include "messages/mobility/Plmn.h"
#include "messages/mobility/RoutingAreaId.h"
#include "messages/umts/EutraFreqInfo.h"
#include "messages/umts/GsmCellMeasResult.h"
#include "messages/umts/GsmFreqInfo.h"
#include "messages/umts/KCellularWcdmaCellInfo.h"
#include "messages/umts/KCellularWcdmaNbrCellMeas.h"
#include "messages/umts/KCellularWcdmaRrcConfiguration.h"
#include "messages/umts/KCellularWcdmaRrcConnectionState.h"
#include "messages/umts/KCellularWcdmaScellMeasurement.h"
#include "messages/umts/KCellularWcdmaSelReselCellInfo.h"
#include "messages/umts/KCellularWcdmaTxPower.h"
#include "messages/umts/LteCellMeasResult.h"
#include "messages/umts/UtraCellMeasResult.h"
#include "messages/umts/UtraFreqInfo.h"

namespace vespscope {
namespace {

template <class Class>
constexpr MessageClass entry{Class::className, []() -> std::shared_ptr<WireMessage> { return std::make_shared<Class>(); }};

constexpr MessageClass classes[] = {
    entry<KCellularGsmScellInfo>,
    entry<KCellularGsmIdleConfig>,
    entry<KCellularGsmGprsConfig>,
    entry<KCellularGsmIdleScellMeasurement>,
    entry<KCellularGsmCsRfMeasurement>,
    entry<KCellularGsmGrrEventMeasCr>,
    entry<GsmNcellMeas>,
    entry<UmtsNcellMeas>,
    entry<LteNcellMeas>,
    entry<KCellularLteRrcState>,
    entry<KCellularLteCdrxConfig>,
    entry<KCellularLteScellInfo>,
    entry<KCellularLteSelReselCellInfo>,
    entry<NbrEutra>,
    entry<KCellularLteServingCellMeasurement>,
    entry<RxInfo>,
    entry<KCellularLteTxPower>,
    entry<TxPowerInfo>,
    entry<KCellularLteRsrpRsrqSinr>,
    entry<RsrpRsrqSinr>,
    entry<KCellularLteComponentCarrierInfo>,
    entry<KCellularLteCarrierAggregationStatus>,
    entry<SecondaryComponentCarrier>,
    entry<KCellularLteNbrEutraCellMeas>,
    entry<EgwErrcNbrEutraMeas>,
    entry<KCellularLteNbrInterRatCellMeas>,
    entry<EgwErrcNbrUtraMeas>,
    entry<EgwErrcNbrGeranMeas>,
    entry<KCellularEmmContext>,
    entry<Guti>,
    entry<KCellularTrackingAreaId>,
    entry<KCellularMmCommonInfo>,
    entry<Plmn>,
    entry<KCellularLocationAreaId>,
    entry<KCellularMmContext>,
    entry<KCellularGmmContext>,
    entry<RoutingAreaId>,
    entry<KCellularActivatedBearerContexts>,
    entry<BearerContext>,
    entry<KCellularSimCardFiles>,
    entry<ElementaryFile>,
    entry<KCellularWcdmaRrcConnectionState>,
    entry<KCellularWcdmaRrcConfiguration>,
    entry<KCellularWcdmaCellInfo>,
    entry<KCellularWcdmaSelReselCellInfo>,
    entry<EutraFreqInfo>,
    entry<UtraFreqInfo>,
    entry<GsmFreqInfo>,
    entry<KCellularWcdmaScellMeasurement>,
    entry<KCellularWcdmaTxPower>,
    entry<KCellularWcdmaNbrCellMeas>,
    entry<UtraCellMeasResult>,
    entry<GsmCellMeasResult>,
    entry<LteCellMeasResult>,
};

}  // namespace

std::span<const MessageClass> messageClasses() { return classes; }

}  // namespace vespscope
