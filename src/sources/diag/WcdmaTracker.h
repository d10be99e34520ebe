// Reports the WCDMA cell from the modem's description, and follows the RRC connection through its messages.
#pragma once

#include <cstdint>
#include <optional>

#include "sources/diag/EventList.h"
#include "sources/diag/WcdmaRecords.h"
#include "sources/diag/WcdmaRrcMeaning.h"

namespace vespscope::sources::diag {

class WcdmaTracker {
 public:
  static void describe(const WcdmaCellRecord& record, EventList& out);
  // Returns true when the message ended the connection.
  bool take(const WcdmaRrcMeaning& meaning, EventList& out);

 private:
  // Values are those of KCellularWcdmaRrcConnectionState.
  struct Connection {
    std::int32_t state = 0;
    std::optional<std::int32_t> establishmentCause;
    std::optional<std::int32_t> releaseCause;
    bool operator==(const Connection&) const = default;
  };
  // A message that needs a connection confirms it.
  void confirm(EventList& out);
  void report(const Connection& connection, EventList& out);

  std::optional<Connection> reported_;
  ReportedAt reportedAt_;
  std::optional<std::int32_t> granted_;  // the state requested by a setup
};

}  // namespace vespscope::sources::diag
