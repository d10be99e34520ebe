// Turns the signals that end a program into the end of a stream, so that what was written can be put in order.
#pragma once

#include "sources/playback/Source.h"

namespace vespscope::tools {

// While this lives, SIGINT, SIGTERM and SIGHUP interrupt the stream, unless they were ignored. One at a time.
class EndSignals {
 public:
  explicit EndSignals(sources::EventStream& stream);
  EndSignals(const EndSignals&) = delete;
  EndSignals& operator=(const EndSignals&) = delete;
  ~EndSignals();

  // Whether a signal came.
  [[nodiscard]] bool received() const;
  // Ends the process by the signal that came, as it would have ended without this.
  [[noreturn]] void endProcess() const;
};

}  // namespace vespscope::tools
