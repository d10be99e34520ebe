// Writes metric events to a capture file: pcap with nanoseconds, link type USER0.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "capture/PcapOutput.h"
#include "platform/files/NewFile.h"
#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

// When packets are written to the file.
enum class Flushing {
  eachPacket,  // each at once, so that a kill loses at most one packet: for recording
  inBlocks,    // when a block is full, and at the end: for conversion
};

class CaptureWriter {
 public:
  using Existing = PcapOutput::Existing;

  // Creates the file, readable by its owner only, and writes its header at once; "-" writes standard output.
  static Result<CaptureWriter> create(const std::string& path, Flushing flushing,
                                      Existing existing = Existing::replace);
  // The same, but the file has a partial name (see files::NewFile) until finish(). Standard output, pipes and devices
  // have no other name: they are written at once.
  static Result<CaptureWriter> createWhole(const std::string& path, Flushing flushing, Existing existing);

  // Each returns a one-line error that names the file on failure; the file then ends with a whole packet.
  [[nodiscard]] std::optional<std::string> write(const MetricEvent& event);
  // Writes the buffered packets to the file; call it at the end to detect a full disk.
  [[nodiscard]] std::optional<std::string> flush();
  // Flushes, and gives a partial file its name.
  [[nodiscard]] std::optional<std::string> finish();

  // Whether the file has a partial name.
  [[nodiscard]] bool isPartial() const { return partial_.has_value(); }
  // Writes the buffered packets, and returns words for the end of a message: "; 28 events are in out.partial.pcap".
  // Removes a partial file without events and returns an empty text, as for a file that is not partial.
  [[nodiscard]] std::string leavePartial();

  // The number of events in the file and in the buffer.
  [[nodiscard]] std::uint64_t count() const { return output_.packets(); }
  // The file's size with the buffered bytes.
  [[nodiscard]] std::uint64_t size() const { return output_.size(); }
  // Whether the last failure was a system error, which may be temporary, and not caused by the event.
  [[nodiscard]] bool unwritable() const { return output_.unwritable(); }
  // Whether the file can no longer be written, because it does not end with a whole packet.
  [[nodiscard]] bool broken() const { return output_.broken(); }
  // Whether the file is still where it was created.
  [[nodiscard]] bool inPlace() const { return output_.isAt(name_); }
  // Whether another program has truncated or extended the file.
  [[nodiscard]] bool wasChanged() const { return output_.wasChanged(); }
  [[nodiscard]] const std::string& name() const { return name_; }

 private:
  CaptureWriter(std::string name, Flushing flushing, PcapOutput output)
      : name_(std::move(name)), flushing_(flushing), output_(std::move(output)) {}

  std::string name_;
  Flushing flushing_;
  PcapOutput output_;
  std::optional<files::NewFile> partial_;
};

}  // namespace vespscope::capture
