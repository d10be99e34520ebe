// What a list holds before its first event, so that its screen shows one row that says so.
#pragma once

#include "values/Value.h"

namespace vespscope {

[[nodiscard]] inline RecordList waitingForUpdate() { return {Record{{"Waiting for Update", "Waiting for Update"}}}; }

}  // namespace vespscope
