// The operations of the messages of schema/umts.proto.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageOperations.h"

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

template class Message<KCellularWcdmaRrcConnectionState>;
template class Message<KCellularWcdmaRrcConfiguration>;
template class Message<KCellularWcdmaCellInfo>;
template class Message<KCellularWcdmaSelReselCellInfo>;
template class Message<EutraFreqInfo>;
template class Message<UtraFreqInfo>;
template class Message<GsmFreqInfo>;
template class Message<KCellularWcdmaScellMeasurement>;
template class Message<KCellularWcdmaTxPower>;
template class Message<KCellularWcdmaNbrCellMeas>;
template class Message<UtraCellMeasResult>;
template class Message<GsmCellMeasResult>;
template class Message<LteCellMeasResult>;

}  // namespace vespscope
