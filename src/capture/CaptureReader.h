// Reads metric events from a capture file, pcap or pcapng of link type USER0, or from all those of a folder.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "capture/PcapFile.h"
#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

class CaptureReader {
 public:
  // "-" reads standard input; of a folder, the files *.pcap and *.pcapng in the order of their names, as one capture.
  // Reasons are one line that names the file: "a.pcap: not a capture: …".
  static Result<CaptureReader> open(const std::string& path);

  // The next event; empty at the end. The reason of a failure names the file and its packet, counted from 0 ("a.pcap:
  // packet 3: …");
  // nothing can be read after it, what came before it is good.
  Result<std::optional<MetricEvent>> next();

  // The number of events read so far.
  [[nodiscard]] std::uint64_t count() const { return count_; }

 private:
  CaptureReader(std::string name, PcapInput input) : name_(std::move(name)), input_(std::move(input)) {}
  Result<std::optional<MetricEvent>> fail(const std::string& reason);
  // Goes on with the next file of the folder; false when there is none.
  Result<bool> openNext();

  std::string name_;
  PcapInput input_;
  std::vector<std::string> rest_;  // of a folder, the files still to be read, the last one first
  std::uint64_t count_ = 0;
  std::uint64_t before_ = 0;  // events of the files before this one
  std::optional<std::string> failure_;
};

// How messages name a capture: the path as given, "standard input" for "-".
[[nodiscard]] std::string nameOfInput(const std::string& path);

}  // namespace vespscope::capture
