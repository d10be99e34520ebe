// The latest GSM neighbour measurements, one list per technology of the neighbours.
#pragma once

#include "metrics/Placeholder.h"
#include "values/Value.h"

namespace vespscope {

struct GSM {
  RecordList eUtraNbrMeas = waitingForUpdate();
  RecordList utraNbrMeas = waitingForUpdate();
  RecordList geraNbrMeas = waitingForUpdate();
};

}  // namespace vespscope
