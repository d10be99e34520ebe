// Reads metric events from a capture file, pcap or pcapng of link type USER0, or from all those of a folder.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "capture/PcapFile.h"
#include "platform/dispatch/WakeDescriptor.h"
#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::capture {

class CaptureReader {
 public:
  // "-" reads standard input; of a folder, the files *.pcap and *.pcapng in the order of their names, as one capture.
  // Reasons are one line that names the file: "a.pcap: not a capture: …". A next() that waits for a pipe returns the
  // end once `interruption` was woken.
  static Result<CaptureReader> open(const std::string& path,
                                    std::shared_ptr<const dispatch::WakeDescriptor> interruption = nullptr);

  // The next event; empty at the end. A failure concerns one file, from there on: its reason names the file and the
  // packet, counted from 0 ("a.pcap: packet 3: …"). What came before is good, and the next call continues with the next
  // file of the folder.
  Result<std::optional<MetricEvent>> next();

  // The number of events read so far.
  [[nodiscard]] std::uint64_t count() const { return count_; }
  // The bytes read so far, those of skipped parts included, and the bytes of all files; 0 where that is unknown.
  [[nodiscard]] std::uint64_t bytesRead() const { return bytesBefore_ + (input_ ? input_->position() : 0); }
  [[nodiscard]] std::uint64_t bytesInAll() const;

 private:
  CaptureReader(std::vector<std::string> files, bool ofFolder,
                std::shared_ptr<const dispatch::WakeDescriptor> interruption)
      : files_(std::move(files)), ofFolder_(ofFolder), interruption_(std::move(interruption)) {}
  // Opens the next of the files; the reason when it cannot be read.
  std::optional<std::string> openNext();
  void close();
  Result<std::optional<MetricEvent>> fail(const std::string& reason);

  std::vector<std::string> files_;
  bool ofFolder_;
  std::shared_ptr<const dispatch::WakeDescriptor> interruption_;
  std::size_t opened_ = 0;  // the number of files that were opened
  std::optional<PcapInput> input_;
  std::uint64_t count_ = 0;
  std::uint64_t before_ = 0;       // events of the files before this one
  std::uint64_t bytesBefore_ = 0;  // bytes of the files before this one
};

// The files that CaptureReader reads for `path`: itself, or those of the folder. Reasons name the folder.
[[nodiscard]] Result<std::vector<std::string>> captureFilesOf(const std::string& path);

// How messages name a capture: the path as given, "standard input" for "-".
[[nodiscard]] std::string nameOfInput(const std::string& path);

}  // namespace vespscope::capture
