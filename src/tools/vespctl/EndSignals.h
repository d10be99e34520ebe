// Turns the signals that end a program into the end of a stream, so that the output can be completed.
#pragma once

#include "sources/playback/Source.h"

namespace vespscope::tools {

// While this object lives, SIGINT, SIGTERM and SIGHUP interrupt the stream, unless they were ignored. At most one
// exists at a time.
class EndSignals {
 public:
  explicit EndSignals(sources::EventStream& stream);
  EndSignals(const EndSignals&) = delete;
  EndSignals& operator=(const EndSignals&) = delete;
  ~EndSignals();

  // Whether a signal has arrived.
  [[nodiscard]] bool received() const;
  // Ends the process by the signal that arrived, with the signal's default effect.
  [[noreturn]] void endProcess() const;
};

}  // namespace vespscope::tools
