// RRC messages of real modem logs, which lie outside the tree: in the folder that the environment variable
// VESPSCOPE_CAPTURES states, else in ../shared/captures beside the tree.
#pragma once

#include <cstdint>
#include <filesystem>
#include <optional>
#include <string>
#include <vector>

#include "rrc/Pdu.h"

namespace vespscope::test {

struct CapturedMessage {
  rrc::Pdu pdu{};
  std::vector<std::uint8_t> bytes;
};

struct Capture {
  std::string name;
  std::vector<CapturedMessage> messages;
  std::size_t unmapped = 0;  // RRC records of a layout or channel that is not known
};

// The logs of the folder; empty when it is missing.
[[nodiscard]] std::vector<std::filesystem::path> captureFiles();
[[nodiscard]] Capture readCapture(const std::filesystem::path& path);

}  // namespace vespscope::test
