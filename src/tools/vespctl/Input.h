// A capture as the commands read it: skips damaged files of a folder and reports them on standard error.
#pragma once

#include <optional>
#include <string>

#include "capture/CaptureReader.h"
#include "tools/vespctl/Commands.h"
#include "values/MetricEvent.h"
#include "values/Result.h"

namespace vespscope::tools {

class Input {
 public:
  // Rejects a modem log with a hint at its conversion.
  static Result<Input> open(const std::string& file);

  // The next event; empty at the end.
  [[nodiscard]] std::optional<MetricEvent> next();
  // The number of events read so far.
  [[nodiscard]] std::uint64_t count() const { return reader_.count(); }
  // The last read error; earlier ones have been printed.
  [[nodiscard]] const Problem& problem() const { return problem_; }

 private:
  explicit Input(capture::CaptureReader reader) : reader_(std::move(reader)) {}

  capture::CaptureReader reader_;
  Problem problem_;
};

}  // namespace vespscope::tools
