// Reads metric events from a capture file: pcap or pcapng of link type USER0.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "capture/PcapFile.h"
#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

class CaptureReader {
 public:
  // "-" reads standard input. Reasons are one line that names the file: "a.pcap: not a capture: …".
  static Result<CaptureReader> open(const std::string& path);

  // The next event; empty at the end. The reason of a failure names the packet, counted from 0 ("a.pcap: packet 3: …");
  // nothing can be read after it, what came before it is good.
  Result<std::optional<MetricEvent>> next();

  // The number of events read so far, which is also the index of the packet that `next` reads.
  [[nodiscard]] std::uint64_t count() const { return count_; }

 private:
  CaptureReader(std::string name, PcapInput input) : name_(std::move(name)), input_(std::move(input)) {}
  Result<std::optional<MetricEvent>> fail(const std::string& reason);

  std::string name_;
  PcapInput input_;
  std::uint64_t count_ = 0;
  std::optional<std::string> failure_;
};

// How messages name a capture: the path as given, "standard input" for "-".
[[nodiscard]] std::string nameOfInput(const std::string& path);

}  // namespace vespscope::capture
