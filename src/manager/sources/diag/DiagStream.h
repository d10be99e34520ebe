// The metric events of a modem's diagnostic log.
#pragma once

#include <cstdio>
#include <deque>
#include <map>
#include <memory>
#include <optional>
#include <span>
#include <string>
#include <vector>

#include "manager/Source.h"
#include "manager/sources/diag/DiagReport.h"
#include "manager/sources/diag/FrameReader.h"
#include "manager/sources/diag/RecordMapper.h"
#include "values/Result.h"

namespace vespscope::manager {

namespace diag {

// A log read front to back. The events of a SIM whose number the modem tells carry it as their profile.
class DiagStream final : public EventStream {
 public:
  // "-" is standard input. Fails, naming the file, when it cannot be read or does not begin like a modem log.
  static Result<std::unique_ptr<DiagStream>> open(const std::string& path);

  [[nodiscard]] std::string label() const override { return label_; }
  [[nodiscard]] SourceKind kind() const override { return SourceKind::recorded; }
  [[nodiscard]] std::optional<MetricEvent> next() override;
  [[nodiscard]] bool canRewind() const override { return canRewind_; }
  void rewind() override;
  [[nodiscard]] std::optional<std::string> failure() const override { return failure_; }
  [[nodiscard]] std::string summary() const override { return report().text(); }
  // The log has no SIM card files.
  [[nodiscard]] std::optional<MetricEvent> simCardFiles() override { return std::nullopt; }

  // Of what has been read since the beginning or the last rewind.
  [[nodiscard]] DiagReport report() const;

 private:
  struct FileCloser {
    void operator()(std::FILE* file) const { std::fclose(file); }
  };

  DiagStream(std::string name, std::string label, std::unique_ptr<std::FILE, FileCloser> file);
  [[nodiscard]] bool beginsLikeALog();
  [[nodiscard]] std::optional<std::span<const std::uint8_t>> nextFrame();
  [[nodiscard]] bool readPiece();
  void takeFrame(std::span<const std::uint8_t> frame);

  std::string name_;  // the path as given
  std::string label_;
  std::unique_ptr<std::FILE, FileCloser> file_;
  bool canRewind_;
  std::vector<std::uint8_t> piece_;
  std::uint64_t bytesRead_ = 0;
  FrameReader frames_;
  std::optional<std::span<const std::uint8_t>> firstFrame_;  // found by open, not yet taken
  std::map<std::uint32_t, RecordMapper> radios_;
  std::deque<MetricEvent> events_;
  DiagReport report_;
  std::optional<std::string> failure_;
};

}  // namespace diag

// The log in the file `path` as a stream; "-" is standard input, which cannot be rewound.
[[nodiscard]] Result<std::unique_ptr<EventStream>> openDiagStream(const std::string& path);

}  // namespace vespscope::manager
