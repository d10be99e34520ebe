// The metric events of a capture, a file or a folder of files, with the times of their packets.
#pragma once

#include <chrono>
#include <memory>
#include <mutex>
#include <optional>
#include <string>

#include "capture/CaptureReader.h"
#include "sources/playback/Source.h"
#include "values/Result.h"

namespace vespscope::sources {

class ReplayStream final : public EventStream {
 public:
  // "-" is standard input. A pipe cannot be rewound; the first next() opens it and waits for its header. Errors name
  // the file.
  static Result<std::unique_ptr<ReplayStream>> open(const std::string& path);

  [[nodiscard]] std::string label() const override { return label_; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  // A damaged file is skipped from the damaged packet on; `failure` then reports it.
  [[nodiscard]] std::optional<MetricEvent> next() override;
  [[nodiscard]] bool canRewind() const override { return canRewind_; }
  void rewind() override;
  void interrupt() override { interruption_->wake(); }
  // Names each damaged file with its packet, separated by semicolons; of many files the first ones and their number.
  [[nodiscard]] std::optional<std::string> failure() const override;
  [[nodiscard]] InputProgress progress() const override;
  [[nodiscard]] std::string summary() const override;
  // The last SIM card files event of the whole capture, which is read for it; of a pipe, the last one read so far.
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token stop) override;
  [[nodiscard]] std::optional<std::chrono::nanoseconds> length(const std::stop_token& stop) override;

 private:
  ReplayStream(std::string path, std::string label, std::optional<capture::CaptureReader> reader,
               std::shared_ptr<const dispatch::WakeDescriptor> interruption);
  void openReader();
  void note(const std::string& failure);

  std::string path_;
  std::string label_;
  bool canRewind_;
  std::optional<capture::CaptureReader> reader_;  // empty before a pipe is opened, and when the file cannot be opened
  bool opened_;                                   // or opening has failed
  std::shared_ptr<const dispatch::WakeDescriptor> interruption_;
  std::uint64_t bytesInAll_;
  std::string failures_;
  std::size_t failureCount_ = 0;

  std::mutex simMutex_;
  bool simSearched_ = false;
  std::optional<MetricEvent> sim_;
};

// Opens the capture in the file `path` as a stream.
[[nodiscard]] Result<std::unique_ptr<EventStream>> openReplayStream(const std::string& path);

}  // namespace vespscope::sources
