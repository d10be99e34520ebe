// Tracks the phone's registration in the circuit and the packet domain of GSM and UMTS, and the equivalent networks;
// reports each whenever it changes, and a registration again while messages confirm it.
#pragma once

#include <cstdint>
#include <optional>
#include <vector>

#include "sources/diag/EventList.h"
#include "sources/diag/NasRecords.h"
#include "sources/nas/EpsMobility.h"
#include "sources/nas/Mobility.h"

namespace vespscope::sources::diag {

class MobilityTracker {
 public:
  void takeCircuit(const MobilityStateRecord& record, EventList& out);
  void takePacket(const MobilityStateRecord& record, EventList& out);
  void take(const GmmRegistrationRecord& record, EventList& out);
  void take(const nas::MobilityMessage& message, EventList& out);
  // A combined procedure of EPS also registers in the circuit domain.
  void take(const nas::EpsMobilityMessage& message, EventList& out);
  // The RRC connection of UMTS has ended, and the procedures in it.
  void endConnection(EventList& out);

 private:
  // Values are those of KCellularMmContext and KCellularGmmContext.
  struct Registration {
    std::optional<std::int32_t> registration;
    std::optional<std::int32_t> update;
    std::optional<nas::LocationArea> location;
    std::optional<std::uint8_t> routingAreaCode;      // packet domain only
    std::optional<std::uint32_t> temporaryIdentity;   // TMSI or P-TMSI
    std::optional<std::uint32_t> updateTimerSeconds;  // packet domain only
    std::optional<std::int32_t> failureCause;
    std::optional<std::int32_t> rejectCause;
    std::optional<std::int32_t> procedure;  // packet domain only
    std::optional<bool> combined;           // circuit domain only
    bool operator==(const Registration&) const = default;
  };

  static void begin(const nas::MobilityMessage& request, Registration& domain);
  static void reject(const nas::MobilityMessage& message, Registration& domain);
  void accept(const nas::MobilityMessage& message);
  void acceptCombined(const std::optional<nas::LocationArea>& location, std::optional<std::uint32_t> tmsi);
  static void endProcedure(Registration& domain);
  void report(EventList& out);
  // The same after a message of one domain, which confirms its registration.
  void report(nas::Domain domain, EventList& out);
  void reportCircuit(EventList& out);
  void reportPacket(EventList& out);

  Registration circuit_;
  Registration packet_;
  Registration reportedCircuit_;
  Registration reportedPacket_;
  ReportedAt circuitReportedAt_;
  ReportedAt packetReportedAt_;
  std::vector<nas::Plmn> equivalents_;
  std::vector<nas::Plmn> reportedEquivalents_;
};

}  // namespace vespscope::sources::diag
