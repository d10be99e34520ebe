// The latest lists that belong to no single technology: bearers and SIM files.
#pragma once

#include "metrics/Placeholder.h"
#include "values/Value.h"

namespace vespscope {

struct Common {
  RecordList activeBearer = waitingForUpdate();
  RecordList simContents = waitingForUpdate();
};

}  // namespace vespscope
