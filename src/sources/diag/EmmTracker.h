// Tracks the phone's EPS registration and reports it whenever it changes, and again while messages confirm it.
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
  // Returns true when the phone has left the network by this message. `outgoing`: the phone sent it.
  bool take(const nas::EpsMobilityMessage& message, bool outgoing, EventList& out);
  // Ends the pending procedure: the RRC connection has ended.
  void endConnection(EventList& out);

 private:
  // Values are those of KCellularEmmContext.
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

  // Whether a detach request ends the registration for EPS, or only that of the circuit domain.
  [[nodiscard]] static bool endsRegistration(const nas::EpsMobilityMessage& request, bool outgoing);
  void leave();

  Context context_;
  Context reported_;
  ReportedAt reportedAt_;
  bool detaching_ = false;
};

}  // namespace vespscope::sources::diag
