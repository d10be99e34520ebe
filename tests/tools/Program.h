// Runs one of the programs as a user does, and makes captures of literal packets.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "support/TemporaryFolder.h"
#include "values/MetricEvent.h"

namespace vespscope::test {

struct Outcome {
  int status = -1;  // the exit status, or the negative number of the signal that ended the program
  std::string output;
  std::string errors;
};

// Runs bin/`program` in the time zone UTC, without a baseband manager available, and waits for its end.
[[nodiscard]] Outcome runProgram(const std::string& program, const std::vector<std::string>& arguments,
                                 const std::string& input = "");
[[nodiscard]] inline Outcome vespctl(const std::vector<std::string>& arguments, const std::string& input = "") {
  return runProgram("vespctl", arguments, input);
}

[[nodiscard]] std::string contentsOf(const std::string& path);
[[nodiscard]] std::vector<std::string> linesOf(const std::string& text);

// Converts hexadecimal digits (blanks are ignored) into bytes.
[[nodiscard]] std::string binary(const std::string& hexadecimal);

// The bytes of a capture file: the header of a nanosecond pcap of link type 147, then `packets`.
[[nodiscard]] std::string captureOf(const std::vector<std::string>& packets);
// One packet of such a file at a time since 1970, with the given bytes.
[[nodiscard]] std::string packetAt(std::uint32_t seconds, std::uint32_t nanoseconds, const std::string& bytes);
// The bytes of such a file with these events.
[[nodiscard]] std::string captureOf(const std::vector<MetricEvent>& events);

}  // namespace vespscope::test
