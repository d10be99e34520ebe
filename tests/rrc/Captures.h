// RRC messages of real modem logs outside the tree: in the folder that the environment variable VESPSCOPE_CAPTURES
// names, else in ../shared/captures next to the tree.
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
  std::size_t unmapped = 0;  // RRC records of an unknown layout or channel
};

// The logs in the folder; empty when it does not exist.
[[nodiscard]] std::vector<std::filesystem::path> captureFiles();
[[nodiscard]] Capture readCapture(const std::filesystem::path& path);

}  // namespace vespscope::test
