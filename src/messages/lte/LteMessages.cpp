// The operations of the messages of schema/lte.proto.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageOperations.h"

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

namespace vespscope {

template class Message<KCellularLteRrcState>;
template class Message<KCellularLteCdrxConfig>;
template class Message<KCellularLteScellInfo>;
template class Message<KCellularLteSelReselCellInfo>;
template class Message<NbrEutra>;
template class Message<KCellularLteServingCellMeasurement>;
template class Message<RxInfo>;
template class Message<KCellularLteTxPower>;
template class Message<TxPowerInfo>;
template class Message<KCellularLteRsrpRsrqSinr>;
template class Message<RsrpRsrqSinr>;
template class Message<KCellularLteComponentCarrierInfo>;
template class Message<KCellularLteCarrierAggregationStatus>;
template class Message<SecondaryComponentCarrier>;
template class Message<KCellularLteNbrEutraCellMeas>;
template class Message<EgwErrcNbrEutraMeas>;
template class Message<KCellularLteNbrInterRatCellMeas>;
template class Message<EgwErrcNbrUtraMeas>;
template class Message<EgwErrcNbrGeranMeas>;
template class Message<KCellularEmmContext>;
template class Message<Guti>;
template class Message<KCellularTrackingAreaId>;

}  // namespace vespscope
