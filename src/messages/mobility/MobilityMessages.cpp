// The operations of the messages of schema/mobility.proto.
//
// Written by messagegen; change it there.
// clang-format off
#include "messages/MessageOperations.h"

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

namespace vespscope {

template class Message<KCellularMmCommonInfo>;
template class Message<Plmn>;
template class Message<KCellularLocationAreaId>;
template class Message<KCellularMmContext>;
template class Message<KCellularGmmContext>;
template class Message<RoutingAreaId>;
template class Message<KCellularActivatedBearerContexts>;
template class Message<BearerContext>;
template class Message<KCellularSimCardFiles>;
template class Message<ElementaryFile>;

}  // namespace vespscope
