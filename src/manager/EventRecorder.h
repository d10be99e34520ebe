// Records every event that the source delivers, independent of the clients' configurations.
#pragma once

#include <cstdint>
#include <string>

#include "manager/DeliveryFilter.h"

namespace vespscope::manager {

struct RecordingStatus {
  std::uint64_t recorded = 0;  // events
  std::uint64_t lost = 0;      // events that could not be recorded
  std::string problem;         // why nothing is being recorded; empty if recording works
};

class EventRecorder {
 public:
  virtual ~EventRecorder() = default;
  // Returns at once; a failure shows in the status only. Safe from any thread.
  virtual void record(SharedEvent event) = 0;
  [[nodiscard]] virtual RecordingStatus status() const = 0;
};

}  // namespace vespscope::manager
