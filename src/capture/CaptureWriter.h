// Writes metric events into a capture file: pcap with nanoseconds, link type USER0.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "capture/PcapFile.h"
#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

// When written packets leave the process.
enum class Flushing {
  eachPacket,  // a kill loses at most the packet being written: for recording
  inBlocks,    // when a block is full, and at the end: for conversion
};

class CaptureWriter {
 public:
  // Creates or replaces the file and writes its header at once; "-" writes standard output.
  static Result<CaptureWriter> create(const std::string& path, Flushing flushing);

  // Each gives a one-line reason naming the file when it fails.
  [[nodiscard]] std::optional<std::string> write(const MetricEvent& event);
  // Brings what is written out of the process; call it at the end to learn of a full disk.
  [[nodiscard]] std::optional<std::string> flush();

  [[nodiscard]] std::uint64_t count() const { return count_; }

 private:
  CaptureWriter(std::string name, Flushing flushing, PcapOutput output)
      : name_(std::move(name)), flushing_(flushing), output_(std::move(output)) {}

  std::string name_;
  Flushing flushing_;
  PcapOutput output_;
  std::uint64_t count_ = 0;
};

}  // namespace vespscope::capture
