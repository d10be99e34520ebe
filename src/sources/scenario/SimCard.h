// The elementary files of a test card, coded as specified in 3GPP TS 31.102 and ETSI TS 102 221.
#pragma once

#include <vector>

#include "sources/scenario/NasReports.h"
#include "values/Value.h"

namespace vespscope::sources::scenario {

// The subscriber identity in the coding of EF_IMSI, TS 31.102 4.2.2, without the length byte.
[[nodiscard]] Bytes testImsi();

[[nodiscard]] std::vector<CardFile> testCardFiles();

}  // namespace vespscope::sources::scenario
