// Asks a modem's log port how it is, without changing what it logs.
#pragma once

#include <chrono>
#include <cstdint>
#include <string>

namespace vespscope::sources::diag {

struct PortAnswer {
  enum class Kind {
    answers,  // and can log
    logging,  // sends log records that nobody asked for here
    refuses,  // answers that the log cannot be turned on
    garbled,  // sends bytes that are no frames of a modem
    silent,   // sends nothing
    failed,   // cannot be opened, or was closed
  };
  Kind kind = Kind::silent;
  std::uint64_t records = 0;  // that came
  std::string reason;         // of a failure
};

// Opens the port as PortConnection does, asks how many codes the modem can log, and listens for `patience`, or for
// `listening` once it answered.
[[nodiscard]] PortAnswer askPort(const std::string& port,
                                 std::chrono::milliseconds patience = std::chrono::milliseconds(2000),
                                 std::chrono::milliseconds listening = std::chrono::milliseconds(500));

}  // namespace vespscope::sources::diag
