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
  // "-" reads standard input; a folder's *.pcap and *.pcapng files, also compressed as *.pcap.gz or *.pcap.xz, are read
  // in the order of their names, as one capture. Errors are one line that names the file: "a.pcap: not a capture: …".
  // Once `interruption` is woken, a next() that waits for a pipe returns as at the end.
  static Result<CaptureReader> open(const std::string& path,
                                    std::shared_ptr<const dispatch::WakeDescriptor> interruption = nullptr);

  // The next event; empty at the end. An error concerns the rest of one file and names the file and the packet, counted
  // from 0 ("a.pcap: packet 3: …"). The events before it are valid, and the next call continues with the next file of
  // the folder.
  Result<std::optional<MetricEvent>> next();

  // The number of events read so far.
  [[nodiscard]] std::uint64_t count() const { return count_; }
  // The number of bytes read so far, including skipped parts, and the size of all files; 0 if unknown.
  [[nodiscard]] std::uint64_t bytesRead() const { return bytesBefore_ + (input_ ? input_->position() : 0); }
  [[nodiscard]] std::uint64_t bytesInAll() const;

 private:
  CaptureReader(std::vector<std::string> files, bool ofFolder,
                std::shared_ptr<const dispatch::WakeDescriptor> interruption)
      : files_(std::move(files)), ofFolder_(ofFolder), interruption_(std::move(interruption)) {}
  // Opens the next of the files; returns the error when it cannot be read.
  std::optional<std::string> openNext();
  void close();
  Result<std::optional<MetricEvent>> fail(const std::string& reason);

  std::vector<std::string> files_;
  bool ofFolder_;
  std::shared_ptr<const dispatch::WakeDescriptor> interruption_;
  std::size_t opened_ = 0;  // the number of opened files
  std::optional<PcapInput> input_;
  std::uint64_t count_ = 0;
  std::uint64_t before_ = 0;       // events of the files before this one
  std::uint64_t bytesBefore_ = 0;  // bytes of the files before this one
};

// The files that CaptureReader reads for `path`: the path itself, or the files of the folder. Errors name the folder.
[[nodiscard]] Result<std::vector<std::string>> captureFilesOf(const std::string& path);

// A capture's name in messages: the path as given, or "standard input" for "-".
[[nodiscard]] std::string nameOfInput(const std::string& path);

}  // namespace vespscope::capture
