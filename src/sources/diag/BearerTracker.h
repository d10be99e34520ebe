// Tracks the active bearers of EPS and packet contexts of UMTS and GSM, and reports them as one list whenever they
// change, and again while messages confirm them.
#pragma once

#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "sources/diag/EventList.h"
#include "sources/diag/NasRecords.h"
#include "sources/nas/EpsSession.h"
#include "sources/nas/Session.h"

namespace vespscope::sources::diag {

class BearerTracker {
 public:
  void take(const BearerStateRecord& record, EventList& out);
  void take(const nas::EpsSessionMessage& message, EventList& out);
  void take(const nas::SessionMessage& message, EventList& out);
  // Removes all bearers: the phone has left the packet domain.
  void clear(EventList& out);

 private:
  struct Bearer {
    std::optional<std::string> accessPoint;
    std::optional<nas::PacketAddress> address;
    bool eps = false;  // whether the address is of a PDN connection
    std::vector<Bytes> nameServers;
    bool operator==(const Bearer&) const = default;
  };
  using Bearers = std::map<std::uint8_t, Bearer>;  // by EPS bearer identity or NSAPI, which are the same number
  // A requested context.
  struct Request {
    std::uint8_t accessPointId = 0;
    std::optional<std::string> accessPoint;
  };

  void remove(std::uint8_t bearer);
  void activate(const nas::SessionMessage& accept);
  void report(EventList& out);

  Bearers bearers_;
  Bearers reported_;
  ReportedAt reportedAt_;
  std::map<std::uint8_t, std::uint8_t> links_;               // from a dedicated bearer to its default one
  std::map<std::uint8_t, Request> requests_;                 // by transaction
  std::map<std::uint8_t, std::uint8_t> activeTransactions_;  // maps to the context that it began
};

}  // namespace vespscope::sources::diag
