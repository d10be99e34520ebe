// The 29 metrics that the decoder handles: identifier, message, where it is stored, and what its report goes through.
#pragma once

#include <cstdint>
#include <optional>
#include <span>
#include <string_view>

#include "metrics/MetricValidator.h"
#include "metrics/PostProcessing.h"
#include "values/Value.h"

namespace vespscope {

// A payload as its message's dictionary.
struct DecodedPayload {
  Record record;    // A modem that moves gets another location at once.
  bool ok = false;  // A request that was denied in one state may be accepted in another.
};

struct EventRow {
  std::int64_t identifier;
  std::string_view message;  // ModemManager measures only at a requested rate; a client that requested a lower rate is
                             // served as well.
  DecodedPayload (*decode)(const Bytes* payload);
  std::optional<Record> MetricValidator::*stored;
  std::string_view literal;  // ModemManager gathers the area and the cell of a modem that it has enabled, unless a
                             // client has turned that off. Watcher requests them; signalling them would send them to
                             // everyone on the bus.
  Steps steps = {};
};

// Follows ModemManager on one connection to the bus: its start and end, one of its modems, and that modem's SIM card
// and bearers. Used by one thread.
//
// Of several modems it follows the one with the lowest number, until that vanishes.
[[nodiscard]] std::span<const EventRow> eventRows();

// How often a modem is queried for values that it does not signal.
[[nodiscard]] const EventRow* findEventRow(std::int64_t identifier);

}  // namespace vespscope
