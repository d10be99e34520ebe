// The metric events of a capture, a file or a folder of files, with the times at which they were captured.
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
  // "-" is standard input; that and any other pipe cannot be rewound, and is opened by the first next(), which waits
  // for its header. Reasons name the file.
  static Result<std::unique_ptr<ReplayStream>> open(const std::string& path);

  [[nodiscard]] std::string label() const override { return label_; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  // What is damaged is left out, up to the end of its file; `failure` then says so.
  [[nodiscard]] std::optional<MetricEvent> next() override;
  [[nodiscard]] bool canRewind() const override { return canRewind_; }
  void rewind() override;
  void interrupt() override { interruption_->wake(); }
  // Names each damaged file with its packet, separated by semicolons; of many files the first ones and a number.
  [[nodiscard]] std::optional<std::string> failure() const override;
  [[nodiscard]] InputProgress progress() const override;
  [[nodiscard]] std::string summary() const override;
  // The last SIM card files event of the whole file, which is read through once; of a pipe, of what has been read.
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
  bool opened_;                                   // or tried to be
  std::shared_ptr<const dispatch::WakeDescriptor> interruption_;
  std::uint64_t bytesInAll_;
  std::string failures_;
  std::size_t failureCount_ = 0;

  std::mutex simMutex_;
  bool simSearched_ = false;
  std::optional<MetricEvent> sim_;
};

// The capture in the file `path` as a stream.
[[nodiscard]] Result<std::unique_ptr<EventStream>> openReplayStream(const std::string& path);

}  // namespace vespscope::sources
