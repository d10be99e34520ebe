// The elementary files of a SIM card as one message (3GPP TS 31.102, TS 51.011).
#pragma once

#include <cstdint>
#include <vector>

#include "messages/mobility/KCellularSimCardFiles.h"
#include "values/Value.h"

namespace vespscope::sources {

struct CardFile {
  std::uint32_t id = 0;  // such as 0x2FE2 for EF_ICCID
  Bytes content;         // in the file's own coding
};

// Makes the message of `files`, in their order and without a timestamp.
[[nodiscard]] KCellularSimCardFiles simCardFilesMessage(const std::vector<CardFile>& files);

}  // namespace vespscope::sources
