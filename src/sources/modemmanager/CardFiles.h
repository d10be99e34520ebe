// The SIM card's elementary files as far as ModemManager reports their contents, coded as specified in 3GPP TS 31.102
// and ETSI TS 102 221. Bytes that it does not report are FF, as on an erased card.
#pragma once

#include <cstdint>
#include <string_view>
#include <vector>

#include "sources/modemmanager/ModemState.h"
#include "sources/report/SimCardFiles.h"
#include "values/Value.h"

namespace vespscope::sources::modemmanager {

// EF_ICCID, EF_IMSI, EF_AD, EF_SPN, EF_GID1 and EF_GID2; a file without any reported content is omitted.
[[nodiscard]] std::vector<CardFile> cardFiles(const SimCard& card);

// Codes an IMSI as in EF_IMSI, TS 31.102 4.2.2, without its length byte.
[[nodiscard]] Bytes encodedImsi(std::string_view digits);

}  // namespace vespscope::sources::modemmanager
