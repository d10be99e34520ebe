// Writes metric events into a capture file: pcap with nanoseconds, link type USER0.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "capture/PcapOutput.h"
#include "platform/files/NewFile.h"
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
  using Existing = PcapOutput::Existing;

  // Creates the file, for its owner alone to read, and writes its header at once; "-" writes standard output.
  static Result<CaptureWriter> create(const std::string& path, Flushing flushing,
                                      Existing existing = Existing::replace);
  // The same under the name of a partial file (see files::NewFile), until finish(). Standard output, pipes and devices
  // have no other name: they are written at once.
  static Result<CaptureWriter> createWhole(const std::string& path, Flushing flushing, Existing existing);

  // Each gives a one-line reason naming the file when it fails; the file then ends with a whole packet.
  [[nodiscard]] std::optional<std::string> write(const MetricEvent& event);
  // Brings what is written out of the process; call it at the end to learn of a full disk.
  [[nodiscard]] std::optional<std::string> flush();
  // Flushes, and gives a partial file its name.
  [[nodiscard]] std::optional<std::string> finish();

  // Whether the file is a partial one.
  [[nodiscard]] bool isPartial() const { return partial_.has_value(); }
  // Brings out what waits, and returns words for the end of a message: "; 28 events are in out.partial.pcap". A partial
  // file without an event is removed instead; without a partial file there are no words.
  [[nodiscard]] std::string leavePartial();

  // The events in the file and those that wait to be brought out.
  [[nodiscard]] std::uint64_t count() const { return output_.packets(); }
  // Bytes of the file, with those that wait.
  [[nodiscard]] std::uint64_t size() const { return output_.size(); }
  // The last failure was the system's, which a later call may be spared, not the event's.
  [[nodiscard]] bool unwritable() const { return output_.unwritable(); }
  // Nothing can be written any more, because what stands at the end of the file is no whole packet.
  [[nodiscard]] bool broken() const { return output_.broken(); }
  // The file is still where it was created.
  [[nodiscard]] bool inPlace() const { return output_.isAt(name_); }
  // Another program has cut the file or added to it.
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
