// Knows what is known of the phone's EPS registration and reports it whenever that changes.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "sources/diag/EventList.h"
#include "sources/diag/NasRecords.h"
#include "sources/nas/EpsMobility.h"

namespace vespscope::sources::diag {

class EmmTracker {
 public:
  // Whether the phone has left the network.
  [[nodiscard]] static bool isDeregistered(const EmmStateRecord& record);

  void take(const EmmStateRecord& record, EventList& out);
  void take(const nas::EpsMobilityMessage& message, EventList& out);

 private:
  // Numbers are those of KCellularEmmContext.
  struct Context {
    std::optional<std::int32_t> registration;
    std::optional<std::int32_t> update;
    std::optional<std::int32_t> mode;
    std::optional<std::int32_t> rejectCause;
    std::optional<std::int32_t> procedure;
    std::optional<nas::Guti> guti;
    std::vector<nas::TrackingArea> areas;
    std::optional<std::uint32_t> updateTimerSeconds;
    std::optional<bool> imsVoice;
    std::optional<bool> emergencyBearers;
    bool operator==(const Context&) const = default;
  };

  void begin(const nas::EpsMobilityMessage& request);
  void accept(const nas::EpsMobilityMessage& message);
  void reject(const nas::EpsMobilityMessage& message);
  void report(EventList& out);

  Context context_;
  Context reported_;
};

}  // namespace vespscope::sources::diag
