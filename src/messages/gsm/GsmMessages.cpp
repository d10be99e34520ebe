// The operations of the messages of schema/gsm.proto.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageOperations.h"

#include "messages/gsm/GsmNcellMeas.h"
#include "messages/gsm/KCellularGsmCsRfMeasurement.h"
#include "messages/gsm/KCellularGsmGprsConfig.h"
#include "messages/gsm/KCellularGsmGrrEventMeasCr.h"
#include "messages/gsm/KCellularGsmIdleConfig.h"
#include "messages/gsm/KCellularGsmIdleScellMeasurement.h"
#include "messages/gsm/KCellularGsmScellInfo.h"
#include "messages/gsm/LteNcellMeas.h"
#include "messages/gsm/UmtsNcellMeas.h"

namespace vespscope {

template class Message<KCellularGsmScellInfo>;
template class Message<KCellularGsmIdleConfig>;
template class Message<KCellularGsmGprsConfig>;
template class Message<KCellularGsmIdleScellMeasurement>;
template class Message<KCellularGsmCsRfMeasurement>;
template class Message<KCellularGsmGrrEventMeasCr>;
template class Message<GsmNcellMeas>;
template class Message<UmtsNcellMeas>;
template class Message<LteNcellMeas>;

}  // namespace vespscope
