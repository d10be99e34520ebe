// The metric events of a modem's diagnostic log.
#pragma once

#include <chrono>
#include <deque>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "platform/files/UnpackedFile.h"
#include "sources/diag/DiagReport.h"
#include "sources/diag/FrameMapper.h"
#include "sources/diag/FrameReader.h"
#include "sources/playback/Source.h"
#include "values/Result.h"

namespace vespscope::sources {

namespace diag {

// A log read front to back.
class DiagStream final : public EventStream {
 public:
  // "-" is standard input. Fails with an error that names the file when it cannot be read or does not begin like a
  // modem log. A pipe is examined by the first next(), which waits for its bytes.
  static Result<std::unique_ptr<DiagStream>> open(const std::string& path);

  [[nodiscard]] std::string label() const override { return label_; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  [[nodiscard]] std::optional<MetricEvent> next() override;
  [[nodiscard]] bool canRewind() const override { return file_->canRewind(); }
  void rewind() override;
  void interrupt() override { interruption_->wake(); }
  [[nodiscard]] std::optional<std::string> failure() const override { return failure_; }
  [[nodiscard]] InputProgress progress() const override { return {file_->position(), file_->size().value_or(0)}; }
  [[nodiscard]] std::string summary() const override { return counts().text(); }
  [[nodiscard]] std::string report() const override { return counts().table(); }
  // The log has no SIM card files.
  [[nodiscard]] std::optional<MetricEvent> simCardFiles(std::stop_token /*stop*/) override { return std::nullopt; }
  [[nodiscard]] std::optional<std::chrono::nanoseconds> length(const std::stop_token& stop) override;

  // Keeps samples of the records that are not read, from here to the next rewind; they must live as long as this.
  void sampleUnread(UnreadSamples& samples) { mapper_.sampleUnread(samples); }
  // The counts since the beginning or the last rewind.
  [[nodiscard]] DiagReport counts() const;

 private:
  DiagStream(std::string path, std::string label, std::unique_ptr<files::UnpackedFile> file,
             std::shared_ptr<const dispatch::WakeDescriptor> interruption);
  // Reads up to the first valid frame; if there is none, failure_ says why.
  void examine();
  [[nodiscard]] std::optional<std::span<const std::uint8_t>> nextFrame();
  [[nodiscard]] bool readPiece();

  std::string path_;  // as given
  std::string name_;  // its name in messages
  std::string label_;
  std::shared_ptr<const dispatch::WakeDescriptor> interruption_;
  std::unique_ptr<files::UnpackedFile> file_;
  std::vector<std::uint8_t> piece_;
  bool examined_ = false;
  Bytes head_;  // the first bytes
  FrameReader frames_;
  std::optional<std::span<const std::uint8_t>> firstFrame_;  // found by open, not yet returned
  FrameMapper mapper_;
  std::deque<MetricEvent> events_;
  std::optional<std::string> failure_;
};

}  // namespace diag

// Opens the log in the file `path` as a stream; "-" is standard input, which cannot be rewound.
[[nodiscard]] Result<std::unique_ptr<EventStream>> openDiagStream(const std::string& path);

}  // namespace vespscope::sources
