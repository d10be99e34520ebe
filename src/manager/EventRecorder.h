// Takes note of every event that the source delivers, whatever any client asked for.
#pragma once

#include <cstdint>
#include <string>

#include "manager/DeliveryFilter.h"

namespace vespscope::manager {

struct RecordingStatus {
  std::uint64_t recorded = 0;  // events
  std::uint64_t lost = 0;      // events that were not recorded and never will be
  std::string problem;         // why nothing is being recorded; empty while all is well
};

class EventRecorder {
 public:
  virtual ~EventRecorder() = default;
  // Returns at once, whatever becomes of the event. Safe from any thread.
  virtual void record(SharedEvent event) = 0;
  [[nodiscard]] virtual RecordingStatus status() const = 0;
};

}  // namespace vespscope::manager
