// A capture as the commands read it: skips damaged files of a folder and reports them on standard error.
#pragma once

#include <optional>
#include <set>
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

  // Skips the events of other SIM cards than `sim` from here on; empty: none.
  void choose(Sim sim) { sim_ = sim; }
  // The next event; empty at the end.
  [[nodiscard]] std::optional<MetricEvent> next();
  // The number of events read so far.
  [[nodiscard]] std::uint64_t count() const { return reader_.count(); }
  // The last read error; earlier ones have been printed. Else, at the end, that the capture has other SIM cards, but
  // not the chosen one.
  [[nodiscard]] Problem problem() const;

 private:
  Input(std::string file, capture::CaptureReader reader) : file_(std::move(file)), reader_(std::move(reader)) {}

  std::string file_;
  capture::CaptureReader reader_;
  Problem problem_;
  Sim sim_;
  std::set<std::int32_t> sims_;  // that were read
};

}  // namespace vespscope::tools
